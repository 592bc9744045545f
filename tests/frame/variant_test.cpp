#include "ryx/variant.h"

#include <gtest/gtest.h>

#include "ryx/errors.h"

using ryx::Variant;

TEST(Variant, NumericTexts) {
    struct Case {
        const char* text;
        bool numeric;
        double value;
    } cases[] = {
        {"12", true, 12},    {" 12 ", true, 12},   {"-3.5", true, -3.5}, {"+7", true, 7},
        {"1e3", true, 1000}, {"2.5D2", true, 250}, {".5", true, 0.5},    {"5.", true, 5},
        {"&H1F", true, 31},  {"&o17", true, 15},   {"", false, 0},       {" ", false, 0},
        {"abc", false, 0},   {"12a", false, 0},    {"1e", false, 0},     {"&H", false, 0},
        {"&HZZ", false, 0},  {"1 2", false, 0},    {"-", false, 0},      {"1e999", false, 0},
    };
    for (const Case& c : cases) {
        SCOPED_TRACE(c.text);
        Variant v(c.text);
        EXPECT_EQ(v.isNumeric(), c.numeric);
        if (c.numeric)
            EXPECT_DOUBLE_EQ(v.toDouble(), c.value);
        else
            EXPECT_THROW(v.toDouble(), ryx::TypeMismatchError);
    }
}

TEST(Variant, RoundsHalvesToEvenAndReportsOverflowWithTheValue) {
    struct Case {
        Variant v;
        int32_t expected;
    } cases[] = {
        {0.5, 0},   {1.5, 2},   {2.5, 2},       {-2.5, -2},        {2.4999, 2},
        {"3.5", 4}, {true, -1}, {Variant(), 0}, {int16_t{-7}, -7}, {int32_t{70000}, 70000},
    };
    for (const Case& c : cases) {
        SCOPED_TRACE(c.v.describe());
        EXPECT_EQ(c.v.toInt32(), c.expected);
    }
    EXPECT_EQ(Variant(32767.4).toInt16(), 32767);
    try {
        (void)Variant(32767.5).toInt16();
        FAIL() << "no overflow";
    } catch (const ryx::OverflowError& e) {
        EXPECT_NE(std::string(e.what()).find("32767.5"), std::string::npos);
    }
    EXPECT_THROW((void)Variant(3e9).toInt32(), ryx::OverflowError);
    EXPECT_THROW((void)Variant(256).toByte(), ryx::OverflowError);
    EXPECT_THROW((void)Variant(-1).toByte(), ryx::OverflowError);
    EXPECT_EQ(Variant(255.4).toByte(), 255);
}

TEST(Variant, BooleansAndTextForms) {
    EXPECT_TRUE(Variant(int16_t{-1}).toBool());
    EXPECT_TRUE(Variant(int32_t{2}).toBool());
    EXPECT_FALSE(Variant(int16_t{0}).toBool());
    EXPECT_TRUE(Variant("True").toBool());
    EXPECT_FALSE(Variant(" false ").toBool());
    EXPECT_TRUE(Variant("-1").toBool());
    EXPECT_THROW((void)Variant("yes").toBool(), ryx::TypeMismatchError);

    EXPECT_EQ(Variant().toString(), "");
    EXPECT_EQ(Variant(true).toString(), "True");
    EXPECT_EQ(Variant(int16_t{5}).toString(), "5");
    EXPECT_EQ(Variant(0.5).toString(), "0.5");
    EXPECT_EQ(Variant(1e20).toString(), "1E+20");

    EXPECT_TRUE(Variant("+").holdsText("+"));
    EXPECT_FALSE(Variant(int16_t{1}).holdsText("1"));
    EXPECT_NE(Variant(int16_t{1}), Variant(int32_t{1}));
}
