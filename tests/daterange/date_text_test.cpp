#include "ryx/date_text.h"

#include <gtest/gtest.h>

using namespace ryx;

namespace {

TEST(DateText, RemovePromptCharBlanksEachPromptWhateverTheLength) {
    struct Case {
        std::string text, result;
    } cases[] = {
        {"__/__/____", "  /  /    "},
        {"1_/0_/2___", "1 /0 /2   "},
        {"1_/5/2000", "1 /5/2000"},
        {"_", " "},
        {"", ""},
        {"15/08/2001", "15/08/2001"},
    };
    for (Case& c : cases) {
        EXPECT_EQ(d_RemovePromptChar(c.text), c.result);
        EXPECT_EQ(c.text, c.result);  // the argument holds the result
    }
}

TEST(DateText, ValidateDayAndMonthRepairOrRefuseTheirField) {
    struct Case {
        const char* text;
        const char* day;
        const char* month;
    } cases[] = {
        {"__/__/____", "01", "01"}, {"00/05/2000", "01", "05"}, {"7 /9 /2000", "07", "09"},
        {"31/12/2000", "31", "12"}, {"32/13/2000", "", ""},     {"99/  /2000", "", "01"},
        {"ab/cd/efgh", "01", "01"}, {"-1/+3/2000", "01", "03"}, {"", "01", "01"},
    };
    for (const Case& c : cases) {
        SCOPED_TRACE(c.text);
        EXPECT_EQ(d_ValidateDay(c.text), c.day);
        EXPECT_EQ(d_ValidateMonth(c.text), c.month);
    }
}

TEST(DateText, DateCheckNormalisesValidDatesAndReturnsOtherTextPromptFree) {
    struct Case {
        std::string text;
        const char* result;
        const char* argument;  // "": the text was unchanged
    } cases[] = {
        {"1_/5_/2000", "01/05/2000", "1 /5 /2000"},
        {"01/05/00__", "01/05/2000", "01/05/00  "},
        {"01/05/41__", "01/05/1941", "01/05/41  "},
        {"01/05/40__", "01/05/2040", "01/05/40  "},
        {"05/13/2000", "05/12/2000", "05/13/2000"},  // valid month first; the month is capped
        {"5/6/2001", "05/06/2001", ""},              // the month is the middle number
        {"31 /12  /2000", "31/12/2000", ""},
        {"5-6-2001", "05/06/2001", ""},
        {"29/02/2000", "29/02/2000", ""},
        {"29/02/1900", "29/02/1900", ""},  // no such day: not a date
        {"ab/cd/efgh", "ab/cd/efgh", ""},
        {"__/__/____", "  /  /    ", "  /  /    "},
    };
    for (Case& c : cases) {
        SCOPED_TRACE(c.text);
        const std::string before = c.text;
        const Variant result = d_DateCheck(c.text);
        EXPECT_TRUE(result.isString());
        EXPECT_EQ(result.toString(), c.result);
        EXPECT_EQ(c.text, *c.argument ? c.argument : before);
    }
}

TEST(DateText, TheValidDateTest) {
    struct Case {
        const char* text;
        CivilDate date;  // year 0: not a valid date
    } cases[] = {
        {"15/08/2001", {2001, 8, 15}},
        {" 1/ 5/2000", {2000, 5, 1}},
        {"1 /5 /2000 ", {2000, 5, 1}},
        {"05/13/2000", {2000, 5, 13}},  // the middle number above 12: month first
        {"5-6-01", {2001, 6, 5}},
        {"01/05/40", {2040, 5, 1}},
        {"01/05/41", {1941, 5, 1}},
        {"29/02/2000", {2000, 2, 29}},
        {"29/02/2004", {2004, 2, 29}},
        {"31/12/9999", {9999, 12, 31}},
        {"29/02/1900", {}},
        {"29/02/2001", {}},
        {"31/04/2000", {}},
        {"00/05/2000", {}},
        {"13/13/2000", {}},
        {"01/05/200", {}},
        {"01/05/0999", {}},
        {"011/05/2000", {}},
        {"1 5/05/2000", {}},
        {"1/5/2000/1", {}},
        {"15.08.2001", {}},
        {"  /  /    ", {}},
        {"__/__/____", {}},
        {"", {}},
    };
    for (const Case& c : cases) {
        SCOPED_TRACE(c.text);
        const auto date = dateOf(c.text);
        ASSERT_EQ(date.has_value(), c.date.year != 0);
        if (date) {
            EXPECT_TRUE(sameDay(*date, c.date));
        }
    }
}

TEST(DateText, MonthLengthsFollowTheGregorianLeapYears) {
    struct Case {
        int month, year, days;
    } cases[] = {
        {1, 2001, 31}, {2, 2001, 28},  {2, 2004, 29}, {2, 1900, 28}, {2, 2000, 29},
        {4, 2001, 30}, {12, 2001, 31}, {0, 2001, 0},  {13, 2001, 0},
    };
    for (const Case& c : cases)
        EXPECT_EQ(d_DaysInMonth(c.month, c.year), c.days) << c.month << "/" << c.year;
}

}  // namespace
