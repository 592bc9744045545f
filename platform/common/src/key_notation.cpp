#include "ryx/common/key_notation.h"

#include <array>
#include <optional>

#include "ryx/common/utf8.h"
#include "ryx/host.h"

namespace ryx::common {

namespace {

// The keys of the US keyboard that type a printable ASCII character: the key code, the
// character it types alone and the one it types with Shift.
struct CharKey {
    int16_t keyCode;
    char plain;
    char shifted;
};

constexpr std::array<CharKey, 22> kSymbolKeys{{
    {vk::Space, ' ', ' '}, {48, '0', ')'},   {49, '1', '!'},  {50, '2', '@'},  {51, '3', '#'},
    {52, '4', '$'},        {53, '5', '%'},   {54, '6', '^'},  {55, '7', '&'},  {56, '8', '*'},
    {57, '9', '('},        {186, ';', ':'},  {187, '=', '+'}, {188, ',', '<'}, {189, '-', '_'},
    {190, '.', '>'},       {191, '/', '?'},  {192, '`', '~'}, {219, '[', '{'}, {220, '\\', '|'},
    {221, ']', '}'},       {222, '\'', '"'},
}};

bool isAsciiLetterKey(int16_t keyCode) {
    return keyCode >= 'A' && keyCode <= 'Z';
}

// The character that key `keyCode` types with the modifiers `shift`.
int16_t charForKey(int16_t keyCode, int16_t shift) {
    const bool withShift = (shift & shift::Shift) != 0;
    const bool withCtrl = (shift & shift::Ctrl) != 0;
    if ((shift & shift::Alt) != 0) return 0;  // Alt keys type no character
    switch (keyCode) {
        case vk::Return:
            return withCtrl ? 10 : 13;
        case vk::Back:
            return withCtrl ? 127 : 8;
        case vk::Escape:
            return withCtrl ? 0 : 27;
        default:
            break;
    }
    if (isAsciiLetterKey(keyCode)) {
        if (withCtrl) return static_cast<int16_t>(keyCode - 'A' + 1);
        return withShift ? keyCode : static_cast<int16_t>(keyCode - 'A' + 'a');
    }
    if (withCtrl) {
        // The control characters that Ctrl types on symbol keys.
        switch (keyCode) {
            case 219:
                return 27;
            case 220:
                return 28;
            case 221:
                return 29;
            case 54:
                return withShift ? 30 : 0;
            case 189:
                return withShift ? 31 : 0;
            case vk::Space:
                return ' ';
            default:
                return 0;
        }
    }
    for (const CharKey& k : kSymbolKeys) {
        if (k.keyCode == keyCode) return withShift ? k.shifted : k.plain;
    }
    return 0;  // Tab, Home, Delete, the arrows...
}

struct KeyName {
    std::string_view name;
    int16_t keyCode;
};

constexpr std::array<KeyName, 17> kKeyNames{{
    {"TAB", vk::Tab},
    {"ENTER", vk::Return},
    {"HOME", vk::Home},
    {"END", vk::End},
    {"DEL", vk::Delete},
    {"DELETE", vk::Delete},
    {"BS", vk::Back},
    {"BKSP", vk::Back},
    {"BACKSPACE", vk::Back},
    {"LEFT", vk::Left},
    {"RIGHT", vk::Right},
    {"UP", vk::Up},
    {"DOWN", vk::Down},
    {"INS", vk::Insert},
    {"INSERT", vk::Insert},
    {"ESC", vk::Escape},
    {"ESCAPE", vk::Escape},
}};

std::optional<int16_t> namedKey(std::u32string_view name) {
    for (const KeyName& k : kKeyNames) {
        if (k.name.size() != name.size()) continue;
        bool same = true;
        for (size_t i = 0; i < name.size() && same; ++i) {
            char32_t c = name[i];
            if (c >= U'a' && c <= U'z') c -= U'a' - U'A';
            same = c == static_cast<unsigned char>(k.name[i]);
        }
        if (same) return k.keyCode;
    }
    return std::nullopt;
}

KeyStroke withModifiers(KeyStroke stroke, int16_t modifiers) {
    if (modifiers == 0) return stroke;
    stroke.shift = static_cast<int16_t>(stroke.shift | modifiers);
    if (stroke.keyCode != 0) {
        stroke.keyChar = charForKey(stroke.keyCode, stroke.shift);
    } else if ((stroke.shift & (shift::Ctrl | shift::Alt)) != 0) {
        stroke.keyChar = 0;  // a character without a key types nothing with Ctrl or Alt
    }
    return stroke;
}

}  // namespace

KeyStroke strokeForChar(char32_t c) {
    if (c >= 'a' && c <= 'z') {
        const auto code = static_cast<int16_t>(c - 'a' + 'A');
        return {code, 0, static_cast<int16_t>(c)};
    }
    if (c >= 'A' && c <= 'Z') {
        return {static_cast<int16_t>(c), shift::Shift, static_cast<int16_t>(c)};
    }
    for (const CharKey& k : kSymbolKeys) {
        if (static_cast<unsigned char>(k.plain) == c) return {k.keyCode, 0, k.plain};
        if (static_cast<unsigned char>(k.shifted) == c) return {k.keyCode, shift::Shift, k.shifted};
    }
    switch (c) {
        case '\b':
            return {vk::Back, 0, 8};
        case '\t':
            return {vk::Tab, 0, 0};
        case '\r':
            return {vk::Return, 0, 13};
        case '\n':
            return {vk::Return, shift::Ctrl, 10};
        case 27:
            return {vk::Escape, 0, 27};
        case 127:
            return {vk::Back, shift::Ctrl, 127};
        case 0:
            return {50, shift::Ctrl | shift::Shift, 0};
        case 28:
            return {220, shift::Ctrl, 28};
        case 29:
            return {221, shift::Ctrl, 29};
        case 30:
            return {54, shift::Ctrl | shift::Shift, 30};
        case 31:
            return {189, shift::Ctrl | shift::Shift, 31};
        default:
            break;
    }
    if (c >= 1 && c <= 26) {
        return {static_cast<int16_t>('A' + c - 1), shift::Ctrl, static_cast<int16_t>(c)};
    }
    if (c <= 0xFFFF) return {0, 0, static_cast<int16_t>(static_cast<uint16_t>(c))};
    return {};  // beyond the 16-bit key characters: no keystroke types it
}

std::vector<KeyStroke> parseKeys(std::string_view keys) {
    const std::u32string text = decodeUtf8(keys);
    std::vector<KeyStroke> strokes;
    int16_t modifiers = 0;
    size_t prefixStart = 0;  // where the pending prefixes began
    auto emit = [&](KeyStroke stroke) {
        strokes.push_back(withModifiers(stroke, modifiers));
        modifiers = 0;
    };
    auto emitChar = [&](char32_t c) {
        if (c > 0xFFFF) {
            modifiers = 0;  // no keystroke types it
            return;
        }
        emit(strokeForChar(c));
    };

    size_t i = 0;
    while (i < text.size()) {
        const char32_t c = text[i];
        if (c == U'+' || c == U'^' || c == U'%') {
            if (modifiers == 0) prefixStart = i;
            modifiers = static_cast<int16_t>(modifiers | (c == U'+'   ? shift::Shift
                                                          : c == U'^' ? shift::Ctrl
                                                                      : shift::Alt));
            ++i;
            continue;
        }
        if (c == U'~') {
            emit({vk::Return, 0, 13});
            ++i;
            continue;
        }
        if (c == U'{') {
            // "{}}" names the closing brace; otherwise the name runs to the first "}".
            if (i + 2 < text.size() && text[i + 1] == U'}' && text[i + 2] == U'}') {
                emitChar(U'}');
                i += 3;
                continue;
            }
            const size_t close = text.find(U'}', i + 1);
            if (close != std::u32string::npos && close > i + 1) {
                const std::u32string_view name(text.data() + i + 1, close - i - 1);
                if (name.size() == 1) {
                    emitChar(name[0]);
                    i = close + 1;
                    continue;
                }
                if (const auto code = namedKey(name)) {
                    emit({*code, 0, charForKey(*code, 0)});
                    i = close + 1;
                    continue;
                }
            }
            // Not a well-formed name: the brace is a plain character.
        }
        emitChar(c);
        ++i;
    }
    // Prefixes with no key after them are plain characters.
    if (modifiers != 0) {
        modifiers = 0;
        for (size_t k = prefixStart; k < text.size(); ++k)
            emitChar(text[k]);
    }
    return strokes;
}

}  // namespace ryx::common
