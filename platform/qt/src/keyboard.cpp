#include "ryx/qt/keyboard.h"

#include <QApplication>
#include <QTimer>
#include <QWidget>

namespace ryx::qt {
namespace {

struct KeyMap {
    int16_t vk;
    int qt;
};
constexpr KeyMap kNamedKeys[] = {
    {vk::Back, Qt::Key_Backspace}, {vk::Tab, Qt::Key_Tab},         {vk::Return, Qt::Key_Return},
    {vk::Escape, Qt::Key_Escape},  {vk::Space, Qt::Key_Space},     {33, Qt::Key_PageUp},
    {34, Qt::Key_PageDown},        {vk::End, Qt::Key_End},         {vk::Home, Qt::Key_Home},
    {vk::Left, Qt::Key_Left},      {vk::Up, Qt::Key_Up},           {vk::Right, Qt::Key_Right},
    {vk::Down, Qt::Key_Down},      {vk::Insert, Qt::Key_Insert},   {vk::Delete, Qt::Key_Delete},
    {vk::Shift, Qt::Key_Shift},    {vk::Control, Qt::Key_Control}, {vk::Menu, Qt::Key_Alt},
};

// The numeric keypad's keys have codes of their own.
int16_t keypadKey(int key) {
    if (key >= Qt::Key_0 && key <= Qt::Key_9) return static_cast<int16_t>(96 + key - Qt::Key_0);
    switch (key) {
        case Qt::Key_Asterisk:
            return 106;
        case Qt::Key_Plus:
            return 107;
        case Qt::Key_Minus:
            return 109;
        case Qt::Key_Period:
            return 110;
        case Qt::Key_Slash:
            return vk::Divide;
        case Qt::Key_Enter:
            return vk::Return;
        default:
            return 0;
    }
}

int qtKeyOf(const common::KeyStroke& k) {
    if (k.keyCode == vk::Tab && (k.shift & shift::Shift)) return Qt::Key_Backtab;
    for (const KeyMap& m : kNamedKeys)
        if (m.vk == k.keyCode) return m.qt;
    if ((k.keyCode >= '0' && k.keyCode <= '9') || (k.keyCode >= 'A' && k.keyCode <= 'Z'))
        return k.keyCode;
    if (k.keyChar > 32) return QChar(static_cast<char16_t>(k.keyChar)).toUpper().unicode();
    return Qt::Key_unknown;
}

Qt::KeyboardModifiers modifiersOf(int16_t shift) {
    Qt::KeyboardModifiers m;
    if (shift & shift::Shift) m |= Qt::ShiftModifier;
    if (shift & shift::Ctrl) m |= Qt::ControlModifier;
    if (shift & shift::Alt) m |= Qt::AltModifier;
    return m;
}

}  // namespace

QtKeyboard& QtKeyboard::instance() {
    static QtKeyboard keyboard;
    return keyboard;
}

void QtKeyboard::injectKeys(std::string_view keys) {
    for (const common::KeyStroke& k : common::parseKeys(keys))
        queue_.push_back(k);
    scheduleFlush();
}

void QtKeyboard::scheduleFlush() {
    if (scheduled_ || !qApp) return;
    scheduled_ = true;
    QTimer::singleShot(0, qApp, [this] {
        scheduled_ = false;
        flush();
    });
}

void QtKeyboard::flush() {
    if (flushing_) return;
    flushing_ = true;
    while (!queue_.empty()) {
        const common::KeyStroke k = queue_.front();
        queue_.pop_front();
        QWidget* target = QApplication::focusWidget();
        if (!target) continue;
        const QString text =
            k.keyChar ? QString(QChar(static_cast<char16_t>(k.keyChar))) : QString();
        QKeyEvent press(QEvent::KeyPress, qtKeyOf(k), modifiersOf(k.shift), text);
        QApplication::sendEvent(target, &press);
        QWidget* now = QApplication::focusWidget();
        QKeyEvent release(QEvent::KeyRelease, qtKeyOf(k), modifiersOf(k.shift), text);
        if (now) QApplication::sendEvent(now, &release);
    }
    flushing_ = false;
}

int16_t QtKeyboard::keyState(int16_t virtualKey) const {
    if (virtualKey == vk::Insert) return insertOn_ ? 1 : 0;
    return 0;
}

int16_t QtKeyboard::upperCase(int16_t keyChar) const {
    const QChar c(static_cast<char16_t>(keyChar));
    return static_cast<int16_t>(c.toUpper().unicode());
}

int16_t virtualKeyOf(const QKeyEvent& e) {
    const int key = e.key();
    if (e.modifiers() & Qt::KeypadModifier)
        if (int16_t k = keypadKey(key)) return k;
    if (key == Qt::Key_Backtab) return vk::Tab;
    if (key == Qt::Key_Enter) return vk::Return;
    for (const KeyMap& m : kNamedKeys)
        if (m.qt == key) return m.vk;
    if ((key >= Qt::Key_0 && key <= Qt::Key_9) || (key >= Qt::Key_A && key <= Qt::Key_Z))
        return static_cast<int16_t>(key);
    if (key >= Qt::Key_F1 && key <= Qt::Key_F12)
        return static_cast<int16_t>(112 + key - Qt::Key_F1);
    const QString text = e.text();
    if (text.size() == 1) return common::strokeForChar(text.at(0).unicode()).keyCode;
    if (key > 32 && key < 127) return common::strokeForChar(static_cast<char32_t>(key)).keyCode;
    return 0;
}

int16_t shiftBitsOf(Qt::KeyboardModifiers m) {
    int16_t bits = 0;
    if (m & Qt::ShiftModifier) bits |= shift::Shift;
    if (m & Qt::ControlModifier) bits |= shift::Ctrl;
    if (m & Qt::AltModifier) bits |= shift::Alt;
    return bits;
}

int16_t keyCharOf(const QKeyEvent& e) {
    if (e.modifiers() & Qt::AltModifier) return 0;
    const int key = e.key();
    if (key == Qt::Key_Tab || key == Qt::Key_Backtab) return 0;
    if (key == Qt::Key_Return || key == Qt::Key_Enter) return vk::Return;
    if (key == Qt::Key_Backspace) return vk::Back;
    if (key == Qt::Key_Escape) return vk::Escape;
    const QString text = e.text();
    if (text.size() != 1) {
        // Ctrl+letter types its control character even where the platform gives no text.
        if ((e.modifiers() & Qt::ControlModifier) && key >= Qt::Key_A && key <= Qt::Key_Z)
            return static_cast<int16_t>(key - Qt::Key_A + 1);
        return 0;
    }
    return static_cast<int16_t>(text.at(0).unicode());
}

}  // namespace ryx::qt
