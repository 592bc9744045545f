// The headless widgets: in-memory models of the host's standard widgets with the behaviour
// the controls rely on, plus read-outs (enabled, visible, colours, repaints) for tests.
#pragma once

#include <cstdint>
#include <string>
#include <vector>

#include "ryx/common/line_edit.h"
#include "ryx/common/list_rows.h"
#include "ryx/common/masked_text.h"
#include "ryx/host.h"

namespace ryx::headless {

class Site;

// What the form knows of every widget, whatever its kind: where it is, whether it takes
// input and focus, and where its notifications go.
class Node {
  public:
    Node(Site* site, const WidgetDesign& d);
    virtual ~Node() = default;
    Node(const Node&) = delete;
    Node& operator=(const Node&) = delete;

    const std::string& name() const { return name_; }
    int16_t index() const { return index_; }
    WidgetKind kind() const { return kind_; }
    Site* site() const { return site_; }  // null for a widget of the form itself
    int tabIndex() const { return tabIndex_; }
    bool inFrame() const { return inFrame_; }
    // "RYXT(1)", "ChkAll": the name as tests and messages show it.
    std::string displayName() const;

    bool isEnabled() const { return enabled_; }
    bool isVisible() const { return visible_; }
    Twips leftPos() const { return left_; }
    Twips topPos() const { return top_; }
    Twips widthSize() const { return width_; }
    Twips heightSize() const { return height_; }
    int repaints() const { return repaints_; }

    // Sends a notification to the control's handler, if one is wired.
    void notify(Notify what, EventArgs& args);
    void notify(Notify what);

    // The widget's own reaction to input, after the handler has seen it.
    virtual bool takesFocus() const { return false; }
    virtual void keyDownDefault(int16_t keyCode, int16_t shift) {
        (void)keyCode;
        (void)shift;
    }
    virtual void keyCharDefault(int16_t keyChar) { (void)keyChar; }
    virtual void clickDefault() { notify(Notify::Click); }

  protected:
    void storeHandler(NotifyHandler h) { handler_ = std::move(h); }
    // Focus requested by the control's code: a WidgetError when the widget cannot take it.
    void focusByCode();

    Site* site_;
    std::string name_;
    int16_t index_;
    WidgetKind kind_;
    int tabIndex_;
    bool inFrame_;
    bool enabled_ = true;
    bool visible_ = true;
    Twips left_, top_, width_, height_;
    int repaints_ = 0;

  private:
    NotifyHandler handler_;
};

template <class Interface>
class WidgetOf : public Interface, public Node {
  public:
    using Node::Node;
    void setHandler(NotifyHandler h) override { storeHandler(std::move(h)); }
};

class HFrame : public WidgetOf<ryx::Frame> {
  public:
    HFrame(Site* site, const WidgetDesign& d);
    std::string caption() const override { return caption_; }
    void setCaption(std::string_view text) override { caption_ = text; }
    Color backColor() const override { return back_; }
    void setBackColor(Color c) override { back_ = c; }
    Color foreColor() const override { return fore_; }
    void setForeColor(Color c) override { fore_ = c; }
    void setEnabled(bool v) override { enabled_ = v; }
    Twips width() const override { return width_; }
    void setWidth(Twips w) override { width_ = w; }
    void setHeight(Twips h) override { height_ = h; }

  private:
    std::string caption_;
    Color back_, fore_;
};

class HLabel : public WidgetOf<ryx::Label> {
  public:
    HLabel(Site* site, const WidgetDesign& d);
    std::string caption() const override { return caption_; }
    void setCaption(std::string_view text) override { caption_ = text; }
    void setEnabled(bool v) override { enabled_ = v; }
    void setVisible(bool v) override { visible_ = v; }
    Color backColor() const { return back_; }

  private:
    std::string caption_;
    Color back_;
};

class HCheckBox : public WidgetOf<ryx::CheckBox> {
  public:
    HCheckBox(Site* site, const WidgetDesign& d);
    int16_t value() const override { return value_; }
    void setValue(int16_t v) override;
    void setBackColor(Color c) override { back_ = c; }
    void setEnabled(bool v) override { enabled_ = v; }
    Color backColor() const { return back_; }
    const std::string& caption() const { return caption_; }

    bool takesFocus() const override { return true; }
    void keyCharDefault(int16_t keyChar) override;  // the space bar toggles
    void clickDefault() override;                   // a click toggles

