#include <charconv>
#include <cmath>
#include <limits>
#include <string>

#include "ryx/range_selector.h"

namespace ryx {
namespace {

bool isSkipped(char c) {
    return c == ' ' || c == '\t' || c == '\n';
}

bool isDigit(char c) {
    return c >= '0' && c <= '9';
}

int digitValue(char c, int radix) {
    int v = radix;
    if (isDigit(c)) v = c - '0';
    if (c >= 'a' && c <= 'f') v = c - 'a' + 10;
    if (c >= 'A' && c <= 'F') v = c - 'A' + 10;
    return v < radix ? v : -1;
}

double radixNumber(std::string_view digits, int radix) {
    double value = 0;
    for (char c : digits) {
        const int d = digitValue(c, radix);
        if (d < 0) break;
        value = value * radix + d;
    }
    return value;
}

// Sign, digits, decimal part and exponent at the start of s, as far as they go.
double decimalNumber(std::string_view s) {
    size_t i = 0;
    auto skipDigits = [&] {
        size_t from = i;
        while (i < s.size() && isDigit(s[i]))
            ++i;
        return i - from;
    };
    if (i < s.size() && (s[i] == '+' || s[i] == '-')) ++i;
    const size_t signEnd = i;
    size_t digits = skipDigits();
    if (i < s.size() && s[i] == '.') {
        ++i;
        digits += skipDigits();
    }
    if (digits == 0) return 0;
    size_t end = i;
    bool negativeExponent = false;
    if (i < s.size() && (s[i] == 'E' || s[i] == 'e' || s[i] == 'D' || s[i] == 'd')) {
        ++i;
        if (i < s.size() && (s[i] == '+' || s[i] == '-')) negativeExponent = s[i++] == '-';
        if (skipDigits() > 0) end = i;
    }
    // from_chars takes no "+" and no "D" exponent.
    std::string text(s.substr(signEnd, end - signEnd));
    for (char& c : text)
        if (c == 'D' || c == 'd') c = 'e';
    double value = 0;
    auto [ptr, ec] = std::from_chars(text.data(), text.data() + text.size(), value);
    if (ec == std::errc::result_out_of_range)
        value = negativeExponent ? 0.0 : std::numeric_limits<double>::infinity();
    return s[0] == '-' ? -value : value;
}

}  // namespace

double leadingNumber(std::string_view text) {
    std::string s;
    for (char c : text)
        if (!isSkipped(c)) s += c;
    if (s.size() >= 2 && s[0] == '&') {
        if (s[1] == 'H' || s[1] == 'h') return radixNumber(std::string_view(s).substr(2), 16);
        if (s[1] == 'O' || s[1] == 'o') return radixNumber(std::string_view(s).substr(2), 8);
    }
    return decimalNumber(s);
}

}  // namespace ryx
