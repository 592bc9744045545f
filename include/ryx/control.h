// What the four controls share: the enabled and locked flags, the relay of child events to
// the host, keyboard navigation by key injection, re-entrancy guards and the loading of
// saved properties key by key.
#pragma once

#include <cstdint>
#include <string_view>

#include "ryx/errors.h"
#include "ryx/host.h"
#include "ryx/property_bag.h"

namespace ryx {

// Holds a guard flag set for the life of a scope. The flag is cleared on every way out,
// an exception from a widget or from the host's event handler included, so a control can
// never be left frozen by a guard that stayed set.
class GuardScope {
  public:
    explicit GuardScope(bool& flag) : flag_(flag) { flag_ = true; }
    ~GuardScope() { flag_ = false; }
    GuardScope(const GuardScope&) = delete;
    GuardScope& operator=(const GuardScope&) = delete;

  private:
    bool& flag_;
};

// Reads saved properties one key at a time. A failure while reading or applying one key
// leaves that property as it was, and loading goes on with the next key.
class PropertyLoader {
  public:
    explicit PropertyLoader(const PropertyBag& bag) : bag_(bag) {}

    // Calls apply with the value saved under key, or def when the form has none.
    template <class Apply>
    void key(std::string_view name, const Variant& def, Apply&& apply) {
        try {
            apply(bag_.readProperty(name, def));
        } catch (const Error&) {
        }
    }

    // A loading step that reads no key.
    template <class Step>
    void step(Step&& run) {
        try {
            run();
        } catch (const Error&) {
        }
    }

  private:
    const PropertyBag& bag_;
};

// The event raised for a child notification of the same name (none for focus changes).
bool eventFor(Notify what, EventId& id);

class Control : public HostedControl {
  public:
    Control(const Control&) = delete;
    Control& operator=(const Control&) = delete;

    // Stores the flag and sets the enabled state of the frame and of the children that the
    // control lists; notifies "Enabled".
    bool Enabled() const { return enabled_; }
    void setEnabled(bool v);

    // Locked: the surface and everything in it take no input, while nothing is greyed.
    bool Locked() const { return locked_; }
    void setLocked(bool v);

    // Repaints the control surface at once.
    void Refresh();

  protected:
    explicit Control(Container& site) : site_(site) {}

    // The enabled state as each control paints it on its children.
    virtual void applyEnabled(bool v) = 0;

    Container& site() const { return site_; }
    bool acceptsInput() const { return enabled_ && !locked_; }

    void notifyChanged(std::string_view name) { site_.propertyChanged(name); }
    void raise(EventId id, EventArgs& args) { site_.raiseEvent(id, args); }
    void raise(EventId id) {
        EventArgs args;
        site_.raiseEvent(id, args);
    }
    // Raises the control event of the same name as the child's notification, with the given
    // index (Empty for a control whose relayed child is single).
    void relay(Notify what, EventArgs& args, const Variant& index = Variant());
    void inject(std::string_view keys) { site_.keyboard().injectKeys(keys); }

    // Enter in an entry widget or check box: Tab to the next control, and the widget never
    // sees the Enter. Returns true when the key was an Enter.
    bool enterMovesFocus(int16_t& KeyAscii);
    // Up arrow: Shift+Tab; Down arrow: Tab. The key code is left as it is.
    void arrowMovesFocus(int16_t KeyCode);

    bool enabled_ = true;
    bool locked_ = false;

  private:
    Container& site_;
};

}  // namespace ryx
