#include "ryx/range_selector.h"

#include <gtest/gtest.h>

#include "form_fixture.h"
#include "ryx/headless/form.h"
#include "ryx/headless/form_file.h"

using namespace ryx;
using namespace ryx::headless;
using ryx::testing::countEvents;

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
        form.clearEvents();
    }

    HTextBox& box(int16_t i) const { return site->child<HTextBox>("RYXT", i); }
    void typeIn(int16_t i, std::string_view text) {
        form.setFocus(box(i));
        form.type(text);
    }
    // The Index of every ButtonClick raised so far.
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
    HTextBox* before = nullptr;
    HTextBox* after = nullptr;
};

TEST_F(RangeSelectorTest, NewInstanceHasTheDesignAndAFixedSize) {
    EXPECT_EQ(frame->caption(), "&Range of Items");
    EXPECT_EQ(footer->caption(), "Leave it Blank for all Items");
    EXPECT_EQ(pop->topPos(), 250);
    EXPECT_EQ(pop->toolTip(), "PopUp List Button (Alt +P)");
    EXPECT_EQ(rs->TextType(), RYXANUserKeys);
    EXPECT_TRUE(rs->ButtonVisible());
    EXPECT_EQ(rs->ForeColor(), 0x00E6FEFF);
    site->resizeByHost(100, 5000);
    EXPECT_EQ(site->width(), 3615);
    EXPECT_EQ(site->height(), 1200);
}

TEST_F(RangeSelectorTest, TypingIsFilteredByTextType) {
    const struct {
        int32_t type;
        const char* typed;
        const char* shown;
        const char* afterBackspace;
    } cases[] = {
        {RYXANUAlphaNumeric, "a-b", "AB", "A"},
        {RYXANUAlphaNumeric, "12a 3", "12A 3", "12A "},
        {RYXANUAlphaNumeric, "~`{}", "", ""},
        {RYXANUserKeys, "a-b", "a-b", "a-"},
        {RYXANUserKeys, "12a 3", "12a 3", "12a "},
        {7, "a-b", "a-b", "a-"},
        {RYXANDigits, "a-b", "", ""},
        {RYXANDigits, "12a 3", "12 3", "12 3"},
    };
    for (const auto& c : cases) {
        SCOPED_TRACE(std::to_string(c.type) + " " + c.typed);
        rs->setTextType(static_cast<RYXRgSelTxtType>(c.type));
        box(1).setText("");
        typeIn(1, c.typed);
        EXPECT_EQ(rs->EndText(), c.shown);
        form.press(vk::Back);
        EXPECT_EQ(rs->EndText(), c.afterBackspace);
    }
    form.press(vk::Home);
    form.press(vk::Delete);  // Delete types no character: it deletes even in a digits box
    EXPECT_EQ(rs->EndText(), "2 3");
    EXPECT_EQ(countEvents(form, "rs", EventId::Change), 0);
}

TEST_F(RangeSelectorTest, TheHostSeesTheKeyAfterTheFilterAndMayPutOneBack) {
    std::vector<int16_t> seen;
    site->onEvent = [&](EventId id, EventArgs& a) {
        if (id != EventId::KeyPress) return;
        seen.push_back(a.KeyAscii);
        EXPECT_EQ(a.Index, Variant(int16_t{0}));
        if (a.KeyAscii == 0 && seen.size() == 2) a.KeyAscii = '-';
    };
    rs->setTextType(RYXANUAlphaNumeric);
    typeIn(0, "a-b\r");
    EXPECT_EQ(seen, (std::vector<int16_t>{'A', 0, 'B', 0}));  // the Enter is 0 to the host
    EXPECT_EQ(rs->StartText(), "A-B");
    EXPECT_EQ(form.focused(), &box(1));
}

