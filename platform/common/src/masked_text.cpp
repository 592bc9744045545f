#include "ryx/common/masked_text.h"

#include <algorithm>
#include <limits>

#include "ryx/common/utf8.h"
#include "ryx/host.h"

namespace ryx::common {

namespace {

constexpr char32_t kBackspace = 8;
constexpr char32_t kCut = 24;  // Ctrl+X

bool isPrintable(char32_t c) {
    if (c < 0x20 || (c >= 0x7F && c <= 0x9F)) return false;
    return c < 0xD800 || c > 0xDFFF;
}

bool isDigit(char32_t c) {
    return c >= U'0' && c <= U'9';
}

// Latin letters: ASCII, Latin-1 (without the multiplication and division signs) and the Latin
// Extended-A and -B blocks.
bool isLetter(char32_t c) {
    if ((c >= U'A' && c <= U'Z') || (c >= U'a' && c <= U'z')) return true;
    if (c >= 0xC0 && c <= 0xFF) return c != 0xD7 && c != 0xF7;
    return c >= 0x100 && c <= 0x24F;
}

}  // namespace

int32_t MaskedText::length() const {
    constexpr size_t kMax = std::numeric_limits<int32_t>::max();
    return static_cast<int32_t>(std::min(chars_.size(), kMax));
}

bool MaskedText::fits(size_t pos, char32_t c) const {
    switch (slots_[pos]) {
        case Slot::Digit:
            return isDigit(c);
        case Slot::Letter:
            return isLetter(c);
        case Slot::AlphaNumeric:
            return isDigit(c) || isLetter(c);
        case Slot::Any:
            return isPrintable(c);
        case Slot::Literal:
            break;
    }
    return false;
}

size_t MaskedText::fieldEnd(size_t pos) const {
    while (pos < slots_.size() && editable(pos))
        ++pos;
    return pos;
}

bool MaskedText::deleteAt(size_t pos) {
    if (pos >= slots_.size() || !editable(pos)) return false;
    const size_t end = fieldEnd(pos);
    bool changed = false;
    for (size_t i = pos; i < end; ++i) {
        const char32_t next = i + 1 < end ? chars_[i + 1] : prompt_;
        changed = changed || chars_[i] != next;
        chars_[i] = next;
    }
    return changed;
}

bool MaskedText::clearSelection() {
    bool changed = false;
    const auto end = static_cast<size_t>(sel_.start()) + static_cast<size_t>(sel_.length());
    for (auto i = static_cast<size_t>(sel_.start()); i < end; ++i) {
        if (editable(i) && chars_[i] != prompt_) {
            chars_[i] = prompt_;
            changed = true;
        }
    }
    select(sel_.start(), sel_.start());
    return changed;
}

void MaskedText::fill(std::u32string_view text) {
    size_t next = 0;
    for (size_t pos = 0; pos < slots_.size(); ++pos) {
        if (!editable(pos)) {
            // chars_ holds the literal itself; a matching character of the text is consumed.
            if (next < text.size() && text[next] == chars_[pos]) ++next;
            continue;
        }
        if (next < text.size()) {
            const char32_t c = text[next++];
            chars_[pos] = fits(pos, c) ? c : prompt_;
        } else {
            chars_[pos] = prompt_;
        }
    }
}

void MaskedText::setMask(std::string_view mask) {
    const std::u32string current = masked() ? chars_ : decodeUtf8(plain_.text());
    maskText_ = decodeUtf8(mask);
    slots_.clear();
    chars_.clear();
    for (size_t i = 0; i < maskText_.size(); ++i) {
        char32_t c = maskText_[i];
        Slot slot = Slot::Literal;
        if (c == U'\\' && i + 1 < maskText_.size()) {
            c = maskText_[++i];  // escaped: a literal whatever it is
        } else if (c == U'#' || c == U'9') {
            slot = Slot::Digit;
        } else if (c == U'?') {
            slot = Slot::Letter;
        } else if (c == U'A') {
            slot = Slot::AlphaNumeric;
        } else if (c == U'&' || c == U'C') {
            slot = Slot::Any;
        }
        slots_.push_back(slot);
        chars_.push_back(slot == Slot::Literal ? c : prompt_);
    }
    if (masked()) {
        fill(current);
        select(0, 0);
    } else {
        plain_.setText(encodeUtf8(current));
    }
}

std::string MaskedText::mask() const {
    return encodeUtf8(maskText_);
}

std::string MaskedText::text() const {
    return masked() ? encodeUtf8(chars_) : plain_.text();
}

void MaskedText::setText(std::string_view text) {
    if (!masked()) {
        plain_.setText(text);
        return;
    }
    fill(decodeUtf8(text));
    select(0, 0);
}

int32_t MaskedText::selStart() const {
    return masked() ? sel_.start() : plain_.selStart();
}

void MaskedText::setSelStart(int32_t v) {
    if (!masked()) {
        plain_.setSelStart(v);
        return;
    }
    sel_.setStart(v, length());
}

int32_t MaskedText::selLength() const {
    return masked() ? sel_.length() : plain_.selLength();
}

void MaskedText::setSelLength(int32_t v) {
    if (!masked()) {
        plain_.setSelLength(v);
        return;
    }
    sel_.setLength(v, length());
}

bool MaskedText::keyDown(int16_t keyCode, int16_t shift) {
    if (!masked()) return plain_.keyDown(keyCode, shift);
    if (keyCode != vk::Delete) {
        sel_.move(keyCode, shift, length());
        return false;
    }
    if (sel_.length() > 0) return clearSelection();
    // At a literal or at the end there is nothing to delete.
    return deleteAt(static_cast<size_t>(sel_.start()));
}

bool MaskedText::keyChar(int16_t keyChar) {
    if (!masked()) return plain_.keyChar(keyChar);
    const char32_t c = static_cast<uint16_t>(keyChar);
    if (c == kBackspace) {
        if (sel_.length() > 0) return clearSelection();
        int32_t pos = sel_.start() - 1;
        while (pos >= 0 && !editable(static_cast<size_t>(pos)))
            --pos;
        if (pos < 0) return false;
        select(pos, pos);
        return deleteAt(static_cast<size_t>(pos));
    }
    if (c == kCut) return sel_.length() > 0 && clearSelection();
    if (!isPrintable(c)) return false;

    const auto start = static_cast<size_t>(sel_.start());
    if (start >= slots_.size()) return false;
    size_t pos = start;
    if (!editable(pos)) {
        if (chars_[pos] == c) {  // typing the literal steps over it
            select(sel_.start() + 1, sel_.start() + 1);
            return false;
        }
        while (pos < slots_.size() && !editable(pos))
            ++pos;
        if (pos == slots_.size()) return false;
    }
    if (!fits(pos, c)) return false;
    bool changed = clearSelection();
    changed = changed || chars_[pos] != c;
    chars_[pos] = c;
    const auto caret = static_cast<int32_t>(pos + 1);
    select(caret, caret);
    return changed;
}

}  // namespace ryx::common
