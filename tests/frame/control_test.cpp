#include "ryx/control.h"

#include <gtest/gtest.h>

#include "ryx/property_bag.h"

using namespace ryx;

TEST(PropertyBag, KeysMatchWithoutRegardToCaseAndKeepTheLastSpelling) {
    MemoryPropertyBag bag;
    bag.writeProperty("BackColor", int32_t{1}, int32_t{0});
    bag.writeProperty("Backcolor", int32_t{2}, int32_t{0});
    ASSERT_EQ(bag.entries().size(), 1u);
    EXPECT_EQ(bag.entries()[0].key, "Backcolor");
    EXPECT_EQ(bag.readProperty("BACKCOLOR", 0).toInt32(), 2);
    EXPECT_EQ(bag.readProperty("Missing", "def"), Variant("def"));
    EXPECT_FALSE(keysEqual("Maxlength", "MaxLengthX"));
    EXPECT_TRUE(keysEqual("Maxlength", "MAXLENGTH"));
}

TEST(PropertyLoader, ABadKeyIsSkippedAndLoadingGoesOn) {
    MemoryPropertyBag bag;
    bag.writeProperty("A", "not a number", Variant());
    bag.putUnreadable("B", "an array");
    bag.writeProperty("C", int16_t{7}, Variant());
    int a = -1, b = -1, c = -1, d = -1;
    PropertyLoader load(bag);
    load.key("A", 1, [&](const Variant& v) { a = v.toInt32(); });
    load.key("B", 2, [&](const Variant& v) { b = v.toInt32(); });
    load.step([&] { throw WidgetError("a widget refused"); });
    load.key("C", 3, [&](const Variant& v) { c = v.toInt32(); });
    load.key("D", 4, [&](const Variant& v) { d = v.toInt32(); });
    EXPECT_EQ(a, -1);
    EXPECT_EQ(b, -1);
    EXPECT_EQ(c, 7);
    EXPECT_EQ(d, 4);
}

TEST(GuardScope, ClearsItsFlagOnEveryWayOut) {
    bool guard = false;
    {
        GuardScope g(guard);
        EXPECT_TRUE(guard);
    }
    EXPECT_FALSE(guard);
    try {
        GuardScope g(guard);
        throw std::runtime_error("host handler failed");
    } catch (const std::runtime_error&) {
    }
    EXPECT_FALSE(guard);
}