TEST_F(RangeSelectorTest, InsertToggleOverwritesPrintableCharacters) {
    const struct {
        int32_t type, selStart, selLength;
        const char* typed;
        const char* shown;
    } cases[] = {
        {RYXANDigits, 1, 0, "9", "1967"},
        {RYXANDigits, 4, 0, "9", "15679"},
        {RYXANDigits, 1, 2, "9", "197"},
        {RYXANUserKeys, 2, 0, "\b", "167"},  // Backspace still deletes before the caret
        {RYXANDigits, 1, 0, "a", "1567"},    // a dropped letter leaves the next digit selected
    };
    form.setInsertToggle(true);
    for (const auto& c : cases) {
        rs->setTextType(static_cast<RYXRgSelTxtType>(c.type));
        form.setFocus(box(0));
        box(0).setText("1567");
        rs->setSelStart(0, c.selStart);
        rs->setSellength(0, c.selLength);
        form.type(c.typed);
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
    EXPECT_EQ(rs->StartText() + rs->EndText(), "");
}

TEST_F(RangeSelectorTest, ButtonClickReportsTheBoxTheButtonServes) {
    form.click(*pop);
    form.click(box(1));
    EXPECT_EQ(pop->topPos(), 575);
    form.click(*pop);
    form.click(box(0));
    EXPECT_EQ(pop->topPos(), 255);
    form.click(*pop);
    form.click(box(1));
    rs->setControlType("name");
    EXPECT_EQ(pop->topPos(), 285);
    form.click(*pop);
    form.setFocus(box(1));
    form.press('P', shift::Alt);  // Alt+P raises it once
    form.press('P');              // P alone is typed like any letter
    EXPECT_EQ(buttonClicks(), (std::vector<int>{0, 1, 0, 0, 1}));
    EXPECT_EQ(rs->EndText(), "p");
}

TEST_F(RangeSelectorTest, AltPWithTheButtonHiddenLockedOrDisabled) {
    rs->setButtonVisible(false);
    EXPECT_FALSE(rs->ButtonVisible());
    typeIn(0, "");
    form.press('P', shift::Alt);
    EXPECT_EQ(buttonClicks(), std::vector<int>{0});

    rs->setButtonVisible(true);
    for (bool locked : {true, false}) {
        rs->setLocked(locked);
        rs->setEnabled(locked);
        form.press('P', shift::Alt);
        form.click(*pop);
        form.click(box(1));
    }
    EXPECT_EQ(buttonClicks(), std::vector<int>{0});
    EXPECT_EQ(countEvents(form, "rs", EventId::Click), 0);
}

TEST_F(RangeSelectorTest, EndTextBelowTheStartIsDropped) {
    const struct {
        const char* type;
        const char* start;
        const char* end;
        bool taken;
    } cases[] = {
        {"policyno", "900", "1000", true},
        {"name", "900", "1000", false},
        {"name", "900", "A", true},
        {"name", "", "000", true},
        {"name", "900", "900", true},
        {"PLAN", "12", "9", false},
        {"plan", "12", " 1 2x", true},
        {"policyno", "900", "", true},
        {"name", "B", "", true},
        {"policyno", "900", "&H400", true},
        {"phspolicyno", "900", "1000", false},
    };
    for (const auto& c : cases) {
        rs->setControlType(c.type);
        box(1).setText("old");
        rs->setStartText(c.start);
        rs->setEndText(c.end);
        EXPECT_EQ(rs->EndText(), c.taken ? c.end : "old") << c.type << " " << c.start;
    }
}

TEST_F(RangeSelectorTest, StartTextMovesTheFocusAndNeverFails) {
    form.setFocus(*after);
    rs->setStartText(" 12 ");
    EXPECT_EQ(rs->StartText(), " 12 ");
    EXPECT_EQ(form.focused(), &box(1));

    rs->setControlType("date");
    form.setFocus(*after);
    rs->setStartText("5");
    EXPECT_EQ(rs->StartText(), "5");
    EXPECT_EQ(form.focused(), after);
    form.focusControl(*site);  // the hidden start box cannot take it: no error
    form.setFocus(*before);
    form.tab();
    EXPECT_EQ(form.focused(), after);
}

TEST_F(RangeSelectorTest, EveryControlTypeSetsCaptionsLengthAndFilter) {
    const struct {
        const char* key;
        const char* word;
        int32_t length;
        int32_t type;  // 7: the filter in force stays
    } rows[] = {
        {"policyno", "Policies", 10, 1},
        {"phspolicyno", "Policies", 10, 1},
        {"filterpolicyno", "Policies", 10, 1},
        {"name", "Clients", 21, 2},
        {"filterclient", "Clients", 21, 2},
        {"filtername", "Clients", 21, 2},
        {"phsname", "Clients", 25, 2},
        {"phsperson", "Persons", 21, 2},
        {"familycode", "Families", 4, 0},
        {"phsfamily", "Families", 4, 0},
        {"filterfamily", "Families", 4, 0},
        {"branchno", "Branches", 4, 0},
        {"location", "Locations", 20, 2},
        {"pincode", "PinCodes", 6, 1},
        {"plan", "Plans", 3, 1},
        {"proposalno", "Proposals", 10, 1},
        {"filterproposalno", "Proposals", 10, 1},
        {"phsdept", "Department", 4, 7},
        {"bankbranchrec", "Bank Branch", 15, 2},
        {"bankbranchppf", "Bank Branch", 15, 2},
        {"accountnorec", "Account No.", 10, 2},
        {"accountnoppf", "Account No.", 10, 2},
        {"companynamesch", "Company Name", 25, 2},
        {"applicationnosch", "Application No.", 10, 2},
        {"applicationnofd", "Application No.", 10, 2},
        {"applicationnoulip", "Application No.", 20, 2},
        {"certificatenosch", "Certificate No.", 10, 2},
        {"certificatenoulip", "Certificate No.", 10, 2},
        {"certificatenonsc", "Certificate No.", 20, 2},
        {"receiptnonsc", "Receipt No.", 25, 2},
        {"PolicyNo", "Policies", 10, 1},
        {" policyno", "", 0, 7},
        {"policy no", "", 0, 7},
        {"Date", "", 0, 7},
        {"DATE", "", 0, 7},
    };
    for (const auto& r : rows) {
        SCOPED_TRACE(r.key);
        rs->setTextType(static_cast<RYXRgSelTxtType>(7));
        rs->setButtonVisible(false);
        box(0).setText("typed");
        rs->setControlType(r.key);
        const std::string word = r.word;
        EXPECT_EQ(rs->ControlType(), r.key);
        EXPECT_EQ(frame->caption(), word.empty() ? "" : "&Range of " + word);
        EXPECT_EQ(footer->caption(), word.empty() ? "" : " Leave it Blank for all " + word);
        EXPECT_EQ(footer->isVisible(), !word.empty());
        EXPECT_EQ(rs->MaxLength(), Variant(r.length));
        EXPECT_EQ(box(1).maxLength(), r.length);
        EXPECT_EQ(rs->TextType(), r.type);
        EXPECT_TRUE(pop->visible() && box(0).isVisible() && box(1).isVisible());
        EXPECT_EQ(rs->StartText(), "");
    }
    rs->setControlType("date");
    EXPECT_FALSE(pop->visible() || box(0).isVisible() || box(1).isVisible() || footer->isVisible());
    EXPECT_EQ(frame->caption(), "");
    EXPECT_TRUE(site->child<HLabel>("lblStart").isVisible());
    EXPECT_EQ(site->notifications().size(), 70u);  // TextType and ButtonVisible only
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

TEST_F(RangeSelectorTest, SettersNotifyAndEnabledGreysEveryChild) {
    rs->setMaxLength("abc");
    rs->setMaxLength(Variant());
    EXPECT_TRUE(site->notifications().empty());
    const struct {
        Variant value;
        int32_t length;
    } lengths[] = {{"12", 12}, {2.5, 2}, {3.5, 4}, {int16_t{0}, 0}};
    for (const auto& l : lengths) {
        rs->setMaxLength(l.value);
        EXPECT_EQ(box(0).maxLength(), l.length);
        EXPECT_EQ(box(1).maxLength(), l.length);
    }
    EXPECT_THROW(rs->setMaxLength(-1), OverflowError);
    site->clearRecords();
    rs->setBackColor(1);
    rs->setForeColor(2);
    rs->setTitleColor(3);
    rs->setEnabled(false);
    rs->setLocked(false);
    rs->setButtonVisible(true);
    rs->setTextType(RYXANDigits);
    rs->setMaxLength(5);
    rs->setControlType("plan");
    EXPECT_EQ(site->notifications(),
              (std::vector<std::string>{"BackColor", "ForeColor", "TitleColor", "Enabled", "Locked",
                                        "ButtonVisible", "TextType", "MaxLength"}));
    EXPECT_EQ(box(1).backColor(), 2);
    for (const auto& n : site->children())
        EXPECT_FALSE(n->isEnabled()) << n->displayName();
}

TEST_F(RangeSelectorTest, SelectionOfEitherBoxByIndex) {
    box(0).setText("abcdef");
    box(1).setText("uvwxyz");
    const struct {
        Variant index;
        HTextBox* field;
    } valid[] = {{int16_t{0}, &box(0)}, {int32_t{1}, &box(1)}, {0.4, &box(0)}, {"1", &box(1)}};
    for (const auto& v : valid) {
        rs->setSelStart(v.index, 2);
        rs->setSellength(v.index, 3.0);
        EXPECT_EQ(v.field->selStart(), 2);
        EXPECT_EQ(rs->Sellength(v.index), Variant(int32_t{3}));
        EXPECT_EQ(rs->SelStart(v.index), Variant(int32_t{2}));
    }
    for (const Variant& bad : {Variant(int16_t{2}), Variant(-1), Variant(1.5), Variant("end")}) {
        EXPECT_THROW(rs->SelStart(bad), IndexError) << bad.describe();
        EXPECT_THROW(rs->setSellength(bad, 1), IndexError) << bad.describe();
    }
}

TEST_F(RangeSelectorTest, BoxEventsSurfaceEnterAndAccessKey) {
    form.doubleClick(box(1));
    form.mouseMove(box(0), 1, 2, 3.f, 4.f);
    EXPECT_EQ(ryx::testing::eventNumbers(form, "rs"), (std::vector<int>{7, 2, 9, 8}));
    EXPECT_EQ(form.events()[1].args.Index, Variant(int16_t{1}));
    rs->setLocked(true);
    rs->Refresh();
    form.click(box(1));  // a locked control takes no input
    EXPECT_EQ(form.events().size(), 4u);
    EXPECT_EQ(site->repaints(), 1);

    rs->setLocked(false);
    rs->setControlType("date");
    form.focusControl(*site);
    form.press(vk::Return);
    EXPECT_EQ(form.focused(), after);
    form.setFocus(*before);
    form.accessKey(*site, 13);
    EXPECT_EQ(form.focused(), after);
}

TEST_F(RangeSelectorTest, EveryKeySurvivesSaveAndReload) {
    ryx::testing::TempFolder tmp;
    form.setUserMode(false);
    rs->setControlType("policyno");
    rs->setTextType(RYXANUAlphaNumeric);
    rs->setMaxLength(7);
    rs->setButtonVisible(false);
    rs->setLocked(true);
    rs->setEnabled(false);
    rs->setBackColor(0x112233);
    rs->setTitleColor(0x445566);
    rs->setForeColor(0x778899);
    rs->setCaption("Branches");
    rs->setFootNote("Only branches");
    saveForm(form, tmp / "form.json");

    for (bool run : {false, true}) {
        Form loaded;
        loaded.setUserMode(run);
        loadForm(loaded, tmp / "form.json");
        auto& again = dynamic_cast<RYXRangeSelector&>(loaded.site("rs").control());
        EXPECT_EQ(again.ControlType(), "policyno");
        EXPECT_EQ(again.TextType(), RYXANUAlphaNumeric);  // the catalogue is not applied
        EXPECT_EQ(again.MaxLength(), Variant(int32_t{7}));
        EXPECT_FALSE(again.ButtonVisible());
        EXPECT_TRUE(again.Locked());
        EXPECT_FALSE(again.Enabled());
        EXPECT_EQ(again.BackColor(), 0x112233);
        EXPECT_EQ(again.TitleColor(), 0x445566);
        EXPECT_EQ(again.ForeColor(), 0x778899);
        EXPECT_EQ(again.Caption(), "Branches");
        EXPECT_EQ(again.FootNote(), "Only branches");
        EXPECT_EQ(loaded.site("rs").child<HFrame>("fraRangeSelector").caption(),
                  "&Range of Branches");
        EXPECT_EQ(loaded.site("rs").width(), 3615);
    }
}

TEST_F(RangeSelectorTest, LoadingDefaultsAndKeysInAnyCase) {
    loadFormJson(form, R"({"format": "ryx-form/1", "controls": {"rs": {"type": "RYXRangeSelector",
        "properties": {"MAXLENGTH": 9, "textType": "abc", "Enabled": [1]}}}})",
                 "inline");
    EXPECT_EQ(rs->MaxLength(), Variant(int32_t{9}));
    EXPECT_EQ(rs->TextType(), RYXANUserKeys);  // unreadable: left as it was
    EXPECT_TRUE(rs->Enabled());
    EXPECT_EQ(frame->caption(), "&Range of Items");
    EXPECT_EQ(footer->caption(), "Items");
    EXPECT_TRUE(footer->isVisible());
    EXPECT_EQ(rs->ControlType(), "");
}

}  // namespace
