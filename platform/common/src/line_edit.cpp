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

std::string LineEdit::text() const {
    return encodeUtf8(text_);
}

void LineEdit::setText(std::string_view text) {
    text_ = decodeUtf8(text);
    sel_.collapse(0, length());
}

std::string LineEdit::selectedText() const {
    return encodeUtf8(std::u32string_view(text_).substr(static_cast<size_t>(sel_.start()),
                                                        static_cast<size_t>(sel_.length())));
}

void LineEdit::setMaxLength(int32_t v) {
    if (v < 0) {
        throw OverflowError("MaxLength cannot be negative: " + std::to_string(v));
    }
    maxLength_ = v;
}

void LineEdit::replaceSelection(std::u32string_view with) {
    text_.replace(static_cast<size_t>(sel_.start()), static_cast<size_t>(sel_.length()), with);
    const auto end = static_cast<int64_t>(sel_.start()) + static_cast<int64_t>(with.size());
    sel_.collapse(static_cast<int32_t>(std::min<int64_t>(end, length())), length());
}

bool LineEdit::keyDown(int16_t keyCode, int16_t shift) {
    if (keyCode != vk::Delete) {
        sel_.move(keyCode, shift, length());
        return false;
    }
    if (sel_.length() == 0) {
        if (sel_.start() >= length()) return false;
        sel_.select(sel_.start(), sel_.start() + 1, length());
    }
    replaceSelection({});
    return true;
}

bool LineEdit::keyChar(int16_t keyChar) {
    const char32_t c = static_cast<uint16_t>(keyChar);
    if (c == kBackspace) {
        if (sel_.length() == 0) {
            if (sel_.start() == 0) return false;
            sel_.select(sel_.start() - 1, sel_.start(), length());
        }
        replaceSelection({});
        return true;
    }
    if (c == kCut) {
        if (sel_.length() == 0) return false;
        replaceSelection({});
        return true;
    }
    if (!isPrintable(c)) return false;
    if (maxLength_ > 0 && static_cast<int64_t>(length()) - sel_.length() + 1 > maxLength_) {
        return false;
    }
    replaceSelection(std::u32string_view(&c, 1));
    return true;
}

}  // namespace ryx::common
