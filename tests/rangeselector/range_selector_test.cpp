#include "ryx/range_selector.h"

#include <gtest/gtest.h>

#include <ranges>

#include "form_fixture.h"
#include "ryx/headless/form.h"
#include "ryx/headless/form_file.h"

using namespace ryx;
using namespace ryx::headless;

namespace {

class RangeSelectorTest : public ::testing::Test {
  protected:
    void SetUp() override {
        before = &form.addTextBox("txtBefore");
        rs = &form.add<RYXRangeSelector>("rs");
        after = &form.addTextBox("txtAfter");
        site = &form.site("rs");
        pop = &site->child<HCommandButton>("cmdpop");
        frame = &site->child<HFrame>("fraRangeSelector");
        footer = &site->child<HLabel>("lblFooter");
        site->clearRecords();
    }
    HTextBox& box(int16_t i) const { return site->child<HTextBox>("RYXT", i); }
    void typeIn(int16_t i, std::string_view text, int32_t type) {
        rs->setTextType(static_cast<RYXRgSelTxtType>(type));
        form.setFocus(box(i));
        form.type(text);
    }
    std::vector<int> buttonClicks() const {
        std::vector<int> indexes;
        for (const auto& e : form.events())
            if (e.id == EventId::ButtonClick) indexes.push_back(e.args.Index.toInt16());
        return indexes;
    }

