#include "ryx/common/line_edit.h"

#include <gtest/gtest.h>

#include <string>

#include "ryx/common/key_notation.h"
#include "ryx/common/utf8.h"
#include "ryx/errors.h"

namespace ryx::common {
namespace {

TEST(Utf8, BadBytesDecodeOneReplacementEach) {
    struct Case {
        std::string bytes;
        std::u32string chars;
    };
    const Case cases[] = {
        {"a\xE2\x82\xAC", U"a\u20AC"},
        {"\xF0\x9F\x98\x80", U"\U0001F600"},
        {"\xC0\x80", U"\uFFFD\uFFFD"},                      // overlong NUL
        {"\xED\xA0\x80", U"\uFFFD\uFFFD\uFFFD"},            // a surrogate
        {"\xF4\x90\x80\x80", U"\uFFFD\uFFFD\uFFFD\uFFFD"},  // past U+10FFFF
        {"\xE2\x82\x61", U"\uFFFD\uFFFDa"},                 // truncated
    };
    for (const Case& c : cases)
        EXPECT_EQ(decodeUtf8(c.bytes), c.chars) << c.bytes;
    // What cannot be encoded comes out as U+FFFD, so the output is always valid.
    EXPECT_EQ(encodeUtf8(char32_t{0xD800}), "\xEF\xBF\xBD");
    const char32_t chars[] = {0xE9, 0x1F600, 0x110000};
    EXPECT_EQ(encodeUtf8(std::u32string_view(chars, 3)), "\xC3\xA9\xF0\x9F\x98\x80\xEF\xBF\xBD");
}

TEST(LineEdit, Keys) {
    struct Case {
        std::string text;
        int32_t selStart, selLength, maxLength;
        std::string keys;  // key notation: a stroke with a character is typed, others pressed
        std::string expected;
        int32_t expStart, expLength;
    };
    const Case cases[] = {
        {"abc", 1, 1, 0, "X", "aXc", 2, 0},
        {"abc", 3, 0, 3, "d", "abc", 3, 0},  // at the maximum length
        {"abc", 2, 1, 3, "d", "abd", 3, 0},  // replacing frees the selected characters
        {"abc", 2, 0, 0, "{BS}{BS}{BS}", "c", 0, 0},
        {"abcd", 1, 2, 0, "{BS}", "ad", 1, 0},
        {"abc", 0, 0, 0, "{DEL}{END}{DEL}", "bc", 2, 0},
        {"abcd", 0, 3, 0, "^x", "d", 0, 0},
        {"abcd", 1, 0, 0, "^x{ENTER}{TAB}^{BS}{UP}{INS}", "abcd", 1, 0},
        {"abc", 3, 0, 0, "+{LEFT}+{LEFT}", "abc", 1, 2},
        {"abc", 1, 0, 0, "+{LEFT}+{RIGHT}+{RIGHT}", "abc", 1, 1},  // back over the anchor
        {"abc", 2, 0, 0, "+{HOME}+{END}", "abc", 2, 1},
        {"abcd", 1, 2, 0, "{LEFT}", "abcd", 1, 0},
        {"abcd", 1, 2, 0, "{RIGHT}", "abcd", 3, 0},
        {"abc", 1, 0, 0, "{LEFT}{LEFT}{END}{RIGHT}!{HOME}?", "?abc!", 1, 0},
        {"h\xC3\xA9llo", 2, 0, 0, "{BS}\xE2\x82\xAC", "h\xE2\x82\xACllo", 2, 0},
        {"", 0, 0, 0, "\xEF\xBC\xA1", "\xEF\xBC\xA1", 1, 0},  // a negative 16-bit key char
    };
    for (const Case& c : cases) {
        LineEdit e;
        e.setText(c.text);
        e.setMaxLength(c.maxLength);
        e.setSelStart(c.selStart);
        e.setSelLength(c.selLength);
        for (const KeyStroke& k : parseKeys(c.keys)) {
            const std::string before = e.text();
            const bool changed = k.keyChar ? e.keyChar(k.keyChar) : e.keyDown(k.keyCode, k.shift);
            EXPECT_EQ(changed, e.text() != before) << c.keys;
        }
        EXPECT_EQ(e.text(), c.expected) << c.text << " " << c.keys;
        EXPECT_EQ(e.selStart(), c.expStart) << c.text << " " << c.keys;
        EXPECT_EQ(e.selLength(), c.expLength) << c.text << " " << c.keys;
    }
}

TEST(LineEdit, SettersClampAndValidate) {
    LineEdit e;
    e.setText("a\xFF\x62\x63");  // the bad byte is one character
    e.setSelStart(-5);
    EXPECT_EQ(e.selStart(), 0);
    e.setSelStart(99);
    EXPECT_EQ(e.selStart(), 4);
    e.setSelStart(1);
    e.setSelLength(99);
    EXPECT_EQ(e.selectedText(), "\xEF\xBF\xBD\x62\x63");
    e.setSelLength(-2);
    EXPECT_EQ(e.selLength(), 0);
    EXPECT_FALSE(e.keyChar(static_cast<int16_t>(0xD800)));  // half a surrogate pair

    // A text longer than the maximum is kept as set; typing stays refused until it shrinks.
    e.setMaxLength(2);
    e.setText("abcd");
    EXPECT_EQ(e.text(), "abcd");
    EXPECT_FALSE(e.keyChar('x'));
    try {
        e.setMaxLength(-7);
        FAIL() << "no error";
    } catch (const OverflowError& err) {
        EXPECT_NE(std::string(err.what()).find("-7"), std::string::npos) << err.what();
    }
}

}  // namespace
}  // namespace ryx::common
