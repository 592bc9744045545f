#include "ryx/variant.h"

#include <charconv>
#include <cmath>
#include <limits>

#include "ryx/errors.h"

namespace ryx {
namespace {

bool isBlank(char c) {
    return c == ' ' || c == '\t';
}

std::string_view trimBlanks(std::string_view s) {
    while (!s.empty() && isBlank(s.front()))
        s.remove_prefix(1);
    while (!s.empty() && isBlank(s.back()))
        s.remove_suffix(1);
    return s;
}

std::optional<double> parseRadix(std::string_view digits, int radix) {
    if (digits.empty() || digits.size() > 22) return std::nullopt;
    uint64_t v = 0;
    auto [end, ec] = std::from_chars(digits.data(), digits.data() + digits.size(), v, radix);
    if (ec != std::errc() || end != digits.data() + digits.size()) return std::nullopt;
    return static_cast<double>(v);
}

// Sign, digits, an optional decimal part and an optional exponent, and nothing else.
std::optional<double> parseDecimal(std::string_view s) {
    size_t i = 0;
    auto digitsAt = [&](size_t from) {
        size_t j = from;
        while (j < s.size() && s[j] >= '0' && s[j] <= '9')
            ++j;
        return j - from;
    };
    if (i < s.size() && (s[i] == '+' || s[i] == '-')) ++i;
    size_t whole = digitsAt(i);
    i += whole;
    size_t fraction = 0;
    if (i < s.size() && s[i] == '.') {
        fraction = digitsAt(i + 1);
        i += 1 + fraction;
    }
    if (whole + fraction == 0) return std::nullopt;
    if (i < s.size() && (s[i] == 'e' || s[i] == 'E' || s[i] == 'd' || s[i] == 'D')) {
        size_t j = i + 1;
        if (j < s.size() && (s[j] == '+' || s[j] == '-')) ++j;
        size_t exponent = digitsAt(j);
        if (exponent == 0) return std::nullopt;
        i = j + exponent;
    }
    if (i != s.size()) return std::nullopt;
    std::string text(s);
    for (char& c : text)
        if (c == 'd' || c == 'D') c = 'e';
    if (!text.empty() && text.front() == '+') text.erase(0, 1);
    double v = 0;
    auto [end, ec] = std::from_chars(text.data(), text.data() + text.size(), v);
    if (ec == std::errc::result_out_of_range) return std::nullopt;
    if (ec != std::errc() || end != text.data() + text.size()) return std::nullopt;
    return v;
}

std::string formatDouble(double v) {
    char buf[64];
    auto [end, ec] = std::to_chars(buf, buf + sizeof buf, v);
    std::string text(buf, ec == std::errc() ? end : buf);
    for (char& c : text)
        if (c == 'e') c = 'E';
    return text;
}

double roundHalfEven(double v) {
    double r = std::nearbyint(v);  // the default rounding mode takes halves to even
    return r;
}

}  // namespace

std::optional<double> parseNumericText(std::string_view text) {
    std::string_view s = trimBlanks(text);
    if (s.size() > 2 && s[0] == '&') {
        if (s[1] == 'h' || s[1] == 'H') return parseRadix(s.substr(2), 16);
        if (s[1] == 'o' || s[1] == 'O') return parseRadix(s.substr(2), 8);
    }
    return parseDecimal(s);
}

int32_t roundToInt32(double v, std::string_view what) {
    double r = roundHalfEven(v);
    if (!(r >= std::numeric_limits<int32_t>::min() && r <= std::numeric_limits<int32_t>::max()))
        throw OverflowError(std::string(what) + " does not fit a 32-bit integer");
    return static_cast<int32_t>(r);
}

int16_t roundToInt16(double v, std::string_view what) {
    double r = roundHalfEven(v);
    if (!(r >= std::numeric_limits<int16_t>::min() && r <= std::numeric_limits<int16_t>::max()))
        throw OverflowError(std::string(what) + " does not fit a 16-bit integer");
    return static_cast<int16_t>(r);
}

bool Variant::isNumeric() const {
    switch (type()) {
        case Type::Boolean:
        case Type::Integer:
        case Type::Long:
        case Type::Double:
            return true;
        case Type::String:
            return parseNumericText(std::get<std::string>(value_)).has_value();
        case Type::Empty:
            return false;
    }
    return false;
}

bool Variant::holdsText(std::string_view text) const {
    return isString() && std::get<std::string>(value_) == text;
}

std::string Variant::toString() const {
    switch (type()) {
        case Type::Empty:
            return "";
        case Type::Boolean:
            return std::get<bool>(value_) ? "True" : "False";
        case Type::Integer:
            return std::to_string(std::get<int16_t>(value_));
        case Type::Long:
            return std::to_string(std::get<int32_t>(value_));
        case Type::Double:
            return formatDouble(std::get<double>(value_));
        case Type::String:
            return std::get<std::string>(value_);
    }
    return "";
}

std::string Variant::describe() const {
    switch (type()) {
        case Type::Empty:
            return "an empty value";
        case Type::Boolean:
            return "the Boolean " + toString();
        case Type::String:
            return "the text \"" + toString() + "\"";
        default:
            return "the number " + toString();
    }
}

double Variant::toDouble() const {
    switch (type()) {
        case Type::Empty:
            return 0;
        case Type::Boolean:
            return std::get<bool>(value_) ? -1 : 0;
        case Type::Integer:
            return std::get<int16_t>(value_);
        case Type::Long:
            return std::get<int32_t>(value_);
        case Type::Double:
            return std::get<double>(value_);
        case Type::String: {
            if (auto v = parseNumericText(std::get<std::string>(value_))) return *v;
            throw TypeMismatchError(describe() + " is not a number");
        }
    }
    return 0;
}

int16_t Variant::toInt16() const {
    return roundToInt16(toDouble(), describe());
}

int32_t Variant::toInt32() const {
    return roundToInt32(toDouble(), describe());
}

uint8_t Variant::toByte() const {
    double r = roundHalfEven(toDouble());
    if (!(r >= 0 && r <= 255)) throw OverflowError(describe() + " does not fit a byte (0 to 255)");
    return static_cast<uint8_t>(r);
}

bool Variant::toBool() const {
    if (type() == Type::Boolean) return std::get<bool>(value_);
    if (type() == Type::String) {
        std::string_view s = trimBlanks(std::get<std::string>(value_));
        auto same = [&](std::string_view word) {
            if (s.size() != word.size()) return false;
            for (size_t i = 0; i < s.size(); ++i)
                if ((s[i] | 0x20) != word[i]) return false;
            return true;
        };
        if (same("true")) return true;
        if (same("false")) return false;
    }
    return toDouble() != 0;
}

}  // namespace ryx
