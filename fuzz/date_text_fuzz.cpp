// The date text routines and the valid-date test on arbitrary text, and on the same bytes laid
// into the shape of a date box: no crash, no error, and
// - d_RemovePromptChar blanks the prompts and nothing else;
// - d_ValidateDay and d_ValidateMonth give "" or a field of two digits in range;
// - d_DateCheck leaves the prompt-free text in its argument, returns text that is not a date
//   unchanged, and turns a date into a valid "dd/mm/yyyy" naming the same day (a date written
//   month first comes back in December, its month capped), on which it changes nothing more;
// - every date the valid-date test accepts is a real day that survives formatting.
#include <cstddef>
#include <cstdint>
#include <cstdio>
#include <cstdlib>
#include <string>
#include <string_view>

#include "ryx/date_text.h"

namespace {

using namespace ryx;

void check(bool ok, const char* what, std::string_view text) {
    if (ok) return;
    std::fprintf(stderr, "date text: %s, for \"%.*s\"\n", what, static_cast<int>(text.size()),
                 text.data());
    std::abort();
}

bool isDigit(char c) {
    return c >= '0' && c <= '9';
}

bool isDayMonthYear(std::string_view s) {
    if (s.size() != 10 || s[2] != '/' || s[5] != '/') return false;
    for (size_t i : {0, 1, 3, 4, 6, 7, 8, 9})
        if (!isDigit(s[i])) return false;
    return true;
}

int fieldValue(std::string_view two) {
    return (two[0] - '0') * 10 + (two[1] - '0');
}

void checkField(const std::string& field, int highest, std::string_view text) {
    if (field.empty()) return;
    check(field.size() == 2 && isDigit(field[0]) && isDigit(field[1]), "field not two digits",
          text);
    const int v = fieldValue(field);
    check(v >= 1 && v <= highest, "field out of range", text);
}

bool same(const CivilDate& a, const CivilDate& b) {
    return a.year == b.year && a.month == b.month && a.day == b.day;
}

void checkValidDate(std::string_view text) {
    const auto date = dateOf(text);
    if (!date) return;
    check(date->year >= 1000 && date->year <= 9999, "year outside four digits", text);
    check(date->month >= 1 && date->month <= 12, "no such month", text);
    check(date->day >= 1 && date->day <= d_DaysInMonth(date->month, date->year), "no such day",
          text);
    const std::string shown = formatDate(*date);
    check(isDayMonthYear(shown), "formatted date not dd/mm/yyyy", text);
    const auto again = dateOf(shown);
    check(again && same(*again, *date), "formatted date reads as another day", text);
}

void checkDateCheck(const std::string& text) {
    std::string promptFree = text;
    d_RemovePromptChar(promptFree);
    std::string argument = text;
    const Variant result = d_DateCheck(argument);
    check(argument == promptFree, "argument not left prompt-free", text);
    check(result.isString(), "result not a text", text);
    const std::string checked = result.toString();
    const auto date = dateOf(promptFree);
    if (!date) {
        check(checked == promptFree, "text that is no date changed", text);
        return;
    }
    check(isDayMonthYear(checked), "date not normalised to dd/mm/yyyy", text);
    const auto normal = dateOf(checked);
    check(normal.has_value(), "normalised date not valid", text);
    // Read month first (the middle number above 12), the month is capped at December.
    check(same(*normal, *date) || same(*normal, {date->year, 12, date->month}),
          "normalised date names another day", text);
    std::string twice = checked;
    check(d_DateCheck(twice).toString() == checked && twice == checked,
          "normalising again changes the date", text);
}

void checkText(const std::string& text) {
    std::string blanked = text;
    const std::string returned = d_RemovePromptChar(blanked);
    check(returned == blanked && blanked.size() == text.size(), "prompt removal resized", text);
    for (size_t i = 0; i < text.size(); ++i)
        check(blanked[i] == (text[i] == '_' ? ' ' : text[i]), "prompt removal changed a character",
              text);
    checkField(d_ValidateDay(text), 31, text);
    checkField(d_ValidateMonth(text), 12, text);
    checkDateCheck(text);
    checkValidDate(text);
    checkValidDate(blanked);
}

// Ten bytes laid into a date box: "/" at the literal places, and each editable place a digit,
// a prompt or a blank, so that most inputs come close to a date.
std::string boxText(const uint8_t* data) {
    static constexpr std::string_view kChars = "0123456789012345678901234567890_ ";
    std::string box(10, '/');
    for (size_t i : {0, 1, 3, 4, 6, 7, 8, 9})
        box[i] = kChars[data[i] % kChars.size()];
    return box;
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size) {
    checkText(std::string(reinterpret_cast<const char*>(data), size));
    if (size >= 10) checkText(boxText(data));
    for (int month = 0; month < 256 && size > 0; month += 1 + data[0] % 16) {
        const int days = d_DaysInMonth(month, 2000 + data[size - 1]);
        check(month >= 1 && month <= 12 ? days >= 28 && days <= 31 : days == 0,
              "month length out of range", "");
    }
    return 0;
}
