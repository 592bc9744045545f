#include "ryx/common/list_rows.h"

#include <gtest/gtest.h>

#include <limits>
#include <string>
#include <vector>

#include "ryx/errors.h"

namespace ryx::common {
namespace {

std::vector<std::string> texts(const ListRows& rows) {
    std::vector<std::string> all;
    for (int32_t r = 0; r < rows.count(); ++r)
        all.push_back(rows.text(r));
    return all;
}

std::string flags(const ListRows& rows) {
    std::string shown;
    for (uint8_t f : rows.flags())
        shown += f ? '1' : '0';
    return shown;
}

// Rows added one by one and many at once, in any order, keep their places; rows added at once
// are asked for their texts each time, counted from the first of their batch.
TEST(ListRows, RowsOfBothKindsInTheirOrder) {
    ListRows rows;
    int asked = 0;
    auto numbered = [&asked](std::string prefix) {
        return [&asked, prefix](int32_t i, std::string& text) {
            ++asked;
            text = prefix + std::to_string(i);
        };
    };
    rows.add("*   Others");
    rows.add(3, numbered("A"));
    rows.add(0, numbered("none"));
    rows.add("middle");
    rows.add("next");
    rows.add(2, numbered("B"));
    EXPECT_EQ(texts(rows), (std::vector<std::string>{"*   Others", "A0", "A1", "A2", "middle",
                                                     "next", "B0", "B1"}));
    EXPECT_EQ(asked, 5);
    EXPECT_EQ(rows.text(2), "A1");
    EXPECT_EQ(asked, 6);
    EXPECT_EQ(flags(rows), "00000000");

    rows.clear();  // the texts' source is let go with the rows
    EXPECT_EQ(rows.count(), 0);
    rows.add("only");
    EXPECT_EQ(texts(rows), std::vector<std::string>{"only"});
    EXPECT_THROW(rows.add(std::numeric_limits<int32_t>::max(), numbered("C")), OverflowError);
    EXPECT_EQ(rows.count(), 1);
}

// Setting a range says whether any flag changed, and leaves the flags outside it alone.
TEST(ListRows, SettingARangeReportsAChange) {
    struct Case {
        std::string before;
        int32_t first, last;
        bool v;
        std::string after;
        bool changed;
    } cases[] = {
        {"000000", 0, 5, true, "111111", true},   {"111111", 0, 5, true, "111111", false},
        {"111011", 0, 5, true, "111111", true},   {"101010", 1, 1, true, "111010", true},
        {"101010", 1, 1, false, "101010", false}, {"111111", 2, 3, false, "110011", true},
        {"100001", 1, 4, false, "100001", false}, {"011110", 0, 5, false, "000000", true},
    };
    for (const Case& c : cases) {
        ListRows rows;
        for (size_t i = 0; i < c.before.size(); ++i)
            rows.add(std::to_string(i));
        for (int32_t i = 0; i < rows.count(); ++i)
            if (c.before[static_cast<size_t>(i)] == '1') rows.setSelected(i, i, true);
        EXPECT_EQ(rows.setSelected(c.first, c.last, c.v), c.changed) << c.before;
        EXPECT_EQ(flags(rows), c.after) << c.before;
    }
}

}  // namespace
}  // namespace ryx::common
