#include "ryx/common/masked_text.h"

#include <gtest/gtest.h>

#include <cstdint>
#include <string>

#include "ryx/common/key_notation.h"

namespace ryx::common {
namespace {

constexpr const char* kDateMask = "##/##/####";

MaskedText dateField(const std::string& text = "") {
    MaskedText f;
    f.setMask(kDateMask);
    f.setText(text);
    return f;
}

// The two digits of a day (max 31) or month (max 12) read from two characters of the field:
// blank reads as "01", 1..9 as "0d"; "" when the number is out of range.
std::string twoDigits(const std::string& chars, int max) {
    std::string digits;
    for (char c : chars) {
        if (c >= '0' && c <= '9') digits += c;
    }
    if (digits.empty()) return "01";
    const int n = std::stoi(digits);
    if (n < 1 || n > max) return "";
    return (n < 10 ? "0" : "") + std::to_string(n);
}

// A stroke of key notation as the field receives it: typed when it has a character.
bool press(MaskedText& f, const KeyStroke& k) {
    return k.keyChar ? f.keyChar(k.keyChar) : f.keyDown(k.keyCode, k.shift);
}

// The date control's typing help around the field: "/" completes the day or the month by
// queued keystrokes that run after the "/" itself, or is swallowed when the number is invalid.
void typeIntoDate(MaskedText& f, const std::string& typed) {
    for (char ch : typed) {
        std::string queued;
        if (ch == '/' && f.selStart() <= 5) {
            const bool day = f.selStart() <= 2;
            const std::string digits = twoDigits(f.text().substr(day ? 0 : 3, 2), day ? 31 : 12);
            queued = std::string(day ? "{HOME}" : "") + "{DEL}{DEL}" + digits;
            f.setSelStart(3);
            if (!digits.empty()) f.keyChar(ch);
        } else {
            f.keyChar(ch);
        }
        for (const KeyStroke& k : parseKeys(queued))
            press(f, k);
    }
}

TEST(MaskedText, DateTypingHelp) {
    struct Case {
        const char* typed;
        const char* expected;
        int32_t caret;
    };
    // A field that skipped past the literal after a field's last digit would end "15/05/2000"
    // as "15/01/0520".
    const Case cases[] = {
        {"1/5/2000", "01/05/2000", 10}, {"15/05/2000", "15/05/2000", 10},
        {"15052000", "15/05/2000", 10}, {"45/", "__/__/____", 0},
        {"3/12/", "03/12/____", 5},     {"1/13/", "01/__/____", 3},
        {"31/1/99", "31/01/99__", 8},   {"1/5/20001", "01/05/2000", 10},
    };
    for (const Case& c : cases) {
        MaskedText f = dateField();
        typeIntoDate(f, c.typed);
        EXPECT_EQ(f.text(), c.expected) << c.typed;
        EXPECT_EQ(f.selStart(), c.caret) << c.typed;
    }
}

TEST(MaskedText, DateFieldKeys) {
    struct Case {
        const char* text;
        int32_t selStart, selLength;
        const char* keys;  // key notation: a stroke with a character is typed, others pressed
        const char* expected;
        int32_t caret;
    };
    const Case cases[] = {
        {"15/05/2000", 3, 0, "{DEL}", "15/5_/2000", 3},  // shifts the rest of the field
        {"15/05/2000", 2, 0, "{DEL}", "15/05/2000", 2},  // a literal
        {"15/05/2000", 1, 6, "{DEL}", "1_/__/_000", 1},
        {"15/05/2000", 3, 0, "{BS}", "1_/05/2000", 1},  // back over the literal
        {"15/05/2000", 3, 2, "{BS}", "15/__/2000", 3},
        {"15/05/2000", 0, 10, "^x", "__/__/____", 0},
        {"15/05/2000", 4, 1, "7", "15/07/2000", 5},  // replaces the selection
        {"15/05/2000", 2, 3, "9", "15/9_/2000", 4},  // from a literal: cleared, then placed
        {"__/__/____", 2, 0, "/", "__/__/____", 3},  // steps over the literal
        {"__/__/____", 3, 0, "/", "__/__/____", 3},
        {"15/05/2000", 0, 10, "a{ENTER}", "15/05/2000", 0},  // refused: the selection stays
        {"15/05/2000", 10, 0, "1", "15/05/2000", 10},
        {"15/05/2000", 7, 0, "{END}{LEFT}{HOME}{RIGHT}", "15/05/2000", 1},
    };
    for (const Case& c : cases) {
        MaskedText f = dateField(c.text);
        f.setSelStart(c.selStart);
        f.setSelLength(c.selLength);
        for (const KeyStroke& k : parseKeys(c.keys)) {
            const std::string before = f.text();
            const bool changed = press(f, k);
            EXPECT_EQ(changed, f.text() != before) << c.text << " " << c.keys;
        }
        EXPECT_EQ(f.text(), c.expected) << c.text << " " << c.keys;
        EXPECT_EQ(f.selStart(), c.caret) << c.text << " " << c.keys;
    }
}

TEST(MaskedText, SetTextFillsPositions) {
    struct Case {
        const char* mask;
        const char* text;
        const char* expected;
    };
    const Case cases[] = {
        {kDateMask, "01/05/2000", "01/05/2000"},
        {kDateMask, "1_/05/2000", "1_/05/2000"},
        {kDateMask, "hello", "__/__/____"},     // letters do not fit
        {kDateMask, "01052000", "01/05/2000"},  // literals need not be in the text
        {kDateMask, "\xFF\xFF/05", "__/05/____"},
        {"?A&C9", "a1-x5", "a1-x5"},
        {"?A&C9", "1-\xC3\xA9\xC3\xA9x", "__\xC3\xA9\xC3\xA9_"},
        {"\\##-\\\\", "#7-\\", "#7-\\"},  // escaped mask characters are literals
    };
    for (const Case& c : cases) {
        MaskedText f;
        f.setMask(c.mask);
        f.setSelStart(3);
        f.setText(c.text);
        EXPECT_EQ(f.text(), c.expected) << c.mask << " " << c.text;
        EXPECT_EQ(f.selStart(), 0);
        EXPECT_EQ(f.mask(), c.mask);
    }
}

TEST(MaskedText, EmptyMaskIsPlainField) {
    MaskedText f = dateField("01/05/2000");
    f.setMask("");
    EXPECT_EQ(f.text(), "01/05/2000");  // the displayed text carries over
    f.setText("");
    EXPECT_EQ(f.text(), "");
    f.setMask(kDateMask);
    EXPECT_EQ(f.text(), "__/__/____");
}

}  // namespace
}  // namespace ryx::common
