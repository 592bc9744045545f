#include "ryx/headless/widgets.h"

#include "ryx/errors.h"
#include "ryx/headless/form.h"
#include "ryx/headless/site.h"

namespace ryx::headless {

Node::Node(Site* site, const WidgetDesign& d)
    : site_(site),
      name_(d.name),
      index_(d.index),
      kind_(d.kind),
      tabIndex_(d.tabIndex),
      inFrame_(d.inFrame),
      left_(d.left),
      top_(d.top),
      width_(d.width),
      height_(d.height) {}

std::string Node::displayName() const {
    if (index_ < 0) return name_;
    return name_ + "(" + std::to_string(index_) + ")";
}

void Node::notify(Notify what, EventArgs& args) {
    if (handler_) handler_(what, args);
}

void Node::notify(Notify what) {
    EventArgs args;
    notify(what, args);
}

void Node::focusByCode() {
    if (!site_) throw WidgetError(displayName() + " is not on a form");
    Form& form = site_->form();
    if (!form.canTakeFocus(*this))
        throw WidgetError(displayName() + " cannot take the focus: it is hidden or disabled");
    form.setFocus(*this);
}

HFrame::HFrame(Site* site, const WidgetDesign& d)
    : WidgetOf(site, d), caption_(d.caption), back_(d.backColor), fore_(d.foreColor) {}

HLabel::HLabel(Site* site, const WidgetDesign& d)
    : WidgetOf(site, d), caption_(d.caption), back_(d.backColor) {}

HCheckBox::HCheckBox(Site* site, const WidgetDesign& d)
    : WidgetOf(site, d), caption_(d.caption), back_(d.backColor) {}

void HCheckBox::setValue(int16_t v) {
    if (v < 0 || v > 2)
        throw OverflowError("check box value " + std::to_string(v) + " is not 0, 1 or 2");
    if (v == value_) return;
    value_ = v;
    notify(Notify::Click);
}

void HCheckBox::keyCharDefault(int16_t keyChar) {
    if (keyChar == vk::Space) clickDefault();
}

void HCheckBox::clickDefault() {
    setValue(value_ == 1 ? 0 : 1);
}

HListBox::HListBox(Site* site, const WidgetDesign& d)
    : WidgetOf(site, d), back_(d.backColor), fore_(d.foreColor) {
    for (std::string_view item : d.items)
        addItem(item);
}

void HListBox::checkRow(int32_t row, const char* what) const {
    if (row < 0 || row >= listCount())
        throw IndexError(std::string(what) + ": row " + std::to_string(row) + " is not in " +
                         displayName() + ", which has " + std::to_string(listCount()) + " rows");
}

void HListBox::clear() {
    rows_.clear();
    current_ = -1;
}

void HListBox::addItem(std::string_view text) {
    rows_.add(text);
}

std::string HListBox::list(int32_t row) const {
    checkRow(row, "List");
    return rows_.text(row);
}

bool HListBox::selected(int32_t row) const {
    checkRow(row, "Selected");
    return rows_.selected(row);
}

void HListBox::setSelected(int32_t row, bool v) {
    checkRow(row, "Selected");
    if (rows_.setSelected(row, row, v)) notify(Notify::Click);
}

void HListBox::setSelectedRange(int32_t first, int32_t last, bool v) {
    if (first > last) return;
    checkRow(first, "Selected");
    checkRow(last, "Selected");
    if (rows_.setSelected(first, last, v)) notify(Notify::Click);
}

void HListBox::setListIndex(int32_t row) {
    if (row != -1) checkRow(row, "ListIndex");
    if (row == current_) return;
    current_ = row;
    notify(Notify::Click);
}

int32_t HListBox::selCount() const {
    int32_t n = 0;
    for (uint8_t f : rows_.flags())
        n += f;
    return n;
}

void HListBox::clickRow(int32_t row) {
    checkRow(row, "Click");
    rows_.setSelected(row, row, !rows_.selected(row));
    current_ = row;
    notify(Notify::Click);
}

void HListBox::keyDownDefault(int16_t keyCode, int16_t) {
    int32_t target = current_;
    if (keyCode == vk::Up) target = current_ - 1;
    if (keyCode == vk::Down) target = current_ + 1;
    if (keyCode == vk::Home) target = 0;
    if (keyCode == vk::End) target = listCount() - 1;
    if (target == current_ || target < 0 || target >= listCount()) return;
    current_ = target;
    notify(Notify::Click);
}

void HListBox::keyCharDefault(int16_t keyChar) {
    if (keyChar == vk::Space && current_ >= 0) clickRow(current_);
}

HTextBox::HTextBox(Site* site, const WidgetDesign& d) : WidgetOf(site, d), back_(d.backColor) {
    edit_.setText(d.caption);
}

HCommandButton::HCommandButton(Site* site, const WidgetDesign& d)
    : WidgetOf(site, d), caption_(d.caption), toolTip_(d.toolTip), back_(d.backColor) {}

void HCommandButton::keyCharDefault(int16_t keyChar) {
    if (keyChar == vk::Space) clickDefault();
}

HMaskedEdit::HMaskedEdit(Site* site, const WidgetDesign& d)
    : WidgetOf(site, d), back_(d.backColor), fore_(d.foreColor) {
    edit_.setMask(d.mask);
}

}  // namespace ryx::headless
