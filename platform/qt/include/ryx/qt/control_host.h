// The Qt home of one control: a QWidget that is the control's surface and its container. It
// builds the control's children as real Qt widgets, delivers keys, mouse and focus to the
// control's handlers, and turns the control's events into Qt signals.
#pragma once

#include <QWidget>
#include <functional>
#include <memory>
#include <vector>

#include "ryx/host.h"
#include "ryx/qt/keyboard.h"

namespace ryx::qt {

class QtNode;
class QtFrameBox;

using RecordSourceFactory = std::function<std::unique_ptr<RecordSource>(const DataSourceDesign&)>;

class ControlHost : public QWidget, public ryx::Container {
    Q_OBJECT
  public:
    explicit ControlHost(QWidget* parent = nullptr);
    ~ControlHost() override;

    ryx::HostedControl& hostedControl() const { return *control_; }

    // Design mode (false) or run mode (true, the default).
    void setUserMode(bool run) { userMode_ = run; }
    // The data source the agency control reads; set before the control is created.
    static void setRecordSourceFactory(RecordSourceFactory factory);

    // Container services.
    void propertyChanged(std::string_view name) override;
    bool userMode() const override { return userMode_; }
    Twips width() const override { return widthTwips_; }
    Twips height() const override { return heightTwips_; }
    void setSize(Twips width, Twips height) override;
    void setSurfaceEnabled(bool v) override;
    void setSurfaceBackColor(Color c) override;
    const Font& font() const override;
    void repaint() override;
    void raiseEvent(EventId id, EventArgs& args) override;
    ryx::Keyboard& keyboard() override { return QtKeyboard::instance(); }
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

    // The Qt widget of a child, by its design name and index (for tests and hosts).
    QWidget* childWidget(std::string_view name, int16_t index = -1) const;

    // Twips and pixels at this screen's logical dpi (15 twips a pixel at 96 dpi).
    int toPixels(Twips t) const;
    Twips toTwips(int px) const;

    // Whether input may reach a child: not locked, and not inside a disabled frame.
    bool inputBlocked(const QtNode& n) const;
    bool canTakeFocus(const QtNode& n) const;
    void updateFocusPolicies();
    // The frame's access letter was pressed.
    void accessKeyPressed(int16_t keyChar);

    QSize sizeHint() const override;

  signals:
    // One signal per event, with the arguments by reference: a handler connected directly
    // may change them, and the control goes on with the changed values.
    void Click(ryx::EventArgs& args);
    void DblClick(ryx::EventArgs& args);
    void Change(ryx::EventArgs& args);
    void KeyDown(ryx::EventArgs& args);
    void KeyPress(ryx::EventArgs& args);
    void KeyUp(ryx::EventArgs& args);
    void MouseDown(ryx::EventArgs& args);
    void MouseMove(ryx::EventArgs& args);
    void MouseUp(ryx::EventArgs& args);
    void ButtonClick(ryx::EventArgs& args);  // number 10: ButtonClick, or FillList
    void eventRaised(int id, ryx::EventArgs& args);
    void propertyChangedNamed(const QString& name);

  protected:
    void setInitialSize(Twips width, Twips height);
    // Orders the children's focus chain by the tab indexes of the design.
    void applyTabOrder();
    void attachControl(std::unique_ptr<HostedControl> control);
    bool eventFilter(QObject* watched, QEvent* event) override;
    void resizeEvent(QResizeEvent* e) override;
    void focusInEvent(QFocusEvent* e) override;
    void focusOutEvent(QFocusEvent* e) override;
    void keyPressEvent(QKeyEvent* e) override;
    void keyReleaseEvent(QKeyEvent* e) override;
    void mousePressEvent(QMouseEvent* e) override;
    void mouseMoveEvent(QMouseEvent* e) override;
    void mouseReleaseEvent(QMouseEvent* e) override;

  private:
    template <class W, class... Args>
    W& add(const WidgetDesign& d, Args&&... args);
    QWidget* parentFor(const WidgetDesign& d);
    QtNode* nodeOf(QObject* o) const;
    bool filterKey(QtNode& n, QKeyEvent* e);
    bool filterMouse(QtNode& n, QObject* watched, QMouseEvent* e);
    void filterFocusIn(QtNode& n, QFocusEvent* e);
    void surfaceEvent(Notify what, EventArgs& args);
    void focusChanged(QWidget* old, QWidget* now);
    EventArgs mouseArgs(const QMouseEvent* e) const;

    std::vector<std::unique_ptr<QtNode>> nodes_;
    QtFrameBox* frame_ = nullptr;
    std::unique_ptr<RecordSource> recordSource_;
    std::unique_ptr<HostedControl> control_;
    bool userMode_ = true;
    bool surfaceEnabled_ = true;
    bool focusInside_ = false;
    bool applyingSize_ = false;
    Twips widthTwips_ = 0;
    Twips heightTwips_ = 0;
    QObject* mousePressedOn_ = nullptr;
};

// A control in its Qt widget. Construction places a new instance as a designer does
// (InitProperties and the size rule) unless told that saved properties will follow.
template <class C>
class ControlWidget : public ControlHost {
  public:
    ControlWidget(QWidget* parent, Twips width, Twips height, bool newInstance = true)
        : ControlHost(parent) {
        setInitialSize(width, height);
        auto control = std::make_unique<C>(static_cast<Container&>(*this));
        control_ = control.get();
        attachControl(std::move(control));
        applyTabOrder();
        if (newInstance) {
            control_->InitProperties();
            control_->Resize();
        }
    }
    C& control() const { return *control_; }

  private:
    C* control_;
};

}  // namespace ryx::qt