  private:
    std::string caption_;
    int16_t value_ = 0;
    Color back_;
};

class HListBox : public WidgetOf<ryx::ListBox> {
  public:
    HListBox(Site* site, const WidgetDesign& d);
    void clear() override;
    void addItem(std::string_view text) override;
    int32_t listCount() const override { return rows_.count(); }
    std::string list(int32_t row) const override;
    bool selected(int32_t row) const override;
    void setSelected(int32_t row, bool v) override;
    void setSelectedRange(int32_t first, int32_t last, bool v) override;
    void setListIndex(int32_t row) override;
    std::span<const uint8_t> selectedFlags() const override { return rows_.flags(); }
    void addRows(int32_t count, RowText text) override { rows_.add(count, std::move(text)); }
    Color backColor() const override { return back_; }
    void setBackColor(Color c) override { back_ = c; }
    Color foreColor() const override { return fore_; }
    void setWidth(Twips w) override { width_ = w; }
    void setHeight(Twips h) override { height_ = h; }
    void setEnabled(bool v) override { enabled_ = v; }
    void refresh() override { ++repaints_; }
    void setFocus() override { focusByCode(); }

    int32_t listIndex() const { return current_; }
    int32_t selCount() const;

    bool takesFocus() const override { return true; }
    // A user click on a row toggles it and makes it current: one Click.
    void clickRow(int32_t row);
    void keyDownDefault(int16_t keyCode, int16_t shift) override;  // arrows move the current row
    void keyCharDefault(int16_t keyChar) override;                 // space toggles it

  private:
    void checkRow(int32_t row, const char* what) const;

    common::ListRows rows_;
    int32_t current_ = -1;
    Color back_, fore_;
};

class HTextBox : public WidgetOf<ryx::TextBox> {
  public:
    HTextBox(Site* site, const WidgetDesign& d);
    std::string text() const override { return edit_.text(); }
    void setText(std::string_view text) override { edit_.setText(text); }
    int32_t selStart() const override { return edit_.selStart(); }
    void setSelStart(int32_t v) override { edit_.setSelStart(v); }
    int32_t selLength() const override { return edit_.selLength(); }
    void setSelLength(int32_t v) override { edit_.setSelLength(v); }
    int32_t maxLength() const override { return edit_.maxLength(); }
    void setMaxLength(int32_t v) override { edit_.setMaxLength(v); }
    Color backColor() const override { return back_; }
    void setBackColor(Color c) override { back_ = c; }
    void setEnabled(bool v) override { enabled_ = v; }
    void setVisible(bool v) override { visible_ = v; }
    void setFocus() override { focusByCode(); }

    bool takesFocus() const override { return true; }
    void keyDownDefault(int16_t keyCode, int16_t shift) override { edit_.keyDown(keyCode, shift); }
    void keyCharDefault(int16_t keyChar) override { edit_.keyChar(keyChar); }

  private:
    common::LineEdit edit_;
    Color back_;
};

class HCommandButton : public WidgetOf<ryx::CommandButton> {
  public:
    HCommandButton(Site* site, const WidgetDesign& d);
    bool visible() const override { return visible_; }
    void setVisible(bool v) override { visible_ = v; }
    void setEnabled(bool v) override { enabled_ = v; }
    Color backColor() const override { return back_; }
    void setBackColor(Color c) override { back_ = c; }
    Twips left() const override { return left_; }
    void setLeft(Twips v) override { left_ = v; }
    Twips top() const override { return top_; }
    void setTop(Twips v) override { top_ = v; }
    Twips width() const override { return width_; }
    const std::string& caption() const { return caption_; }
    const std::string& toolTip() const { return toolTip_; }

    bool takesFocus() const override { return true; }
    void keyCharDefault(int16_t keyChar) override;  // the space bar presses the button

  private:
    std::string caption_, toolTip_;
    Color back_;
};

class HImage : public WidgetOf<ryx::Image> {
  public:
    using WidgetOf::WidgetOf;
    bool visible() const override { return visible_; }
    void setVisible(bool v) override { visible_ = v; }
};

class HMaskedEdit : public WidgetOf<ryx::MaskedEdit> {
  public:
    HMaskedEdit(Site* site, const WidgetDesign& d);
    void setMask(std::string_view mask) override { edit_.setMask(mask); }
    std::string text() const override { return edit_.text(); }
    void setText(std::string_view text) override { edit_.setText(text); }
    int32_t selStart() const override { return edit_.selStart(); }
    void setSelStart(int32_t v) override { edit_.setSelStart(v); }
    int32_t selLength() const override { return edit_.selLength(); }
    void setSelLength(int32_t v) override { edit_.setSelLength(v); }
    Color backColor() const override { return back_; }
    void setBackColor(Color c) override { back_ = c; }
    void setForeColor(Color c) override { fore_ = c; }
    Color foreColor() const { return fore_; }
    std::string mask() const { return edit_.mask(); }

    bool takesFocus() const override { return true; }
    void keyDownDefault(int16_t keyCode, int16_t shift) override { edit_.keyDown(keyCode, shift); }
    void keyCharDefault(int16_t keyChar) override { edit_.keyChar(keyChar); }

  private:
    common::MaskedText edit_;
    Color back_, fore_;
};

}  // namespace ryx::headless
