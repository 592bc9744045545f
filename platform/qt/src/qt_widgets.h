// The Qt widgets behind the controls' children. Each adapter does only what a toolkit does:
// store and show state, and report input to the control's handler through the host.
#pragma once

#include <QAbstractListModel>
#include <QCheckBox>
#include <QGroupBox>
#include <QLabel>
#include <QLineEdit>
#include <QListView>
#include <QPushButton>
#include <string>
#include <vector>

#include "ryx/common/line_edit.h"
#include "ryx/common/list_rows.h"
#include "ryx/common/masked_text.h"
#include "ryx/host.h"

namespace ryx::qt {

class ControlHost;

QColor toQColor(Color c);
// Sets a colour role for the active and inactive states, leaving the disabled look alone.
void setRoleColor(QWidget* w, QPalette::ColorRole role, Color c);
QFont toQFont(const Font& f);

// What the host knows of every child, whatever its kind.
class QtNode {
  public:
    QtNode(ControlHost& host, const WidgetDesign& d, QWidget* widget);
    virtual ~QtNode() = default;

    QWidget* widget() const { return widget_; }
    const std::string& name() const { return name_; }
    int16_t index() const { return index_; }
    bool inFrame() const { return inFrame_; }
    int tabIndex() const { return tabIndex_; }
    bool isEnabledFlag() const { return enabled_; }
    bool isVisibleFlag() const { return visible_; }
    std::string displayName() const;

    void notify(Notify what, EventArgs& args);
    void notify(Notify what);

    virtual bool takesFocus() const { return false; }
    virtual Qt::FocusPolicy focusPolicy() const { return Qt::NoFocus; }
    // The widget's own reaction to a key, after the handler has seen it.
    virtual void keyDownDefault(int16_t keyCode, int16_t shift) {
        (void)keyCode;
        (void)shift;
    }
    virtual void keyCharDefault(int16_t keyChar) { (void)keyChar; }
    // A click (press and release on the widget) at a point of `on` (the widget or its viewport).
    virtual void clickDefault(QWidget* on, QPoint at) {
        (void)on;
        (void)at;
        notify(Notify::Click);
    }
    // Text fields let Qt place the caret with the mouse, then read it back.
    virtual bool qtHandlesMouse() const { return false; }
    virtual void afterQtMouse() {}

  protected:
    void storeHandler(NotifyHandler h) { handler_ = std::move(h); }
    void applyGeometry();
    void setEnabledFlag(bool v);
    void setVisibleFlag(bool v);
    void focusByCode();

    ControlHost& host_;
    QWidget* widget_;
    std::string name_;
    int16_t index_;
    bool inFrame_;
    int tabIndex_;
    bool enabled_ = true;
    bool visible_ = true;
    Twips left_, top_, width_, height_;

  private:
    NotifyHandler handler_;
};

template <class Interface>
class QtWidgetOf : public Interface, public QtNode {
  public:
    using QtNode::QtNode;
    void setHandler(NotifyHandler h) override { storeHandler(std::move(h)); }
};

// A group box whose access letter reaches the control rather than focusing a child.
class QtFrameBox : public QGroupBox {
  public:
    QtFrameBox(ControlHost& host, QWidget* parent) : QGroupBox(parent), host_(host) {}

  protected:
    bool event(QEvent* e) override;

  private:
    ControlHost& host_;
};

class QtFrame : public QtWidgetOf<ryx::Frame> {
  public:
    QtFrame(ControlHost& host, const WidgetDesign& d, QtFrameBox* box);
    std::string caption() const override { return caption_; }
    void setCaption(std::string_view text) override;
    Color backColor() const override { return back_; }
    void setBackColor(Color c) override;
    Color foreColor() const override { return fore_; }
    void setForeColor(Color c) override;
    void setEnabled(bool v) override;
    Twips width() const override { return width_; }
    void setWidth(Twips w) override;
    void setHeight(Twips h) override;

  private:
    void paintTitle();
    std::string caption_;
    Color back_, fore_;
};

class QtLabel : public QtWidgetOf<ryx::Label> {
  public:
    QtLabel(ControlHost& host, const WidgetDesign& d, QWidget* parent);
    std::string caption() const override { return caption_; }
    void setCaption(std::string_view text) override;
    void setEnabled(bool v) override;
    void setVisible(bool v) override;

  private:
    std::string caption_;
};

class QtCheckBox : public QtWidgetOf<ryx::CheckBox> {
  public:
    QtCheckBox(ControlHost& host, const WidgetDesign& d, QWidget* parent);
    int16_t value() const override { return value_; }
    void setValue(int16_t v) override;
    void setBackColor(Color c) override;
    void setEnabled(bool v) override;

    bool takesFocus() const override { return true; }
    Qt::FocusPolicy focusPolicy() const override { return Qt::StrongFocus; }
    void keyCharDefault(int16_t keyChar) override;
    void clickDefault(QWidget* on, QPoint at) override;

  private:
    QCheckBox* box() const { return static_cast<QCheckBox*>(widget_); }
    int16_t value_ = 0;
};

// The rows of a list, with a selected flag each. The view draws a selected row highlighted;
// the flags live here, so selecting a million rows is one pass over a byte vector, and the
// view asks for the texts of the rows it shows only.
class RowsModel : public QAbstractListModel {
  public:
    int rowCount(const QModelIndex& parent = {}) const override;
    QVariant data(const QModelIndex& index, int role) const override;