    Form form;
    RYXRangeSelector* rs = nullptr;
    Site* site = nullptr;
    HCommandButton* pop = nullptr;
    HFrame* frame = nullptr;
    HLabel* footer = nullptr;
    HTextBox *before = nullptr, *after = nullptr;
};

TEST_F(RangeSelectorTest, TypingIsFilteredByTextTypeBackspaceIncluded) {
    const struct {
        int32_t type;
        const char *typed, *shown, *afterBackspace;
    } cases[] = {{0, "a-b", "AB", "A"},   {0, "12a 3", "12A 3", "12A "}, {0, "~`{}", "", ""},
                 {2, "a-b", "a-b", "a-"}, {2, "12a 3", "12a 3", "12a "}, {7, "a-b", "a-b", "a-"},
                 {1, "a-b", "", ""},      {1, "12a 3", "12 3", "12 3"}};
    for (const auto& c : cases) {
        box(1).setText("");
        typeIn(1, c.typed, c.type);
        EXPECT_EQ(rs->EndText(), c.shown) << c.type << c.typed;
        form.press(vk::Back);
        EXPECT_EQ(rs->EndText(), c.afterBackspace) << c.type << c.typed;
    }
    form.keys("{HOME}{DEL}");  // Delete types no character: it deletes even in a digits box
    EXPECT_EQ(rs->EndText(), "2 3");
}

TEST_F(RangeSelectorTest, TheHostSeesTheKeyAfterTheFilterAndMayPutOneBack) {
    std::vector<int16_t> seen;
    site->onEvent = [&](EventId id, EventArgs& a) {
        if (id != EventId::KeyPress) return;
        seen.push_back(a.KeyAscii);
        EXPECT_EQ(a.Index, Variant(int16_t{0}));
        if (seen.size() == 2) a.KeyAscii = '-';
    };
    typeIn(0, "a-b\r", RYXANUAlphaNumeric);
    EXPECT_EQ(seen, (std::vector<int16_t>{'A', 0, 'B', 0}));  // the Enter is 0 to the host
    EXPECT_EQ(rs->StartText(), "A-B");
    EXPECT_EQ(form.focused(), &box(1));
}

TEST_F(RangeSelectorTest, InsertToggleOverwritesPrintableCharacters) {
    const struct {
        int32_t type, selStart, selLength;
        const char *typed, *shown;
    } cases[] = {{1, 1, 0, "9", "1967"},
                 {1, 4, 0, "9", "15679"},
                 {1, 1, 2, "9", "197"},
                 {2, 2, 0, "\b", "167"},   // Backspace still deletes before the caret
                 {1, 1, 0, "a", "1567"}};  // a dropped letter leaves the next digit selected
    form.setInsertToggle(true);
    for (const auto& c : cases) {
        box(0).setText("1567");
        rs->setSelStart(0, c.selStart);
        rs->setSellength(0, c.selLength);
        typeIn(0, c.typed, c.type);
        EXPECT_EQ(rs->StartText(), c.shown) << c.typed << " at " << c.selStart;
    }
    EXPECT_EQ(rs->Sellength(0), Variant(int32_t{1}));
}

TEST_F(RangeSelectorTest, EnterUpAndDownMoveAlongTheTabOrder) {
    form.setFocus(*before);
    form.tab();  // the control passes the focus on to the start box
    ASSERT_EQ(form.focused(), &box(0));
    const struct {
        int16_t key;
        Node* to;
    } moves[] = {{vk::Return, &box(1)},
                 {vk::Up, &box(0)},
                 {vk::Up, pop},
                 {vk::Down, &box(1)},
                 {vk::Return, after}};
    for (const auto& m : moves) {
        if (m.key == vk::Down) form.setFocus(box(0));
        form.press(m.key);
        EXPECT_EQ(form.focused(), m.to) << m.key;
    }
}

TEST_F(RangeSelectorTest, ButtonClickReportsTheBoxTheButtonServes) {
    form.click(*pop);    // 0: no box had the focus yet
    form.click(box(1));  // the button moves beside the end box
    form.click(*pop);    // 1
    form.click(box(0));
    form.click(*pop);  // 0
    form.click(box(1));
    rs->setControlType("name");
    form.click(*pop);  // 0: ControlType puts the button back
    form.setFocus(box(1));
    form.press('P', shift::Alt);  // 1, once
    form.press('P');              // P alone is typed like any letter
    rs->setButtonVisible(false);
    form.press('P', shift::Alt);  // 1: the hidden button still answers
    EXPECT_EQ(buttonClicks(), (std::vector<int>{0, 1, 0, 0, 1, 1}));
    EXPECT_EQ(rs->EndText(), "p");

    rs->setButtonVisible(true);
    for (bool locked : {true, false}) {
        rs->setLocked(locked);
        rs->setEnabled(locked);
        form.press('P', shift::Alt);
        form.click(*pop);
        form.click(box(1));
    }
    EXPECT_EQ(buttonClicks().size(), 6u);
    EXPECT_EQ(ryx::testing::countEvents(form, "rs", EventId::Click), 3);  // the box clicks before
}

TEST_F(RangeSelectorTest, StartAndEndTexts) {
    const struct {
        const char *type, *start, *end;
        bool taken;
    } cases[] = {{"policyno", "900", "1000", true}, {"name", "900", "1000", false},
                 {"name", "900", "A", true},        {"name", "", "000", true},
                 {"name", "900", "900", true},      {"PLAN", "12", "9", false},
                 {"plan", "12", " 1 2x", true},     {"policyno", "900", "", true},
                 {"name", "B", "", true},           {"phspolicyno", "900", "1000", false}};
    for (const auto& c : cases) {
        rs->setControlType(c.type);
        box(1).setText("old");
        form.setFocus(*after);
        rs->setStartText(c.start);
        EXPECT_EQ(form.focused(), &box(1));
        rs->setEndText(c.end);
        EXPECT_EQ(rs->EndText(), c.taken ? c.end : "old") << c.type << " " << c.start;
    }
    rs->setControlType("date");
    form.setFocus(*after);
    rs->setStartText(" 5 ");  // the end box is hidden: no error, the focus stays
    EXPECT_EQ(rs->StartText(), " 5 ");
    EXPECT_EQ(form.focused(), after);
    form.focusControl(*site);  // nor when the control itself gets the focus
    form.press(vk::Return);    // Enter on the surface moves on
    EXPECT_EQ(form.focused(), after);
}

TEST_F(RangeSelectorTest, EveryControlTypeSetsCaptionsLengthAndFilter) {
    const struct {
        const char *keys, *word;  // keys that share one outcome, separated by "|"
        int32_t length, type;     // type 7: the filter in force stays
    } rows[] = {{"policyno|phspolicyno|filterpolicyno|PolicyNo", "Policies", 10, 1},
                {"name|filterclient|filtername", "Clients", 21, 2},
                {"phsname", "Clients", 25, 2},
                {"phsperson", "Persons", 21, 2},
                {"familycode|phsfamily|filterfamily", "Families", 4, 0},
                {"branchno", "Branches", 4, 0},
                {"location", "Locations", 20, 2},
                {"pincode", "PinCodes", 6, 1},
                {"plan", "Plans", 3, 1},
                {"proposalno|filterproposalno", "Proposals", 10, 1},
                {"phsdept", "Department", 4, 7},
                {"bankbranchrec|bankbranchppf", "Bank Branch", 15, 2},
                {"accountnorec|accountnoppf", "Account No.", 10, 2},
                {"companynamesch", "Company Name", 25, 2},
                {"applicationnosch|applicationnofd", "Application No.", 10, 2},
                {"applicationnoulip", "Application No.", 20, 2},
                {"certificatenosch|certificatenoulip", "Certificate No.", 10, 2},
                {"certificatenonsc", "Certificate No.", 20, 2},
                {"receiptnonsc", "Receipt No.", 25, 2},
                {" policyno|policy no|Date|DATE", "", 0, 7}};
    for (const auto& r : rows) {
        for (const auto key : std::views::split(std::string_view(r.keys), '|')) {
            const std::string text(key.begin(), key.end()), word = r.word;
            SCOPED_TRACE(text);
            rs->setTextType(static_cast<RYXRgSelTxtType>(7));
            rs->setButtonVisible(false);
            box(0).setText("typed");
            rs->setControlType(text);
            EXPECT_EQ(rs->ControlType(), text);
            EXPECT_EQ(frame->caption(), word.empty() ? "" : "&Range of " + word);
            EXPECT_EQ(footer->caption(), word.empty() ? "" : " Leave it Blank for all " + word);
            EXPECT_EQ(footer->isVisible(), !word.empty());
            EXPECT_EQ(rs->MaxLength(), Variant(r.length));
            EXPECT_EQ(box(1).maxLength(), r.length);
            EXPECT_EQ(rs->TextType(), r.type);
            EXPECT_TRUE(pop->visible() && box(0).isVisible() && box(1).isVisible());
            EXPECT_EQ(rs->StartText(), "");
        }
    }
    rs->setControlType("date");
    EXPECT_FALSE(pop->visible() || box(0).isVisible() || box(1).isVisible() || footer->isVisible());
    EXPECT_EQ(frame->caption(), "");
    EXPECT_TRUE(site->child<HLabel>("lblStart").isVisible());
    EXPECT_EQ(site->notifications().size(), 70u);  // TextType and ButtonVisible, none of its own
}

TEST_F(RangeSelectorTest, CaptionAndFootNoteInDesignAndRunMode) {
    form.setUserMode(false);
    rs->setCaption("Policies");
    EXPECT_EQ(frame->caption(), "&Range of Policies");
    EXPECT_EQ(footer->caption(), " Leave it Blank for all Policies");
    rs->setCaption("");
    EXPECT_EQ(frame->caption(), "&Range of Items");
    rs->setFootNote("");
    EXPECT_EQ(footer->caption(), " Leave it Blank for all Items");
    EXPECT_EQ(site->notifications(), (std::vector<std::string>{"Caption", "Caption", "Footnote"}));

    form.setUserMode(true);
    rs->setFootNote("Only branches");
    rs->setCaption("");
    EXPECT_EQ(frame->caption(), "");
    EXPECT_EQ(footer->caption(), "Only branches");
    EXPECT_EQ(rs->FootNote(), "Only branches");
    rs->setFootNote("");
    EXPECT_EQ(footer->caption(), "Leave it blank for all Items");
    rs->setCaption("Branches");
    EXPECT_EQ(footer->caption(), " Leave it Blank for all Branches");
    rs->setFootNote("");
    EXPECT_EQ(footer->caption(), "Leave it blank for all Branches");
    EXPECT_EQ(site->notifications().size(), 3u);
}

TEST_F(RangeSelectorTest, MaxLengthAndSelectionByIndex) {
    const struct {
        Variant value;
        int32_t length;
    } lengths[] = {{"12", 12}, {2.5, 2}, {3.5, 4}, {"abc", 4}, {Variant(), 4}};
    for (const auto& l : lengths) {
        rs->setMaxLength(l.value);
        EXPECT_EQ(box(1).maxLength(), l.length) << l.value.describe();
    }
    EXPECT_EQ(site->notifications().size(), 3u);
    EXPECT_THROW(rs->setMaxLength(-1), OverflowError);

    box(1).setText("uvwxyz");
    rs->setSelStart("1", 2);
    rs->setSellength(0.6, 3.0);
    EXPECT_EQ(rs->SelStart(int16_t{1}), Variant(int32_t{2}));
    EXPECT_EQ(box(1).selLength(), 3);
    for (const Variant& bad : {Variant(int16_t{2}), Variant(-1), Variant(1.5), Variant("end")})
        EXPECT_THROW(rs->SelStart(bad), IndexError) << bad.describe();
}

TEST_F(RangeSelectorTest, EveryKeySurvivesSaveAndReload) {
    const std::pair<std::string, Variant> keys[] = {
        {"ControlType", "policyno"}, {"Enabled", false},           {"TextType", int32_t{0}},
        {"MaxLength", int32_t{7}},   {"ButtonVisible", false},     {"Locked", true},
        {"Titlecolor", int32_t{1}},  {"Backcolor", int32_t{2}},    {"ForeColor", int32_t{3}},
        {"Caption", "Branches"},     {"FootNote", "Only branches"}};
    MemoryPropertyBag designed;
    for (const auto& [key, value] : keys)
        designed.writeProperty(key == "MaxLength" ? "Maxlength" : key, value, Variant());
    rs->ReadProperties(designed);
    ryx::testing::TempFolder tmp;
    saveForm(form, tmp / "form.json");
    Form loaded;
    loadForm(loaded, tmp / "form.json");
    MemoryPropertyBag saved;
    loaded.site("rs").control().WriteProperties(saved);
    ASSERT_EQ(saved.entries().size(), std::size(keys));
    for (size_t i = 0; i < std::size(keys); ++i) {
        EXPECT_EQ(saved.entries()[i].key, keys[i].first);
        EXPECT_EQ(saved.entries()[i].value, keys[i].second) << keys[i].first;
    }
    EXPECT_EQ(loaded.site("rs").child<HFrame>("fraRangeSelector").caption(), "&Range of Branches");
    EXPECT_EQ(loaded.site("rs").width(), 3615);  // the catalogue is not applied, the size is

    loadFormJson(form, R"({"format": "ryx-form/1", "controls": {"rs": {"type": "RYXRangeSelector",
        "properties": {"MAXLENGTH": 9, "textType": "abc"}}}})",
                 "inline");
    EXPECT_EQ(rs->MaxLength(), Variant(int32_t{9}));
    EXPECT_EQ(rs->TextType(), RYXANUAlphaNumeric);  // unreadable: left as it was
    EXPECT_EQ(frame->caption() + "/" + footer->caption(), "&Range of Items/Items");
    EXPECT_TRUE(rs->ButtonVisible() && rs->Enabled() && footer->isVisible());
    site->resizeByHost(100, 5000);
    EXPECT_EQ(site->width() + site->height(), 3615 + 1200);
}

}  // namespace
