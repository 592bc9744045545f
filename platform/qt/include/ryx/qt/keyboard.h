// The keyboard of a Qt application as the controls see it: injected keys, the Insert
// toggle, and the upper-case mapping of one character.
#pragma once

#include <QKeyEvent>
#include <deque>

#include "ryx/common/key_notation.h"
#include "ryx/host.h"

namespace ryx::qt {

class QtKeyboard : public ryx::Keyboard {
  public:
    static QtKeyboard& instance();

    // Queues the keys; they are sent to the focused widget right after the handler that is
    // running returns (flush), and at the latest before the next posted event.
    void injectKeys(std::string_view keys) override;
    int16_t keyState(int16_t virtualKey) const override;
    int16_t upperCase(int16_t keyChar) const override;

    // Sends the queued keys now, in order, each as a key press and release.
    void flush();
    bool pending() const { return !queue_.empty(); }

    // The Insert key toggles overwrite; the adapters report each Insert key they see.
    void insertPressed() { insertOn_ = !insertOn_; }
    void setInsertToggle(bool on) { insertOn_ = on; }

  private:
    void scheduleFlush();

    std::deque<common::KeyStroke> queue_;
    bool flushing_ = false;
    bool scheduled_ = false;
    bool insertOn_ = false;
};

// Key translation between Qt and the virtual key codes and characters of the controls.
int16_t virtualKeyOf(const QKeyEvent& e);
int16_t shiftBitsOf(Qt::KeyboardModifiers m);
// The character a key press types, or 0 (Alt combinations, keys without text, Tab).
int16_t keyCharOf(const QKeyEvent& e);

}  // namespace ryx::qt
