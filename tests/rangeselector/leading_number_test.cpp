#include <gtest/gtest.h>

#include <limits>

#include "ryx/range_selector.h"

namespace {

TEST(LeadingNumberTest, ReadsTheNumberAtTheStartOfAText) {
    const double inf = std::numeric_limits<double>::infinity();
    const struct {
        const char* text;
        double value;
    } cases[] = {
        {"", 0},         {"abc", 0},      {"900", 900},   {"  1000  ", 1000}, {"1 2\t3\n4", 1234},
        {"12abc34", 12}, {"-5", -5},      {"- 5", -5},    {"+7", 7},          {"3.25", 3.25},
        {".5", 0.5},     {"1.2.3", 1.2},  {"1e3", 1000},  {"2D2", 200},       {"1e", 1},
        {"1e+", 1},      {"5E-1x", 0.5},  {"-", 0},       {".", 0},           {"&H1F", 31},
        {"&hff", 255},   {" & H 10", 16}, {"&O17", 15},   {"&O19", 1},        {"&HZZ", 0},
        {"&", 0},        {"&X12", 0},     {"1e400", inf}, {"1e-400", 0},      {"-1e400", -inf},
        {"0010", 10},    {"9 99", 999},
    };
    for (const auto& c : cases)
        EXPECT_EQ(ryx::leadingNumber(c.text), c.value) << '"' << c.text << '"';
}

}  // namespace
