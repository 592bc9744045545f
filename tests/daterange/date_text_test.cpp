#include "ryx/date_text.h"

#include <gtest/gtest.h>

using namespace ryx;

namespace {

TEST(DateText, RemovePromptCharBlanksEachPromptWhateverTheLength) {
    std::string cases[][2] = {{"__/__/____", "  /  /    "},
                              {"1_/0_/2___", "1 /0 /2   "},
                              {"1_/5/2000", "1 /5/2000"},
                              {"_", " "},
                              {"", ""},
                              {"15/08/2001", "15/08/2001"}};
    for (auto& [text, result] : cases) {
        EXPECT_EQ(d_RemovePromptChar(text), result);
        EXPECT_EQ(text, result);  // the argument holds the result
    }
}

TEST(DateText, ValidateDayAndMonthRepairOrRefuseTheirField) {
    const char* cases[][3] = {
        {"__/__/____", "01", "01"}, {"00/05/2000", "01", "05"}, {"7 /9 /2000", "07", "09"},
        {"31/12/2000", "31", "12"}, {"32/13/2000", "", ""},     {"99/  /2000", "", "01"},
        {"ab/cd/efgh", "01", "01"}, {"-1/+3/2000", "01", "03"}, {"", "01", "01"}};
    for (auto [text, day, month] : cases) {
        EXPECT_EQ(d_ValidateDay(text), day) << text;
        EXPECT_EQ(d_ValidateMonth(text), month) << text;
    }
}

TEST(DateText, DateCheckNormalisesValidDatesAndReturnsOtherTextPromptFree) {
    const char* cases[][2] = {
        {"1_/5_/2000", "01/05/2000"},    {"01/05/00__", "01/05/2000"},
        {"01/05/41__", "01/05/1941"},    {"01/05/40__", "01/05/2040"},
        {"05/13/2000", "05/12/2000"},  // valid read month first; the month is capped
        {"5/6/2001", "05/06/2001"},    // the month is the middle number
        {"31 /12  /2000", "31/12/2000"}, {"5-6-2001", "05/06/2001"},
        {"29/02/2000", "29/02/2000"},    {"29/02/1900", "29/02/1900"},
        {"ab/cd/efgh", "ab/cd/efgh"},    {"__/__/____", "  /  /    "}};
    for (auto [text, result] : cases) {
        std::string argument = text;
        const Variant checked = d_DateCheck(argument);
        EXPECT_TRUE(checked.isString());
        EXPECT_EQ(checked.toString(), result) << text;
        std::string promptFree = text;
        EXPECT_EQ(argument, d_RemovePromptChar(promptFree));
    }
}

TEST(DateText, TheValidDateTest) {
    const char* valid[][2] = {
        {"15/08/2001", "15/08/2001"}, {" 1/ 5/2000", "01/05/2000"}, {"1 /5 /2000 ", "01/05/2000"},
        {"05/13/2000", "13/05/2000"}, {"5-6-01", "05/06/2001"},     {"01/05/41", "01/05/1941"},
        {"29/02/2000", "29/02/2000"}, {"29/02/2004", "29/02/2004"}};  // leap years
    for (auto [text, date] : valid) {
        ASSERT_TRUE(isDate(text)) << text;
        EXPECT_EQ(formatDate(*dateOf(text)), date);
    }
    for (const char* text :
         {"29/02/1900", "29/02/2001", "31/04/2000", "00/05/2000", "13/13/2000", "01/05/200",
          "01/05/0999", "011/05/2000", "1 5/05/2000", "1/5/2000/1", "15.08.2001", "  /  /    ", ""})
        EXPECT_FALSE(isDate(text)) << text;
}

// Found in review: a two-character year that is not a number ("ab") was read through an empty
// value, so "01/05/ab" could pass as a date and come back with a year of garbage.
TEST(DateText, ATwoCharacterYearThatIsNoNumberIsNoDate) {
    for (const char* text : {"01/05/ab", "01/05/1a", "01/05/ 1x", "01/05/-1"}) {
        EXPECT_FALSE(isDate(text)) << text;
        std::string box = text;
        EXPECT_EQ(d_DateCheck(box), Variant(std::string(text))) << text;
    }
}

}  // namespace
