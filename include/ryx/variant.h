// ryx::Variant: the value of a property that accepts more than one kind of value
// (DefaultSetting, StartDate, MaxLength, an event's Index, an entry of a property bag).
#pragma once

#include <cstdint>
#include <optional>
#include <string>
#include <string_view>
#include <variant>

namespace ryx {

class Variant {
  public:
    enum class Type { Empty, Boolean, Integer, Long, Double, String };

    Variant() = default;
    Variant(bool v) : value_(v) {}
    Variant(int16_t v) : value_(v) {}
    Variant(int32_t v) : value_(v) {}
    Variant(double v) : value_(v) {}
    Variant(std::string v) : value_(std::move(v)) {}
    Variant(const char* v) : value_(std::string(v)) {}
    Variant(std::string_view v) : value_(std::string(v)) {}

    Type type() const { return static_cast<Type>(value_.index()); }
    bool isEmpty() const { return type() == Type::Empty; }
    bool isString() const { return type() == Type::String; }

    // True for numbers and Booleans, and for a text that reads wholly as a number
    // (blanks around it, a sign, decimals, an exponent, or an "&H"/"&O" prefix).
    bool isNumeric() const;

    // True when the Variant holds a text equal to `text` (no conversion of other kinds).
    bool holdsText(std::string_view text) const;

    // Text form: "" for Empty, "True"/"False" for a Boolean, the shortest decimal form of a
    // number ("2", "0.5", "1E+20").
    std::string toString() const;

    // Numeric value; a non-numeric text or an Empty value is a TypeMismatchError
    // (Empty reads as 0, as in the host's conversions).
    double toDouble() const;

    // Rounded to the nearest whole number, halves to the even neighbour; OverflowError names
    // the value when it does not fit.
    int16_t toInt16() const;
    int32_t toInt32() const;
    uint8_t toByte() const;

    // Non-zero numbers are true; texts "True"/"False" (any case) or numeric texts convert.
    bool toBool() const;

    // A short description for error messages: the kind and the value ("text \"abc\"").
    std::string describe() const;

    friend bool operator==(const Variant& a, const Variant& b) { return a.value_ == b.value_; }

  private:
    std::variant<std::monostate, bool, int16_t, int32_t, double, std::string> value_;
};

// Reads a text as a number the way the host's numeric conversions do: the whole text must be
// a number, with optional blanks around it. "&H1F" and "&O17" are hexadecimal and octal.
std::optional<double> parseNumericText(std::string_view text);

// Rounds half to even and checks the range; `what` names the value in the error message.
int32_t roundToInt32(double v, std::string_view what);
int16_t roundToInt16(double v, std::string_view what);

}  // namespace ryx
