// The caret and selection of a single-line field, and how the keys that move the caret change
// them. Positions count characters; every change clamps them to the text's length.
#pragma once

#include <cstdint>

namespace ryx::common {

class Selection {
  public:
    int32_t start() const { return start_; }
    int32_t length() const { return length_; }
    int32_t end() const { return start_ + length_; }
    int32_t caret() const { return caretAtStart_ ? start_ : end(); }
    int32_t anchor() const { return caretAtStart_ ? end() : start_; }

    // Selects from `anchor` to `caret` (the caret may stand before the anchor).
    void select(int32_t anchor, int32_t caret, int32_t textLength);
    void collapse(int32_t caret, int32_t textLength) { select(caret, caret, textLength); }
    void setStart(int32_t v, int32_t textLength) { collapse(v, textLength); }
    void setLength(int32_t v, int32_t textLength);

    // Home, End, Left and Right. Shift extends the selection from its anchor; without Shift a
    // selection collapses to the end the arrow points at. False for any other key.
    bool move(int16_t keyCode, int16_t shift, int32_t textLength);

  private:
    int32_t start_ = 0;
    int32_t length_ = 0;
    bool caretAtStart_ = false;  // the caret is at the selection's start (Shift+Left, ...)
};

}  // namespace ryx::common
