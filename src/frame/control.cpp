#include "ryx/control.h"

namespace ryx {

bool eventFor(Notify what, EventId& id) {
    switch (what) {
        case Notify::Click:
            id = EventId::Click;
            return true;
        case Notify::DblClick:
            id = EventId::DblClick;
            return true;
        case Notify::KeyDown:
            id = EventId::KeyDown;
            return true;
        case Notify::KeyPress:
            id = EventId::KeyPress;
            return true;
        case Notify::KeyUp:
            id = EventId::KeyUp;
            return true;
        case Notify::MouseDown:
            id = EventId::MouseDown;
            return true;
        case Notify::MouseMove:
            id = EventId::MouseMove;
            return true;
        case Notify::MouseUp:
            id = EventId::MouseUp;
            return true;
        case Notify::GotFocus:
        case Notify::LostFocus:
            return false;
    }
    return false;
}

void Control::setEnabled(bool v) {
    enabled_ = v;
    applyEnabled(v);
    notifyChanged("Enabled");
}

void Control::setLocked(bool v) {
    locked_ = v;
    site_.setSurfaceEnabled(!v);
    notifyChanged("Locked");
}

void Control::Refresh() {
    site_.repaint();
}

void Control::relay(Notify what, EventArgs& args, const Variant& index) {
    EventId id;
    if (!eventFor(what, id)) return;
    args.Index = index;
    raise(id, args);
}

bool Control::enterMovesFocus(int16_t& KeyAscii) {
    if (KeyAscii != vk::Return) return false;
    inject("{TAB}");
    KeyAscii = 0;
    return true;
}

void Control::arrowMovesFocus(int16_t KeyCode) {
    if (KeyCode == vk::Up) inject("+{TAB}");
    if (KeyCode == vk::Down) inject("{TAB}");
}

}  // namespace ryx
