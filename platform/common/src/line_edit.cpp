#include "ryx/common/line_edit.h"

#include <algorithm>
#include <limits>
#include <string>

#include "ryx/common/utf8.h"
#include "ryx/errors.h"
#include "ryx/host.h"

namespace ryx::common {

namespace {

constexpr char16_t kBackspace = 8;
constexpr char16_t kCut = 24;  // Ctrl+X

bool isPrintable(char32_t c) {
    if (c < 0x20 || (c >= 0x7F && c <= 0x9F)) return false;
    return c < 0xD800 || c > 0xDFFF;  // half of a surrogate pair is no character
}

}  // namespace

int32_t LineEdit::length() const {
    constexpr size_t kMax = std::numeric_limits<int32_t>::max();
    return static_cast<int32_t>(std::min(text_.size(), kMax));
}

void LineEdit::select(int32_t anchor, int32_t caret) {
    const int32_t len = length();
    anchor = std::clamp(anchor, 0, len);
    caret = std::clamp(caret, 0, len);
    selStart_ = std::min(anchor, caret);
    selLength_ = std::max(anchor, caret) - selStart_;
    caretAtStart_ = caret < anchor;
}

std::string LineEdit::text() const {
    return encodeUtf8(text_);
}

void LineEdit::setText(std::string_view text) {
    text_ = decodeUtf8(text);
    select(0, 0);
}

void LineEdit::setSelStart(int32_t v) {
    const int32_t pos = std::clamp(v, 0, length());
    select(pos, pos);
}

void LineEdit::setSelLength(int32_t v) {
    const int32_t n = std::clamp(v, 0, length() - selStart_);
    select(selStart_, selStart_ + n);
}

std::string LineEdit::selectedText() const {
    return encodeUtf8(std::u32string_view(text_).substr(static_cast<size_t>(selStart_),
                                                        static_cast<size_t>(selLength_)));
}

void LineEdit::setMaxLength(int32_t v) {
    if (v < 0) {
        throw OverflowError("MaxLength cannot be negative: " + std::to_string(v));
    }
    maxLength_ = v;
}

void LineEdit::replaceSelection(std::u32string_view with) {
    text_.replace(static_cast<size_t>(selStart_), static_cast<size_t>(selLength_), with);
    const auto end = static_cast<int64_t>(selStart_) + static_cast<int64_t>(with.size());
    const auto caret = static_cast<int32_t>(std::min<int64_t>(end, length()));
    select(caret, caret);
}

bool LineEdit::keyDown(int16_t keyCode, int16_t shift) {
    const bool extend = (shift & ryx::shift::Shift) != 0;
    const int32_t start = selStart_;
    const int32_t end = selStart_ + selLength_;
    int32_t target = 0;
    switch (keyCode) {
        case vk::Home:
            target = 0;
            break;
        case vk::End:
            target = length();
            break;
        case vk::Left:
            // Without Shift a selection collapses to its start; with Shift the caret moves.
            target = (!extend && selLength_ > 0) ? start : caret() - 1;
            break;
        case vk::Right:
            target = (!extend && selLength_ > 0) ? end : caret() + 1;
            break;
        case vk::Delete:
            if (selLength_ == 0) {
                if (selStart_ >= length()) return false;
                selLength_ = 1;
            }
            replaceSelection({});
            return true;
        default:
            return false;
    }
    select(extend ? anchor() : target, target);
    return false;
}

bool LineEdit::keyChar(int16_t keyChar) {
    const char32_t c = static_cast<uint16_t>(keyChar);
    if (c == kBackspace) {
        if (selLength_ == 0) {
            if (selStart_ == 0) return false;
            select(selStart_ - 1, selStart_);
        }
        replaceSelection({});
        return true;
    }
    if (c == kCut) {
        if (selLength_ == 0) return false;
        replaceSelection({});
        return true;
    }
    if (!isPrintable(c)) return false;
    if (maxLength_ > 0 && static_cast<int64_t>(length()) - selLength_ + 1 > maxLength_) {
        return false;
    }
    replaceSelection(std::u32string_view(&c, 1));
    return true;
}

}  // namespace ryx::common
