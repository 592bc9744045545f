// A headless host form: controls and plain widgets in one tab order, focus, the keyboard with
// its injection queue, the user's actions, design or run mode, and records for tests.
//
// User actions are made the way a person makes them: a click goes to a widget only when input
// can reach it, keys go to the focused widget (KeyDown, KeyPress, KeyUp), Tab and Shift+Tab
// move the focus along the tab order, and keys that a handler injects arrive after the key
// being handled, in order.
#pragma once

#include <deque>
#include <functional>
#include <memory>
#include <optional>
#include <string>
#include <vector>

#include "ryx/common/key_notation.h"
#include "ryx/headless/site.h"
#include "ryx/headless/widgets.h"
#include "ryx/host.h"

namespace ryx::headless {

using RecordSourceFactory = std::function<std::unique_ptr<RecordSource>(const DataSourceDesign&)>;

class Form : public Keyboard, public Clock {
  public:
    Form();
    ~Form() override;
    Form(const Form&) = delete;
    Form& operator=(const Form&) = delete;

    // Places a control as the designer does for a new instance: Initialize, InitProperties,
    // then a Resize at the given size.
    template <class C>
    C& add(std::string name, Twips width = 3000, Twips height = 1800) {
        Site& s = newSite(std::move(name), width, height);
        auto control = std::make_unique<C>(s);
        C& ref = *control;
        s.attach(std::move(control));
        ref.InitProperties();
        s.resizeByHost(width, height);
        return ref;
    }
    // Places a control of a type known by name ("RYXPolicyStatus"), Initialize only; the
    // caller goes on with InitProperties or ReadProperties. Null for an unknown type.
    HostedControl* create(std::string_view type, std::string name, Twips width = 3000,
                          Twips height = 1800);

    // A plain text box or button of the host form itself, in the tab order after what is
    // placed so far (to see where focus goes before and after a control).
    HTextBox& addTextBox(std::string name);
    HCommandButton& addButton(std::string name);

    Site& site(std::string_view name) const;
    Site* findSite(std::string_view name) const;
    const std::vector<std::unique_ptr<Site>>& sites() const { return sites_; }
    Site& siteOf(const HostedControl& control) const;

    // Design mode (the form designer) or run mode (the application).
    bool userMode() const { return userMode_; }
    void setUserMode(bool run) { userMode_ = run; }

    // Today's date as the clock gives it; fixed for tests, the system date otherwise.
    CivilDate today() const override;
    void setToday(CivilDate d) { fixedToday_ = d; }

    void setRecordSourceFactory(RecordSourceFactory f) { recordSources_ = std::move(f); }
    std::unique_ptr<RecordSource> makeRecordSource(const DataSourceDesign& d) const;

    // Focus.
    Node* focused() const { return focused_; }
    void setFocus(Node& target);  // as a click would; WidgetError if it cannot take focus
    bool canTakeFocus(const Node& n) const;
    // The host gives the focus to a control as a whole (its surface): the control's GotFocus
    // runs and may pass the focus on to a child; if it does not, the surface keeps it and
    // keys go to the control's surface handlers.
    void focusControl(Site& s);
    // Tab and Shift+Tab. Focus that enters a control along the tab order reaches the control
    // as a whole first (its GotFocus) and then the child that the tab order names, unless
    // GotFocus passed it elsewhere. A click or a child's own focus request goes straight to
    // the child.
    void tab();
    void shiftTab();

    // The user's actions. Each ends by delivering the injected keys.
    void click(Node& target);
    void doubleClick(Node& target);
    void clickRow(HListBox& list, int32_t row);
    void mouseDown(Node& target, int16_t button, int16_t shift, float x, float y);
    void mouseMove(Node& target, int16_t button, int16_t shift, float x, float y);
    void mouseUp(Node& target, int16_t button, int16_t shift, float x, float y);
    // A key on the focused widget, with Shift/Ctrl/Alt bits; Alt+letter also reaches the
    // control whose access keys hold the letter.
    void press(int16_t keyCode, int16_t shift = 0);
    // Types each character of a UTF-8 text on the focused widget.
    void type(std::string_view text);
    // Keys in the injection notation ("{TAB}", "+{TAB}", "15/"), as the user would type them.
    void keys(std::string_view notation);
    // The host passes an access key to a control (Alt+letter, or Enter as an access key).
    void accessKey(Site& s, int16_t keyChar);
    // Delivers keys injected by code outside any user action.
    void deliverInjected();

    // The Insert key's toggle, as the key-state query reports it.
    void setInsertToggle(bool on) { insertOn_ = on; }

    // Keyboard services for the controls.
    void injectKeys(std::string_view keys) override;
    int16_t keyState(int16_t virtualKey) const override;
    int16_t upperCase(int16_t keyChar) const override;

    // Records: the events raised by every control, in order.
    const std::vector<RaisedEvent>& events() const { return events_; }
    void clearEvents() { events_.clear(); }
    void record(RaisedEvent e) { events_.push_back(std::move(e)); }

  private:
    friend class Site;
    Site& newSite(std::string name, Twips width, Twips height);
    std::vector<Node*> tabStops() const;
    void moveFocus(Node* target, bool enterControl);
    void moveFocusBy(int step);
    void deliverKey(const common::KeyStroke& k);
    void routeAccessKey(int16_t keyCode);
    bool inputReaches(const Node& n) const;
    void mouse(Node& target, Notify what, int16_t button, int16_t shift, float x, float y);

    struct Entry {
        Site* site = nullptr;
        Node* plain = nullptr;
    };
    std::vector<std::unique_ptr<Site>> sites_;
    std::vector<std::unique_ptr<Node>> plain_;
    std::vector<Entry> order_;
    Node* focused_ = nullptr;
    bool userMode_ = true;
    bool insertOn_ = false;
    std::optional<CivilDate> fixedToday_;
    RecordSourceFactory recordSources_;
    std::deque<common::KeyStroke> injected_;
    bool delivering_ = false;
    std::vector<RaisedEvent> events_;
};

}  // namespace ryx::headless
