// The place of one control on a headless form: the container the control talks to, the owner
// of its child widgets, and a record of what the control told its host.
#pragma once

#include <functional>
#include <memory>
#include <string>
#include <vector>

#include "ryx/headless/widgets.h"
#include "ryx/host.h"

namespace ryx::headless {

class Form;

// An event that a control raised, with its arguments as the host's handler left them.
struct RaisedEvent {
    std::string control;
    EventId id;
    EventArgs args;
};

class Site : public Container {
  public:
    Site(Form& form, std::string name, Twips width, Twips height);
    ~Site() override;

    const std::string& name() const { return name_; }
    Form& form() const { return form_; }
    HostedControl& control() const { return *control_; }
    void attach(std::unique_ptr<HostedControl> control) { control_ = std::move(control); }

    // The host's handler of the control's events; it may change the arguments.
    std::function<void(EventId, EventArgs&)> onEvent;

    // Container services.
    void propertyChanged(std::string_view name) override;
    bool userMode() const override;
    Twips width() const override { return width_; }
    Twips height() const override { return height_; }
    void setSize(Twips width, Twips height) override;
    void setSurfaceEnabled(bool v) override { surfaceEnabled_ = v; }
    void setSurfaceBackColor(Color c) override { surfaceBack_ = c; }
    const Font& font() const override { return font_; }
    void repaint() override { ++repaints_; }
    void raiseEvent(EventId id, EventArgs& args) override;
    Keyboard& keyboard() override;
    const Clock& clock() const override;

    Frame& addFrame(const WidgetDesign& d) override;
    Label& addLabel(const WidgetDesign& d) override;
    CheckBox& addCheckBox(const WidgetDesign& d) override;
    ListBox& addListBox(const WidgetDesign& d) override;
    TextBox& addTextBox(const WidgetDesign& d) override;
    CommandButton& addCommandButton(const WidgetDesign& d) override;
    Image& addImage(const WidgetDesign& d) override;
    MaskedEdit& addMaskedEdit(const WidgetDesign& d) override;
    RecordSource& addRecordSource(const DataSourceDesign& d) override;

    // Read-outs for tests and for the form.
    template <class W>
    W& child(std::string_view name, int16_t index = -1) const {
        return dynamic_cast<W&>(node(name, index));
    }
    Node& node(std::string_view name, int16_t index = -1) const;
    const std::vector<std::unique_ptr<Node>>& children() const { return children_; }
    HFrame* frame() const { return frame_; }
    RecordSource* recordSource() const { return recordSource_.get(); }
    Node& surface() { return *surface_; }

    bool surfaceEnabled() const { return surfaceEnabled_; }
    Color surfaceBackColor() const { return surfaceBack_; }
    int repaints() const { return repaints_; }
    int resizes() const { return resizes_; }
    const std::vector<std::string>& notifications() const { return notifications_; }
    void clearRecords();

    // Whether user input can reach this widget now: visible and enabled, inside an enabled
    // frame, on an enabled (not locked) surface.
    bool inputReaches(const Node& n) const;

    // Sets the size as the host does, raising Resize when it changes.
    void resizeByHost(Twips width, Twips height);

  private:
    template <class W>
    W& add(const WidgetDesign& d);

    Form& form_;
    std::string name_;
    Twips width_, height_;
    bool surfaceEnabled_ = true;
    Color surfaceBack_ = 0x00C0C0FF;
    Font font_;
    int repaints_ = 0;
    int resizes_ = 0;
    std::vector<std::string> notifications_;
    std::vector<std::unique_ptr<Node>> children_;
    HFrame* frame_ = nullptr;
    std::unique_ptr<Node> surface_;
    std::unique_ptr<RecordSource> recordSource_;
    std::unique_ptr<HostedControl> control_;
};

}  // namespace ryx::headless