    int32_t count() const { return rows_.count(); }
    std::string row(int32_t i) const { return rows_.text(i); }
    bool isSelected(int32_t i) const { return rows_.selected(i); }
    std::span<const uint8_t> flags() const { return rows_.flags(); }
    bool setSelected(int32_t first, int32_t last, bool v);  // true when a flag changed
    void clear();
    void append(std::string_view text);
    void append(int32_t count, ListBox::RowText text);
    // Tells the view about rows appended since the last announcement.
    void announce();

  private:
    void announceLater();

    common::ListRows rows_;
    int announced_ = 0;
    bool announceScheduled_ = false;
};

class QtListBox : public QtWidgetOf<ryx::ListBox> {
  public:
    QtListBox(ControlHost& host, const WidgetDesign& d, QWidget* parent);
    void clear() override;
    void addItem(std::string_view text) override;
    int32_t listCount() const override { return model_.count(); }
    std::string list(int32_t row) const override;
    bool selected(int32_t row) const override;
    void setSelected(int32_t row, bool v) override;
    void setSelectedRange(int32_t first, int32_t last, bool v) override;
    void setListIndex(int32_t row) override;
    std::span<const uint8_t> selectedFlags() const override { return model_.flags(); }
    void addRows(int32_t count, RowText text) override { model_.append(count, std::move(text)); }
    Color backColor() const override { return back_; }
    void setBackColor(Color c) override;
    Color foreColor() const override { return fore_; }
    void setWidth(Twips w) override;
    void setHeight(Twips h) override;
    void setEnabled(bool v) override;
    void refresh() override;
    void setFocus() override { focusByCode(); }

    int32_t listIndex() const { return current_; }
    QListView* view() const { return static_cast<QListView*>(widget_); }

    bool takesFocus() const override { return true; }
    Qt::FocusPolicy focusPolicy() const override { return Qt::StrongFocus; }
    void keyDownDefault(int16_t keyCode, int16_t shift) override;
    void keyCharDefault(int16_t keyChar) override;
    void clickDefault(QWidget* on, QPoint at) override;

  private:
    void checkRow(int32_t row, const char* what) const;
    void toggle(int32_t row);
    void showCurrent();

    RowsModel model_;
    int32_t current_ = -1;
    Color back_, fore_;
};

// A QLineEdit that shows the state of one of the shared editing engines. Keys are applied to
// the engine, never to the QLineEdit itself, so typing behaves as on every other platform.
template <class Interface, class Engine>
class QtEditOf : public QtWidgetOf<Interface> {
  public:
    QtEditOf(ControlHost& host, const WidgetDesign& d, QWidget* parent);

    bool takesFocus() const override { return true; }
    Qt::FocusPolicy focusPolicy() const override { return Qt::StrongFocus; }
    void keyDownDefault(int16_t keyCode, int16_t shift) override {
        engine_.keyDown(keyCode, shift);
        show();
    }
    void keyCharDefault(int16_t keyChar) override {
        engine_.keyChar(keyChar);
        show();
    }
    bool qtHandlesMouse() const override { return true; }
    void afterQtMouse() override;

  protected:
    QLineEdit* edit() const { return static_cast<QLineEdit*>(this->widget_); }
    void show();
    Engine engine_;
};

class QtTextBox : public QtEditOf<ryx::TextBox, common::LineEdit> {
  public:
    QtTextBox(ControlHost& host, const WidgetDesign& d, QWidget* parent);
    std::string text() const override { return engine_.text(); }
    void setText(std::string_view text) override;
    int32_t selStart() const override { return engine_.selStart(); }
    void setSelStart(int32_t v) override;
    int32_t selLength() const override { return engine_.selLength(); }
    void setSelLength(int32_t v) override;
    int32_t maxLength() const override { return engine_.maxLength(); }
    void setMaxLength(int32_t v) override { engine_.setMaxLength(v); }
    Color backColor() const override { return back_; }
    void setBackColor(Color c) override;
    void setEnabled(bool v) override;
    void setVisible(bool v) override;
    void setFocus() override { focusByCode(); }

  private:
    Color back_;
};

class QtMaskedEdit : public QtEditOf<ryx::MaskedEdit, common::MaskedText> {
  public:
    QtMaskedEdit(ControlHost& host, const WidgetDesign& d, QWidget* parent);
    void setMask(std::string_view mask) override;
    std::string text() const override { return engine_.text(); }
    void setText(std::string_view text) override;
    int32_t selStart() const override { return engine_.selStart(); }
    void setSelStart(int32_t v) override;
    int32_t selLength() const override { return engine_.selLength(); }
    void setSelLength(int32_t v) override;
    Color backColor() const override { return back_; }
    void setBackColor(Color c) override;
    void setForeColor(Color c) override;

  private:
    Color back_;
};

class QtCommandButton : public QtWidgetOf<ryx::CommandButton> {
  public:
    QtCommandButton(ControlHost& host, const WidgetDesign& d, QWidget* parent);
    bool visible() const override { return visible_; }
    void setVisible(bool v) override { setVisibleFlag(v); }
    void setEnabled(bool v) override;
    Color backColor() const override { return back_; }
    void setBackColor(Color c) override;
    Twips left() const override { return left_; }
    void setLeft(Twips v) override;
    Twips top() const override { return top_; }
    void setTop(Twips v) override;
    Twips width() const override { return width_; }

    bool takesFocus() const override { return true; }
    Qt::FocusPolicy focusPolicy() const override { return Qt::StrongFocus; }
    void keyCharDefault(int16_t keyChar) override;

  private:
    Color back_;
};

class QtImage : public QtWidgetOf<ryx::Image> {
  public:
    QtImage(ControlHost& host, const WidgetDesign& d, QWidget* parent);
    bool visible() const override { return visible_; }
    void setVisible(bool v) override { setVisibleFlag(v); }
};

}  // namespace ryx::qt
