#include "ryx/common/key_notation.h"

#include <gtest/gtest.h>

#include <ostream>
#include <string>
#include <vector>

#include "ryx/host.h"

namespace ryx::common {

bool operator==(const KeyStroke& a, const KeyStroke& b) {
    return a.keyCode == b.keyCode && a.shift == b.shift && a.keyChar == b.keyChar;
}
void PrintTo(const KeyStroke& k, std::ostream* os) {
    *os << "{" << k.keyCode << "," << k.shift << "," << k.keyChar << "}";
}

namespace {

constexpr int16_t S = shift::Shift;
constexpr int16_t C = shift::Ctrl;
constexpr int16_t A = shift::Alt;

TEST(KeyNotation, ParseKeys) {
    struct Case {
        std::string keys;
        std::vector<KeyStroke> strokes;
    };
    const Case cases[] = {
        {"{TAB}{tab}+{TAB}", {{vk::Tab, 0, 0}, {vk::Tab, 0, 0}, {vk::Tab, S, 0}}},
        {"{HOME}{DEL}{DEL}01",
         {{vk::Home, 0, 0}, {vk::Delete, 0, 0}, {vk::Delete, 0, 0}, {48, 0, 48}, {49, 0, 49}}},
        {"{End}{Delete}{BackSpace}{ins}{ESC}",
         {{vk::End, 0, 0}, {vk::Delete, 0, 0}, {8, 0, 8}, {vk::Insert, 0, 0}, {27, 0, 27}}},
        {"aA/ ", {{65, 0, 97}, {65, S, 65}, {191, 0, 47}, {32, 0, 32}}},
        {"{ENTER}~{BS}", {{13, 0, 13}, {13, 0, 13}, {8, 0, 8}}},
        {"%p^x", {{80, A, 0}, {88, C, 24}}},
        {"+a+1^+a", {{65, S, 65}, {49, S, '!'}, {65, S | C, 1}}},
        {"^{HOME}^[^{ENTER}^{BS}", {{vk::Home, C, 0}, {219, C, 27}, {13, C, 10}, {8, C, 127}}},
        {"%{ENTER}+~", {{13, A, 0}, {13, S, 13}}},
        {"{+}{^}{%}{~}{{}{}}",
         {{187, S, '+'}, {54, S, '^'}, {53, S, '%'}, {192, S, '~'}, {219, S, '{'}, {221, S, '}'}}},
        // Malformed notation is plain characters.
        {"{", {{219, S, '{'}}},
        {"{TAB", {{219, S, '{'}, {84, S, 'T'}, {65, S, 'A'}, {66, S, 'B'}}},
        {"{NOPE}",
         {{219, S, '{'}, {78, S, 'N'}, {79, S, 'O'}, {80, S, 'P'}, {69, S, 'E'}, {221, S, '}'}}},
        {"a+", {{65, 0, 'a'}, {187, S, '+'}}},
        {"{}^%", {{219, S, '{'}, {221, S, '}'}, {54, S, '^'}, {53, S, '%'}}},
        // Characters without a key.
        {"\xC3\xA9", {{0, 0, 0xE9}}},
        {"^\xC3\xA9", {{0, C, 0}}},
        {"\xE2\x82\xAC\xEF\xBC\xA1", {{0, 0, 0x20AC}, {0, 0, static_cast<int16_t>(0xFF21)}}},
        {"\xF0\x9F\x98\x80x", {{88, 0, 'x'}}},
    };
    for (const Case& c : cases) {
        EXPECT_EQ(parseKeys(c.keys), c.strokes) << c.keys;
    }
}

TEST(KeyNotation, StrokeForChar) {
    struct Case {
        char32_t c;
        KeyStroke stroke;
    };
    const Case cases[] = {
        {'-', {189, 0, '-'}}, {'.', {190, 0, '.'}},   {',', {188, 0, ','}}, {';', {186, 0, ';'}},
        {'=', {187, 0, '='}}, {'`', {192, 0, '`'}},   {'[', {219, 0, '['}}, {'\\', {220, 0, '\\'}},
        {']', {221, 0, ']'}}, {'\'', {222, 0, '\''}}, {'?', {191, S, '?'}}, {'_', {189, S, '_'}},
        {'"', {222, S, '"'}}, {')', {48, S, ')'}},    {'|', {220, S, '|'}}, {'\t', {vk::Tab, 0, 0}},
        {'\r', {13, 0, 13}},  {'\n', {13, C, 10}},    {3, {67, C, 3}},      {0x10000, {0, 0, 0}},
    };
    for (const Case& c : cases) {
        EXPECT_EQ(strokeForChar(c.c), c.stroke) << static_cast<uint32_t>(c.c);
    }
    // Every printable ASCII character has a key that types exactly it.
    for (char32_t c = 0x20; c < 0x7F; ++c) {
        const KeyStroke k = strokeForChar(c);
        EXPECT_NE(k.keyCode, 0) << static_cast<char>(c);
        EXPECT_EQ(k.keyChar, static_cast<int16_t>(c)) << static_cast<char>(c);
        EXPECT_EQ(k.shift & ~S, 0) << static_cast<char>(c);
    }
}

}  // namespace
}  // namespace ryx::common
