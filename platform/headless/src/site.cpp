#include "ryx/headless/site.h"

#include "ryx/errors.h"
#include "ryx/headless/form.h"

namespace ryx::headless {
namespace {

// The surface of the control: a focus target of its own whose key and mouse events go to the
// control's surface handler.
WidgetDesign surfaceDesign(const std::string& name) {
    return {.kind = WidgetKind::Frame, .name = name, .inFrame = false};
}

}  // namespace

Site::Site(Form& form, std::string name, Twips width, Twips height)
    : form_(form), name_(std::move(name)), width_(width), height_(height) {
    surface_ = std::make_unique<HImage>(this, surfaceDesign(name_));
    static_cast<HImage&>(*surface_).setHandler([this](Notify what, EventArgs& args) {
        if (!control_) return;
        if (what == Notify::GotFocus)
            control_->GotFocus();
        else if (what == Notify::LostFocus)
            control_->LostFocus();
        else
            control_->SurfaceEvent(what, args);
    });
}

Site::~Site() = default;

void Site::propertyChanged(std::string_view name) {
    notifications_.emplace_back(name);
}

bool Site::userMode() const {
    return form_.userMode();
}

void Site::setSize(Twips width, Twips height) {
    if (width == width_ && height == height_) return;
    width_ = width;
    height_ = height;
    ++resizes_;
    if (control_) control_->Resize();
}

void Site::resizeByHost(Twips width, Twips height) {
    width_ = width;
    height_ = height;
    ++resizes_;
    if (control_) control_->Resize();
}

void Site::raiseEvent(EventId id, EventArgs& args) {
    if (onEvent) onEvent(id, args);
    form_.record({name_, id, args});
}

Keyboard& Site::keyboard() {
    return form_;
}

const Clock& Site::clock() const {
    return form_;
}

template <class W>
W& Site::add(const WidgetDesign& d) {
    auto w = std::make_unique<W>(this, d);
    W& ref = *w;
    children_.push_back(std::move(w));
    return ref;
}

Frame& Site::addFrame(const WidgetDesign& d) {
    HFrame& f = add<HFrame>(d);
    if (!frame_) frame_ = &f;
    return f;
}
Label& Site::addLabel(const WidgetDesign& d) {
    return add<HLabel>(d);
}
CheckBox& Site::addCheckBox(const WidgetDesign& d) {
    return add<HCheckBox>(d);
}
ListBox& Site::addListBox(const WidgetDesign& d) {
    return add<HListBox>(d);
}
TextBox& Site::addTextBox(const WidgetDesign& d) {
    return add<HTextBox>(d);
}
CommandButton& Site::addCommandButton(const WidgetDesign& d) {
    return add<HCommandButton>(d);
}
Image& Site::addImage(const WidgetDesign& d) {
    return add<HImage>(d);
}
MaskedEdit& Site::addMaskedEdit(const WidgetDesign& d) {
    return add<HMaskedEdit>(d);
}

RecordSource& Site::addRecordSource(const DataSourceDesign& d) {
    recordSource_ = form_.makeRecordSource(d);
    return *recordSource_;
}

Node& Site::node(std::string_view name, int16_t index) const {
    for (const auto& n : children_)
        if (n->name() == name && n->index() == index) return *n;
    std::string shown(name);
    if (index >= 0) shown += "(" + std::to_string(index) + ")";
    throw IndexError(name_ + " has no child widget " + shown);
}

void Site::clearRecords() {
    notifications_.clear();
    repaints_ = 0;
    resizes_ = 0;
}

bool Site::inputReaches(const Node& n) const {
    if (!surfaceEnabled_) return false;
    if (&n == surface_.get()) return true;
    if (!n.isEnabled() || !n.isVisible()) return false;
    if (n.inFrame() && frame_ && frame_ != &n && !frame_->isEnabled()) return false;
    return true;
}

}  // namespace ryx::headless
