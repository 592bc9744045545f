// The editing rules of a single-line text box: the text, the caret, the selection and the
// maximum length, and what each key does to them. Toolkit-independent; the headless text box
// and the Qt one both run on it.
#pragma once

#include <cstdint>
#include <string>
#include <string_view>

#include "ryx/common/selection.h"

namespace ryx::common {

class LineEdit {
  public:
    std::string text() const;  // UTF-8
    // Replaces the whole text (not cut to the maximum length, as a host's code may set any
    // text); the caret goes to 0 and the selection is emptied.
    void setText(std::string_view text);

    // Positions count characters, not bytes. Setters clamp to the text.
    int32_t selStart() const { return sel_.start(); }
    void setSelStart(int32_t v) { sel_.setStart(v, length()); }
    int32_t selLength() const { return sel_.length(); }
    void setSelLength(int32_t v) { sel_.setLength(v, length()); }
    std::string selectedText() const;

    int32_t maxLength() const { return maxLength_; }  // 0: no limit
    void setMaxLength(int32_t v);                     // negative values are an error

    // A key with no character: Home, End, Left, Right (selection emptied), Delete (the
    // selection, or the character after the caret). Shift extends the selection with
    // Home/End/Left/Right. Other keys do nothing. Returns true when the text changed.
    bool keyDown(int16_t keyCode, int16_t shift);

    // A typed character (after the KeyPress handler; 0 never arrives here). Printable
    // characters replace the selection or are inserted at the caret, unless the maximum length
    // is reached; Backspace (8) deletes the selection or the character before the caret;
    // Ctrl+X (24) deletes the selection; other control characters do nothing.
    // Returns true when the text changed.
    bool keyChar(int16_t keyChar);

  private:
    void replaceSelection(std::u32string_view with);
    int32_t length() const;

    std::u32string text_;
    Selection sel_;
    int32_t maxLength_ = 0;
};

}  // namespace ryx::common
