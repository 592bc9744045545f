// UTF-8 text as sequences of characters: decoding, encoding and counting.
#pragma once

#include <string>
#include <string_view>

namespace ryx::common {

// Invalid bytes decode to U+FFFD each, so any byte string decodes.
std::u32string decodeUtf8(std::string_view text);
std::string encodeUtf8(std::u32string_view text);
std::string encodeUtf8(char32_t c);

}  // namespace ryx::common
