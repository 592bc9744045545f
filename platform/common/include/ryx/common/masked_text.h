// The masked edit field's engine: a mask of literals and editable positions with a prompt
// character in every empty position, the caret and selection, and what each key does.
// Toolkit-independent; the headless field and the Qt field both run on it.
//
// The rules are those the date control's typing help is built on:
// - a typed character that fits the editable position at the caret replaces the character
//   there (at a literal position it goes into the next editable position), and the caret moves
//   one position right, past that character only: it never skips a literal on its own;
// - a character typed at a literal position that equals the literal steps over it;
// - a character that does not fit is refused and nothing changes;
// - a selection is cleared to prompts before a fitting character is placed at its start;
// - Delete removes the character at the caret and shifts the rest of that field (up to its
//   next literal) left, a prompt filling the field's end; the caret stays;
// - Backspace moves back to the previous editable position and deletes there the same way;
// - Home puts the caret at 0, End after the last position.
// With the empty mask the field is a plain text field (LineEdit rules, no length limit).
#pragma once

#include <cstdint>
#include <string>
#include <string_view>
#include <vector>

#include "ryx/common/line_edit.h"
#include "ryx/common/selection.h"

namespace ryx::common {

class MaskedText {
  public:
    // Mask characters: "#" and "9" a digit, "?" a letter, "A" a letter or digit, "&" and "C"
    // any character; "\\" makes the next character a literal; every other character is a
    // literal. Setting a mask refills the positions from the current text.
    void setMask(std::string_view mask);
    std::string mask() const;
    char32_t promptChar() const { return prompt_; }

    // With a mask: literals, characters and prompts ("__/__/____" when empty).
    std::string text() const;
    // With a mask, fills the positions from the given text: at a literal position a matching
    // character of the text is consumed; at an editable position the next character of the
    // text is placed if it fits, else the position gets the prompt. The caret goes to 0.
    void setText(std::string_view text);

    int32_t selStart() const;
    void setSelStart(int32_t v);
    int32_t selLength() const;
    void setSelLength(int32_t v);

    // Home, End, Left, Right, Delete as described above; returns true when the text changed.
    bool keyDown(int16_t keyCode, int16_t shift);
    // A typed character (never 0): Backspace (8), Ctrl+X (24) clears the selection, other
    // control characters do nothing, others are placed as described above.
    bool keyChar(int16_t keyChar);

  private:
    enum class Slot : char { Literal, Digit, Letter, AlphaNumeric, Any };
    bool masked() const { return !slots_.empty(); }
    int32_t length() const;
    bool fits(size_t pos, char32_t c) const;
    bool editable(size_t pos) const { return slots_[pos] != Slot::Literal; }
    size_t fieldEnd(size_t pos) const;  // first literal (or end) at or after pos
    bool deleteAt(size_t pos);          // true when the text changed
    bool clearSelection();              // true when the text changed
    void fill(std::u32string_view text);
    void select(int32_t anchor, int32_t caret) { sel_.select(anchor, caret, length()); }

    std::u32string maskText_;
    std::vector<Slot> slots_;  // one per mask position; empty when plain
    std::u32string chars_;     // the displayed characters, one per mask position
    char32_t prompt_ = U'_';
    Selection sel_;
    LineEdit plain_;
};

}  // namespace ryx::common
