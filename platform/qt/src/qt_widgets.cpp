#include "qt_widgets.h"

#include <QApplication>
#include <QEvent>
#include <QPainter>
#include <QShortcutEvent>
#include <QTimer>

#include "ryx/errors.h"
#include "ryx/qt/control_host.h"

namespace ryx::qt {
namespace {

// The system colours a control may name (0x800000nn), as a light Windows theme paints them.
QColor systemColor(int index) {
    switch (index) {
        case 5:
            return QColor(255, 255, 255);  // window
        case 8:
            return QColor(0, 0, 0);  // window text
        case 13:
            return QColor(0, 120, 215);  // highlight
        case 15:
            return QColor(240, 240, 240);  // button face
        case 16:
            return QColor(160, 160, 160);  // button shadow
        case 17:
            return QColor(109, 109, 109);  // grey text
        case 20:
            return QColor(255, 255, 255);  // 3D highlight
        case 22:
            return QColor(227, 227, 227);  // 3D light
        default:
            return QColor(128, 128, 128);
    }
}

QString qstr(std::string_view s) {
    return QString::fromUtf8(s.data(), static_cast<int>(s.size()));
}

QPixmap picture(std::string_view name, int w, int h) {
    QPixmap pm(w, h);
    pm.fill(Qt::transparent);
    QPainter p(&pm);
    p.setRenderHint(QPainter::Antialiasing);
    if (name == "popup") {  // a white upward triangle on red
        p.fillRect(0, 0, w, h, QColor(192, 0, 0));
        QPolygon tri;
        tri << QPoint(w / 2, h / 4) << QPoint(w - w / 5, h - h / 4) << QPoint(w / 5, h - h / 4);
        p.setBrush(Qt::white);
        p.setPen(Qt::NoPen);
        p.drawPolygon(tri);
    } else if (name == "calendar") {  // a leaf of a wall calendar
        p.setPen(QColor(64, 64, 64));
        p.setBrush(Qt::white);
        p.drawRect(1, 2, w - 3, h - 4);
        p.fillRect(2, 3, w - 4, h / 4, QColor(192, 0, 0));
        p.setPen(QColor(96, 96, 96));
        for (int row = 0; row < 3; ++row)
            for (int col = 0; col < 4; ++col)
                p.drawPoint(4 + col * (w - 8) / 4, h / 2 + row * (h / 6));
    }
    return pm;
}

}  // namespace

QColor toQColor(Color c) {
    const auto u = static_cast<uint32_t>(c);
    if ((u & 0xFF000000u) == 0x80000000u) return systemColor(static_cast<int>(u & 0xFF));
    return QColor(static_cast<int>(u & 0xFF), static_cast<int>((u >> 8) & 0xFF),
                  static_cast<int>((u >> 16) & 0xFF));
}

void setRoleColor(QWidget* w, QPalette::ColorRole role, Color c) {
    QPalette pal = w->palette();
    pal.setColor(QPalette::Active, role, toQColor(c));
    pal.setColor(QPalette::Inactive, role, toQColor(c));
    w->setPalette(pal);
}

QFont toQFont(const Font& f) {
    // The design's Windows fonts map to the nearest fonts of a Linux desktop.
    QFont font(f.name == "Fixedsys" ? "DejaVu Sans Mono" : "DejaVu Sans");
    font.setPointSizeF(f.name == "Fixedsys" ? 8.5 : f.size * 0.88);
    font.setBold(f.bold);
    return font;
}

// ---- every child -------------------------------------------------------------------------

QtNode::QtNode(ControlHost& host, const WidgetDesign& d, QWidget* widget)
    : host_(host),
      widget_(widget),
      name_(d.name),
      index_(d.index),
      inFrame_(d.inFrame),
      tabIndex_(d.tabIndex),
      left_(d.left),
      top_(d.top),
      width_(d.width),
      height_(d.height) {
    widget_->setObjectName(qstr(displayName()));
    widget_->setFont(toQFont(d.font));
    if (!d.toolTip.empty()) widget_->setToolTip(qstr(d.toolTip));
    applyGeometry();
}

std::string QtNode::displayName() const {
    if (index_ < 0) return name_;
    return name_ + "(" + std::to_string(index_) + ")";
}

void QtNode::notify(Notify what, EventArgs& args) {
    if (handler_) handler_(what, args);
}

void QtNode::notify(Notify what) {
    EventArgs args;
    notify(what, args);
}

void QtNode::applyGeometry() {
    widget_->setGeometry(host_.toPixels(left_), host_.toPixels(top_), host_.toPixels(width_),
                         host_.toPixels(height_));
}

void QtNode::setEnabledFlag(bool v) {
    enabled_ = v;
    widget_->setEnabled(v);
    host_.updateFocusPolicies();
}

void QtNode::setVisibleFlag(bool v) {
    visible_ = v;
    widget_->setVisible(v);
}

void QtNode::focusByCode() {
    if (!host_.canTakeFocus(*this))
        throw WidgetError(displayName() + " cannot take the focus: it is hidden or disabled");
    widget_->setFocus(Qt::OtherFocusReason);
    QtKeyboard::instance().flush();
}

// ---- frame -------------------------------------------------------------------------------

bool QtFrameBox::event(QEvent* e) {
    if (e->type() == QEvent::Shortcut) {
        // The frame's access letter belongs to the control, which decides what it does.
        const QString keys = static_cast<QShortcutEvent*>(e)->key().toString();
        const QChar letter = keys.isEmpty() ? QChar() : keys.back().toLower();
        host_.accessKeyPressed(static_cast<int16_t>(letter.unicode()));
        return true;
    }
    return QGroupBox::event(e);
}

QtFrame::QtFrame(ControlHost& host, const WidgetDesign& d, QtFrameBox* box)
    : QtWidgetOf(host, d, box), caption_(d.caption), back_(d.backColor), fore_(d.foreColor) {
    box->setAutoFillBackground(true);
    box->setTitle(qstr(caption_));
    setRoleColor(box, QPalette::Window, back_);
    paintTitle();
}

void QtFrame::setCaption(std::string_view text) {
    caption_ = text;
    static_cast<QGroupBox*>(widget_)->setTitle(qstr(caption_));
}

void QtFrame::setBackColor(Color c) {
    back_ = c;
    setRoleColor(widget_, QPalette::Window, c);
}

void QtFrame::setForeColor(Color c) {
    fore_ = c;
    paintTitle();
}

// A disabled frame greys its caption and lets no input through, while the widgets inside
// keep their own look: the frame itself is never disabled in Qt, which would grey them all.
void QtFrame::paintTitle() {
    const Color greyText = static_cast<Color>(0x80000011);
    setRoleColor(widget_, QPalette::WindowText, enabled_ ? fore_ : greyText);
}

void QtFrame::setEnabled(bool v) {
    enabled_ = v;
    paintTitle();
    host_.updateFocusPolicies();
}

void QtFrame::setWidth(Twips w) {
    width_ = w;
    applyGeometry();
}

void QtFrame::setHeight(Twips h) {
    height_ = h;
    applyGeometry();
}

// ---- label -------------------------------------------------------------------------------

QtLabel::QtLabel(ControlHost& host, const WidgetDesign& d, QWidget* parent)
    : QtWidgetOf(host, d, new QLabel(parent)), caption_(d.caption) {
    auto* label = static_cast<QLabel*>(widget_);
    label->setTextFormat(Qt::PlainText);
    label->setText(qstr(caption_));
    setRoleColor(label, QPalette::WindowText, d.foreColor);
}

void QtLabel::setCaption(std::string_view text) {
    caption_ = text;
    static_cast<QLabel*>(widget_)->setText(qstr(caption_));
}

void QtLabel::setEnabled(bool v) {
    setEnabledFlag(v);
}
void QtLabel::setVisible(bool v) {
    setVisibleFlag(v);
}

// ---- check box ---------------------------------------------------------------------------

QtCheckBox::QtCheckBox(ControlHost& host, const WidgetDesign& d, QWidget* parent)
    : QtWidgetOf(host, d, new QCheckBox(parent)) {
    box()->setText(qstr(d.caption));
    box()->setAutoFillBackground(true);
    setRoleColor(box(), QPalette::Window, d.backColor);
    setRoleColor(box(), QPalette::WindowText, d.foreColor);
}

void QtCheckBox::setValue(int16_t v) {
    if (v < 0 || v > 2)
        throw OverflowError("check box value " + std::to_string(v) + " is not 0, 1 or 2");
    if (v == value_) return;
    value_ = v;
    box()->setCheckState(v == 1 ? Qt::Checked : v == 2 ? Qt::PartiallyChecked : Qt::Unchecked);
    notify(Notify::Click);
}

void QtCheckBox::setBackColor(Color c) {
    setRoleColor(widget_, QPalette::Window, c);
}
void QtCheckBox::setEnabled(bool v) {
    setEnabledFlag(v);
}

void QtCheckBox::keyCharDefault(int16_t keyChar) {
    if (keyChar == vk::Space) setValue(value_ == 1 ? 0 : 1);
}

void QtCheckBox::clickDefault(QWidget*, QPoint) {
    setValue(value_ == 1 ? 0 : 1);
}

// ---- list --------------------------------------------------------------------------------

int RowsModel::rowCount(const QModelIndex& parent) const {
    return parent.isValid() ? 0 : announced_;
}

QVariant RowsModel::data(const QModelIndex& index, int role) const {
    if (!index.isValid() || index.row() >= count()) return {};
    const int32_t row = index.row();
    switch (role) {
        case Qt::DisplayRole:
            return QString::fromStdString(rows_.text(row));
        case Qt::BackgroundRole:
            return rows_.selected(row)
                       ? QVariant(QApplication::palette().brush(QPalette::Highlight))
                       : QVariant();
        case Qt::ForegroundRole:
            return rows_.selected(row)
                       ? QVariant(QApplication::palette().brush(QPalette::HighlightedText))
                       : QVariant();
        default:
            return {};
    }
}

bool RowsModel::setSelected(int32_t first, int32_t last, bool v) {
    const bool changed = rows_.setSelected(first, last, v);
    if (changed && first < announced_)
        emit dataChanged(index(first), index(std::min<int32_t>(last, announced_ - 1)));
    return changed;
}

void RowsModel::clear() {
    beginResetModel();
    rows_.clear();
    announced_ = 0;
    endResetModel();
}

// Appended rows reach the view in one announcement, when the running handler has returned:
// a million appends then cost one insertion in the view, not a million.
void RowsModel::append(std::string_view text) {
    rows_.add(text);
    announceLater();
}

void RowsModel::append(int32_t count, ListBox::RowText text) {
    rows_.add(count, std::move(text));
    announceLater();
}

void RowsModel::announceLater() {
    if (announceScheduled_) return;
    announceScheduled_ = true;
    QTimer::singleShot(0, this, [this] { announce(); });
}

void RowsModel::announce() {
    announceScheduled_ = false;
    if (announced_ >= count()) return;
    beginInsertRows({}, announced_, count() - 1);
    announced_ = count();
    endInsertRows();
}

QtListBox::QtListBox(ControlHost& host, const WidgetDesign& d, QWidget* parent)
    : QtWidgetOf(host, d, new QListView(parent)), back_(d.backColor), fore_(d.foreColor) {
    view()->setUniformItemSizes(true);
    view()->setHorizontalScrollBarPolicy(Qt::ScrollBarAlwaysOff);
    view()->setSelectionMode(QAbstractItemView::NoSelection);
    view()->setEditTriggers(QAbstractItemView::NoEditTriggers);
    view()->setModel(&model_);
    setRoleColor(view(), QPalette::Base, back_);
    setRoleColor(view(), QPalette::Text, fore_);
    for (std::string_view item : d.items)
        addItem(item);
    model_.announce();
}

void QtListBox::checkRow(int32_t row, const char* what) const {
    if (row < 0 || row >= listCount())
        throw IndexError(std::string(what) + ": row " + std::to_string(row) + " is not in " +
                         displayName() + ", which has " + std::to_string(listCount()) + " rows");
}

void QtListBox::clear() {
    model_.clear();
    current_ = -1;
}

void QtListBox::addItem(std::string_view text) {
    model_.append(text);
}

std::string QtListBox::list(int32_t row) const {
    checkRow(row, "List");
    return model_.row(row);
}

bool QtListBox::selected(int32_t row) const {
    checkRow(row, "Selected");
    return model_.isSelected(row);
}

void QtListBox::setSelected(int32_t row, bool v) {
    checkRow(row, "Selected");
    if (model_.setSelected(row, row, v)) notify(Notify::Click);
}

void QtListBox::setSelectedRange(int32_t first, int32_t last, bool v) {
    if (first > last) return;
    checkRow(first, "Selected");
    checkRow(last, "Selected");
    if (model_.setSelected(first, last, v)) notify(Notify::Click);
}

void QtListBox::setListIndex(int32_t row) {
    if (row != -1) checkRow(row, "ListIndex");
    if (row == current_) return;
    current_ = row;
    showCurrent();
    notify(Notify::Click);
}

void QtListBox::showCurrent() {
    model_.announce();
    const QModelIndex index = current_ >= 0 ? model_.index(current_) : QModelIndex();
    view()->selectionModel()->setCurrentIndex(index, QItemSelectionModel::NoUpdate);
    if (index.isValid()) view()->scrollTo(index);
}

void QtListBox::toggle(int32_t row) {
    model_.announce();
    model_.setSelected(row, row, !model_.isSelected(row));
    current_ = row;
    showCurrent();
    notify(Notify::Click);
}

void QtListBox::setBackColor(Color c) {
    back_ = c;
    setRoleColor(view(), QPalette::Base, c);
}

void QtListBox::setWidth(Twips w) {
    width_ = w;
    applyGeometry();
}

void QtListBox::setHeight(Twips h) {
    height_ = h;
    applyGeometry();
}

void QtListBox::setEnabled(bool v) {
    setEnabledFlag(v);
}

void QtListBox::refresh() {
    view()->viewport()->repaint();
}

void QtListBox::keyDownDefault(int16_t keyCode, int16_t) {
    int32_t target = current_;
    const int32_t page = 8;
    if (keyCode == vk::Up) target = current_ - 1;
    if (keyCode == vk::Down) target = current_ + 1;
    if (keyCode == 33) target = std::max(0, current_ - page);
    if (keyCode == 34) target = std::min(listCount() - 1, current_ + page);
    if (keyCode == vk::Home) target = 0;
    if (keyCode == vk::End) target = listCount() - 1;
    if (target == current_ || target < 0 || target >= listCount()) return;
    current_ = target;
    showCurrent();
    notify(Notify::Click);
}

void QtListBox::keyCharDefault(int16_t keyChar) {
    if (keyChar == vk::Space && current_ >= 0) toggle(current_);
}

void QtListBox::clickDefault(QWidget*, QPoint at) {
    model_.announce();
    const QModelIndex index = view()->indexAt(at);
    if (index.isValid()) toggle(index.row());
}

// ---- text fields -------------------------------------------------------------------------

template <class Interface, class Engine>
QtEditOf<Interface, Engine>::QtEditOf(ControlHost& host, const WidgetDesign& d, QWidget* parent)
    : QtWidgetOf<Interface>(host, d, new QLineEdit(parent)) {
    edit()->setContextMenuPolicy(Qt::NoContextMenu);
    edit()->setDragEnabled(false);
    edit()->setAcceptDrops(false);
    edit()->setMaxLength(32767);
    setRoleColor(edit(), QPalette::Base, d.backColor);
    setRoleColor(edit(), QPalette::Text, d.foreColor);
}

template <class Interface, class Engine>
void QtEditOf<Interface, Engine>::show() {
    const QString text = QString::fromStdString(engine_.text());
    if (edit()->text() != text) edit()->setText(text);
    if (engine_.selLength() > 0)
        edit()->setSelection(engine_.selStart(), engine_.selLength());
    else
        edit()->setCursorPosition(engine_.selStart());
}

// The mouse placed the caret or made a selection: the engine takes it over.
template <class Interface, class Engine>
void QtEditOf<Interface, Engine>::afterQtMouse() {
    if (edit()->hasSelectedText()) {
        engine_.setSelStart(edit()->selectionStart());
        engine_.setSelLength(static_cast<int32_t>(edit()->selectedText().size()));
    } else {
        engine_.setSelLength(0);
        engine_.setSelStart(edit()->cursorPosition());
    }
}

QtTextBox::QtTextBox(ControlHost& host, const WidgetDesign& d, QWidget* parent)
    : QtEditOf(host, d, parent), back_(d.backColor) {
    engine_.setText(d.caption);
    show();
}

void QtTextBox::setText(std::string_view text) {
    engine_.setText(text);
    show();
}

void QtTextBox::setSelStart(int32_t v) {
    engine_.setSelStart(v);
    show();
}

void QtTextBox::setSelLength(int32_t v) {
    engine_.setSelLength(v);
    show();
}

void QtTextBox::setBackColor(Color c) {
    back_ = c;
    setRoleColor(widget_, QPalette::Base, c);
}

void QtTextBox::setEnabled(bool v) {
    setEnabledFlag(v);
}
void QtTextBox::setVisible(bool v) {
    setVisibleFlag(v);
}

QtMaskedEdit::QtMaskedEdit(ControlHost& host, const WidgetDesign& d, QWidget* parent)
    : QtEditOf(host, d, parent), back_(d.backColor) {
    engine_.setMask(d.mask);
    show();
}

void QtMaskedEdit::setMask(std::string_view mask) {
    engine_.setMask(mask);
    show();
}

void QtMaskedEdit::setText(std::string_view text) {
    engine_.setText(text);
    show();
}

void QtMaskedEdit::setSelStart(int32_t v) {
    engine_.setSelStart(v);
    show();
}

void QtMaskedEdit::setSelLength(int32_t v) {
    engine_.setSelLength(v);
    show();
}

void QtMaskedEdit::setBackColor(Color c) {
    back_ = c;
    setRoleColor(widget_, QPalette::Base, c);
}

void QtMaskedEdit::setForeColor(Color c) {
    // The text colour shows in every state: a control greys its own text by colour.
    QPalette pal = widget_->palette();
    pal.setColor(QPalette::Text, toQColor(c));
    widget_->setPalette(pal);
}

// ---- button and image --------------------------------------------------------------------

QtCommandButton::QtCommandButton(ControlHost& host, const WidgetDesign& d, QWidget* parent)
    : QtWidgetOf(host, d, new QPushButton(parent)), back_(d.backColor) {
    auto* button = static_cast<QPushButton*>(widget_);
    button->setText(qstr(d.caption));
    button->setAutoFillBackground(true);
    button->setAutoDefault(false);
    setRoleColor(button, QPalette::Button, back_);
    if (!d.picture.empty()) {
        const int w = host.toPixels(d.width) - 4, h = host.toPixels(d.height) - 4;
        button->setIcon(QIcon(picture(d.picture, std::max(w, 8), std::max(h, 8))));
        button->setIconSize(QSize(std::max(w, 8), std::max(h, 8)));
    }
}

void QtCommandButton::setEnabled(bool v) {
    setEnabledFlag(v);
}

void QtCommandButton::setBackColor(Color c) {
    back_ = c;
    setRoleColor(widget_, QPalette::Button, c);
}

void QtCommandButton::setLeft(Twips v) {
    left_ = v;
    applyGeometry();
}

void QtCommandButton::setTop(Twips v) {
    top_ = v;
    applyGeometry();
}

void QtCommandButton::keyCharDefault(int16_t keyChar) {
    if (keyChar == vk::Space) notify(Notify::Click);
}

QtImage::QtImage(ControlHost& host, const WidgetDesign& d, QWidget* parent)
    : QtWidgetOf(host, d, new QLabel(parent)) {
    auto* label = static_cast<QLabel*>(widget_);
    label->setPixmap(picture(d.picture, host.toPixels(d.width), host.toPixels(d.height)));
}

template class QtEditOf<ryx::TextBox, common::LineEdit>;
template class QtEditOf<ryx::MaskedEdit, common::MaskedText>;

}  // namespace ryx::qt
