// The key notation of key injection ("{TAB}", "+{TAB}", "{HOME}", "{DEL}", plain characters)
// parsed into keystrokes, and the key code of a typed character.
#pragma once

#include <cstdint>
#include <string_view>
#include <vector>

namespace ryx::common {

struct KeyStroke {
    int16_t keyCode = 0;  // virtual key code
    int16_t shift = 0;    // shift::Shift, Ctrl, Alt bits
    int16_t keyChar = 0;  // the character the key types, 0 for none (Home, Delete, arrows)
};

// Names in braces, any letter case: TAB, ENTER, HOME, END, DEL or DELETE, BS, BKSP or
// BACKSPACE, LEFT, RIGHT, UP, DOWN, INS or INSERT, ESC; "{+}", "{^}", "{%}", "{~}", "{{}",
// "{}}" for those characters. Prefixes "+" Shift, "^" Ctrl, "%" Alt apply to the next key.
// "~" is Enter. Anything that is not well-formed notation is taken as plain characters, so
// parsing never fails.
std::vector<KeyStroke> parseKeys(std::string_view keys);

// The keystroke that types character c ('a' is key code 65 without Shift, 'A' with it).
KeyStroke strokeForChar(char32_t c);

}  // namespace ryx::common
