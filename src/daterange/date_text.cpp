#include "ryx/date_text.h"

#include <cmath>
#include <tuple>

namespace ryx {
namespace {

constexpr char kPrompt = '_';
constexpr std::string_view kSeparators = "/-";

// The three numbers of a date text, blanks around them removed.
struct DateParts {
    std::string_view day, month, year;
};

std::string_view trimBlanks(std::string_view s) {
    while (!s.empty() && s.front() == ' ')
        s.remove_prefix(1);
    while (!s.empty() && s.back() == ' ')
        s.remove_suffix(1);
    return s;
}

std::optional<DateParts> splitDate(std::string_view text) {
    const size_t first = text.find_first_of(kSeparators);
    if (first == std::string_view::npos) return std::nullopt;
    const size_t second = text.find_first_of(kSeparators, first + 1);
    if (second == std::string_view::npos) return std::nullopt;
    if (text.find_first_of(kSeparators, second + 1) != std::string_view::npos) return std::nullopt;
    return DateParts{trimBlanks(text.substr(0, first)),
                     trimBlanks(text.substr(first + 1, second - first - 1)),
                     trimBlanks(text.substr(second + 1))};
}

// The value of a text of 1 to `maxDigits` decimal digits.
std::optional<int> digitsValue(std::string_view s, size_t maxDigits) {
    if (s.empty() || s.size() > maxDigits) return std::nullopt;
    int v = 0;
    for (char c : s) {
        if (c < '0' || c > '9') return std::nullopt;
        v = v * 10 + (c - '0');
    }
    return v;
}

// A two-digit year names a year from 1941 to 2040.
int centuryOf(int twoDigitYear) {
    return twoDigitYear > 40 ? 1900 + twoDigitYear : 2000 + twoDigitYear;
}

std::optional<int> yearValue(std::string_view s) {
    if (s.size() == 2) {
        auto twoDigits = digitsValue(s, 2);
        if (!twoDigits) return std::nullopt;
        return centuryOf(*twoDigits);
    }
    if (s.size() != 4) return std::nullopt;
    auto year = digitsValue(s, 4);
    if (!year || *year < 1000) return std::nullopt;
    return year;
}

// A text read as a whole number from 0 to 255, the way the host's byte conversion reads it
// (blanks around it, halves rounded to even); nothing when it is no such number.
std::optional<int> byteValue(std::string_view text) {
    auto v = parseNumericText(text);
    if (!v) return std::nullopt;
    const double r = std::nearbyint(*v);
    if (!(r >= 0 && r <= 255)) return std::nullopt;
    return static_cast<int>(r);
}

std::string twoDigits(int v) {
    return (v < 10 ? "0" : "") + std::to_string(v);
}

// The repaired text of a day or month field: blank or 0 gives "01", above `highest` "".
std::string validateField(std::string_view field, int highest) {
    int value = byteValue(field).value_or(0);
    if (value == 0) value = 1;
    if (value > highest) return "";
    return twoDigits(value);
}

}  // namespace

std::string d_RemovePromptChar(std::string& mMskDate) {
    for (char& c : mMskDate)
        if (c == kPrompt) c = ' ';
    return mMskDate;
}

std::string d_ValidateDay(std::string_view mMskDate) {
    return validateField(mMskDate.substr(0, 2), 31);
}

std::string d_ValidateMonth(std::string_view mMskDate) {
    if (mMskDate.size() <= 3) return validateField({}, 12);
    return validateField(mMskDate.substr(3, 2), 12);
}

Variant d_DateCheck(std::string& mDate) {
    d_RemovePromptChar(mDate);
    if (!isDate(mDate)) return Variant(mDate);
    // The numbers are read in their order: the day before the first separator, the month
    // between the two. A month above 12 (a date written month first) is taken as December.
    const DateParts parts = *splitDate(mDate);
    int day = *digitsValue(parts.day, 2);
    int month = *digitsValue(parts.month, 2);
    if (month > 12) month = 12;
    if (month == 0) month = 1;
    const int year = *yearValue(parts.year);
    if (day == 0) day = 1;
    const int lastDay = d_DaysInMonth(month, year);
    if (day > lastDay) day = lastDay;
    return Variant(formatDate({year, month, day}));
}

bool isLeapYear(int year) {
    return (year % 4 == 0 && year % 100 != 0) || year % 400 == 0;
}

uint8_t d_DaysInMonth(int month, int year) {
    switch (month) {
        case 1:
        case 3:
        case 5:
        case 7:
        case 8:
        case 10:
        case 12:
            return 31;
        case 4:
        case 6:
        case 9:
        case 11:
            return 30;
        case 2:
            return isLeapYear(year) ? 29 : 28;
        default:
            return 0;
    }
}

std::optional<CivilDate> dateOf(std::string_view text) {
    auto parts = splitDate(text);
    if (!parts) return std::nullopt;
    auto first = digitsValue(parts->day, 2);
    auto middle = digitsValue(parts->month, 2);
    auto year = yearValue(parts->year);
    if (!first || !middle || !year) return std::nullopt;
    CivilDate d{*year, *middle, *first};
    if (*middle > 12) d = {*year, *first, *middle};  // written month first
    if (d.month < 1 || d.month > 12) return std::nullopt;
    if (d.day < 1 || d.day > d_DaysInMonth(d.month, d.year)) return std::nullopt;
    return d;
}

std::string formatDate(const CivilDate& d) {
    std::string year = std::to_string(d.year);
    if (year.size() < 4) year.insert(0, 4 - year.size(), '0');
    return twoDigits(d.day) + "/" + twoDigits(d.month) + "/" + year;
}

bool earlier(const CivilDate& a, const CivilDate& b) {
    return std::tie(a.year, a.month, a.day) < std::tie(b.year, b.month, b.day);
}

bool sameDay(const CivilDate& a, const CivilDate& b) {
    return std::tie(a.year, a.month, a.day) == std::tie(b.year, b.month, b.day);
}

int financialYear(const CivilDate& d) {
    return d.month >= 4 ? d.year : d.year - 1;
}

}  // namespace ryx
