// The date text routines of the date range control, usable without a control: they take text
// and give text, touch no widget and never raise an error.
//
// Date text is day, month, year in the layout "dd/mm/yyyy", as the masked date boxes show it
// (mask "##/##/####", prompt "_", so an empty box reads "__/__/____").
#pragma once

#include <cstdint>
#include <optional>
#include <string>
#include <string_view>

#include "ryx/host.h"
#include "ryx/variant.h"

namespace ryx {

inline constexpr std::string_view kDateMask = "##/##/####";
// The text that stands for an empty date wherever a date is passed to StartDate or EndDate.
inline constexpr std::string_view kBlankDate = "11/11/1111";

// Turns every prompt character "_" into a blank; the argument holds the result afterwards.
std::string d_RemovePromptChar(std::string& mMskDate);

// The day field (the first two characters) repaired: blank or 0 gives "01", 1 to 31 two
// digits, 32 and above "" (the caller clears the field).
std::string d_ValidateDay(std::string_view mMskDate);

// The month field (characters 4 and 5) repaired the same way: "01" to "12", or "" from 13 on.
std::string d_ValidateMonth(std::string_view mMskDate);

// A valid date normalised to "dd/mm/yyyy" (day first, a month above 12 taken as 12, a
// two-digit year placed in 1941..2040, the day limited to its month). Text that is not a
// valid date comes back without its prompt characters. The argument holds the prompt-free
// text afterwards.
Variant d_DateCheck(std::string& mDate);

// Gregorian leap years: every fourth year, except century years not divisible by 400.
bool isLeapYear(int year);

// The number of days of a month in a year; 0 for a month outside 1 to 12.
uint8_t d_DaysInMonth(int month, int year);

// The valid-date test every date rule uses: three numbers separated by "/" or "-", blanks
// around them allowed; day and month of one or two digits, a year of two digits (00-40 are
// 2000-2040, 41-99 are 1941-1999) or of four (1000 to 9999); a real calendar day. The numbers
// are read day first, and month first only when the middle one is above 12. Nothing for text
// that is not a valid date.
std::optional<CivilDate> dateOf(std::string_view text);
inline bool isDate(std::string_view text) {
    return dateOf(text).has_value();
}

// "dd/mm/yyyy"; the year written with at least four digits.
std::string formatDate(const CivilDate& d);

// Calendar order of two dates.
bool earlier(const CivilDate& a, const CivilDate& b);
bool sameDay(const CivilDate& a, const CivilDate& b);

// The financial year of a date runs from April to March; it is named by the year of its April.
int financialYear(const CivilDate& d);

}  // namespace ryx
