#include "ryx/policy_status.h"

#include <gtest/gtest.h>

#include "form_fixture.h"
#include "ryx/headless/form.h"
#include "ryx/headless/form_file.h"

using namespace ryx;
using namespace ryx::headless;
using ryx::testing::countEvents;

namespace {

class PolicyStatusTest : public ::testing::Test {
  protected:
    void SetUp() override {
        before = &form.addTextBox("txtBefore");
        ps = &form.add<RYXPolicyStatus>("ps", 2905, 1580);
        after = &form.addTextBox("txtAfter");
        site = &form.site("ps");
        list = &site->child<HListBox>("LstPolicyStatus");
        all = &site->child<HCheckBox>("ChkAll");
        frame = &site->child<HFrame>("fraPolicyStatus");
        form.clearEvents();
    }

    void pick(std::initializer_list<int> rows) {
        for (int r : rows)
            form.clickRow(*list, r);
    }
    std::vector<int> selectedRows() const {
        std::vector<int> rows;
        for (int r = 0; r < list->listCount(); ++r)
            if (list->selected(r)) rows.push_back(r);
        return rows;
    }
    int clicks() const { return countEvents(form, "ps", EventId::Click); }

    Form form;
    RYXPolicyStatus* ps = nullptr;
    Site* site = nullptr;
    HListBox* list = nullptr;
    HCheckBox* all = nullptr;
    HFrame* frame = nullptr;
    HTextBox* before = nullptr;
    HTextBox* after = nullptr;
};

TEST_F(PolicyStatusTest, CriterionTextsInBothSyntaxes) {
    struct Case {
        std::vector<int> rows;
        bool checkAll;
        const char* formula;
        const char* plain;
        const char* setting;
    } cases[] = {
        {{}, false, "+", "+", ""},
        {{0, 3}, false, R"(["I","F"])", "I,F", "IF"},
        {{1, 4, 7}, false, R"(["L","S","R"])", "L,S,R", "LS"},
        {{2}, false, R"(["P"])", "P", "R"},
        {{7}, false, R"(["R"])", "R", ""},
        {{0, 1, 2, 3, 4, 5, 6}, false, R"(["I","L","P","F","S","M","D"])", "I,L,P,F,S,M,D", "+"},
        {{0, 1, 2, 3, 4, 5, 6, 7},
         false,
         R"(["I","L","P","F","S","M","D","R"])",
         "I,L,P,F,S,M,D,R",
         "+"},
        {{}, true, "+", "+", "+"},
    };
    for (const Case& c : cases) {
        Form f;
        auto& control = f.add<RYXPolicyStatus>("ps", 2905, 1580);
        auto& s = f.site("ps");
        for (int r : c.rows)
            f.clickRow(s.child<HListBox>("LstPolicyStatus"), r);
        if (c.checkAll) f.click(s.child<HCheckBox>("ChkAll"));
        SCOPED_TRACE(c.formula);
        EXPECT_EQ(control.ReturnedText(), c.formula);
        control.setCrystalStyle(false);
        EXPECT_EQ(control.ReturnedText(), c.plain);
        EXPECT_EQ(control.DefaultSetting(), Variant(c.setting));
    }
}

TEST_F(PolicyStatusTest, DefaultSettingRestoresASelection) {
    struct Case {
        Variant value;
        std::vector<int> before;
        std::vector<int> rows;
        int16_t checked;
    } cases[] = {
        {"IF", {}, {0, 3}, 0},
        {"IF", {5}, {0, 3, 5}, 0},  // selecting never clears a row
        {"il", {}, {}, 0},          // letters are case-sensitive
        {"XDZ", {}, {6}, 0},        // unknown letters are passed over
        {"R", {}, {2}, 0},          // R is "Reduced PaidUp", not "Record"
        {"+", {}, {0, 1, 2, 3, 4, 5, 6, 7}, 1},
        {"ABCDEFG", {}, {0, 1, 2, 3, 4, 5, 6, 7}, 1},  // any seven characters mean all
        {Variant(int16_t{5}), {}, {}, 0},
        {Variant(), {}, {}, 0},
        {std::string(255, 'M'), {}, {5}, 0},
    };
    for (const Case& c : cases) {
        Form f;
        auto& control = f.add<RYXPolicyStatus>("ps", 2905, 1580);
        auto& l = f.site("ps").child<HListBox>("LstPolicyStatus");
        for (int r : c.before)
            f.clickRow(l, r);
        SCOPED_TRACE(c.value.toString());
        control.setDefaultSetting(c.value);
        std::vector<int> rows;
        for (int r = 0; r < 8; ++r)
            if (l.selected(r)) rows.push_back(r);
        EXPECT_EQ(rows, c.rows);
        EXPECT_EQ(f.site("ps").child<HCheckBox>("ChkAll").value(), c.checked);
        EXPECT_EQ(l.listIndex(), 0);
    }
}

TEST_F(PolicyStatusTest, DefaultSettingOver255CharactersIsAnOverflowAndSelectsNothing) {
    EXPECT_THROW(ps->setDefaultSetting(std::string(256, 'I')), OverflowError);
    EXPECT_TRUE(selectedRows().empty());
    EXPECT_EQ(list->listIndex(), -1);
}

TEST_F(PolicyStatusTest, DefaultSettingRaisesClickForEachListChange) {
    ps->setDefaultSetting("IF");
    EXPECT_EQ(clicks(), 3);  // row 0, row 3, and the current row

    // With "All Policies" checked every row is selected and row 0 is current already: the
    // list reports no change, so the box stays checked.
    form.click(*all);
    form.clearEvents();
    ps->setDefaultSetting("IF");
    EXPECT_EQ(all->value(), 1);
    EXPECT_EQ(clicks(), 0);
}

TEST_F(PolicyStatusTest, ClickingARowWhileAllPoliciesIsCheckedUnchecksItOnce) {
    form.click(*all);
    EXPECT_EQ(all->value(), 1);
    EXPECT_EQ(selectedRows().size(), 8u);
    EXPECT_EQ(clicks(), 0);  // checking "All Policies" raises nothing

    form.clickRow(*list, 4);
    EXPECT_EQ(all->value(), 0);
    EXPECT_EQ(clicks(), 1);
    EXPECT_FALSE(list->selected(4));
    EXPECT_EQ(selectedRows().size(), 7u);  // the box's handler did not run again
}

TEST_F(PolicyStatusTest, UncheckingAllPoliciesLeavesEveryRowSelected) {
    form.click(*all);
    form.click(*all);
    EXPECT_EQ(all->value(), 0);
    EXPECT_EQ(selectedRows().size(), 8u);
    EXPECT_EQ(ps->ReturnedText(), R"(["I","L","P","F","S","M","D","R"])");
}

TEST_F(PolicyStatusTest, AThrowingHostHandlerLeavesTheControlWorking) {
    int calls = 0;
    site->onEvent = [&](EventId id, EventArgs&) {
        if (id == EventId::Click && ++calls == 1) throw std::runtime_error("host failed");
    };
    form.click(*all);
    EXPECT_THROW(form.clickRow(*list, 1), std::runtime_error);
    EXPECT_EQ(all->value(), 0);
    form.click(*all);  // the box's handler is not blocked by a guard left set
    EXPECT_EQ(selectedRows().size(), 8u);
    form.clickRow(*list, 2);
    EXPECT_EQ(all->value(), 0);
    EXPECT_EQ(calls, 2);
}

TEST_F(PolicyStatusTest, EnterAndArrowsMoveTheFocusAlongTheTabOrder) {
    form.setFocus(*before);
    form.tab();
    ASSERT_EQ(form.focused(), list);

    form.press(vk::Return);  // Enter in the list: to the check box, never into the list
    EXPECT_EQ(form.focused(), all);
    ASSERT_EQ(countEvents(form, "ps", EventId::KeyPress), 1);
    EXPECT_EQ(form.events()[1].id, EventId::KeyPress);
    EXPECT_EQ(form.events()[1].args.KeyAscii, 13);  // the host sees the Enter first

    form.press(vk::Up);  // Up on the check box: back to the list
    EXPECT_EQ(form.focused(), list);
    form.tab();
    form.press(vk::Down);
    EXPECT_EQ(form.focused(), after);
    form.shiftTab();
    form.press(vk::Return);  // Enter on the check box: on to the next control, box unchanged
    EXPECT_EQ(form.focused(), after);
    EXPECT_EQ(all->value(), 0);
}

TEST_F(PolicyStatusTest, HostHandlersThatChangeTheKeyStopTheNavigation) {
    site->onEvent = [](EventId id, EventArgs& a) {
        if (id == EventId::KeyPress && a.KeyAscii == 13) a.KeyAscii = 0;
        if (id == EventId::KeyDown && a.KeyCode == vk::Up) a.KeyCode = 0;
    };
    form.setFocus(*list);
    form.press(vk::Return);
    EXPECT_EQ(form.focused(), list);
    form.setFocus(*all);
    form.press(vk::Up);
    EXPECT_EQ(form.focused(), all);
}

TEST_F(PolicyStatusTest, WhichChildEventsReachTheHost) {
    form.setFocus(*list);
    form.press('A');
    form.mouseMove(*list, 1, 2, 30.f, 40.f);
    form.doubleClick(*list);
    std::vector<int> listEvents = ryx::testing::eventNumbers(form, "ps");
    EXPECT_EQ(listEvents, (std::vector<int>{4, 5, 6, 8, 7, 2, 9}));
    const auto& move = form.events()[3].args;
    EXPECT_EQ(move.Button, 1);
    EXPECT_EQ(move.Shift, 2);
    EXPECT_EQ(move.X, 30.f);
    EXPECT_TRUE(move.Index.isEmpty());  // this control's events carry no index

    form.clearEvents();
    form.setFocus(*all);
    form.press('B');  // KeyDown only: the box's key press and key up stay inside
    form.mouseDown(*all, 1, 0, 0, 0);
    EXPECT_EQ(ryx::testing::eventNumbers(form, "ps"), (std::vector<int>{4}));
}

TEST_F(PolicyStatusTest, SurfaceKeysAndAccessKey) {
    form.focusControl(*site);
    ASSERT_EQ(form.focused(), &site->surface());
    form.press(vk::Return);
    EXPECT_EQ(form.focused(), after);
    EXPECT_EQ(countEvents(form, "ps", EventId::KeyPress), 1);
    EXPECT_EQ(countEvents(form, "ps", EventId::KeyDown), 1);
    EXPECT_EQ(countEvents(form, "ps", EventId::KeyUp), 1);

    form.setFocus(*before);
    form.accessKey(*site, 13);  // the host passes Enter as an access key
    EXPECT_EQ(form.focused(), list);
}

TEST_F(PolicyStatusTest, LockedTakesNoInputWithoutGreying) {
    ps->setLocked(true);
    EXPECT_TRUE(ps->Locked());
    form.clickRow(*list, 1);
    form.click(*all);
    EXPECT_TRUE(selectedRows().empty());
    EXPECT_EQ(all->value(), 0);
    EXPECT_TRUE(list->isEnabled());
    EXPECT_TRUE(all->isEnabled());
    EXPECT_TRUE(frame->isEnabled());
    form.setFocus(*before);
    form.tab();
    EXPECT_EQ(form.focused(), after);  // the tab order passes over a locked control

    ps->setLocked(false);
    form.clickRow(*list, 1);
    EXPECT_EQ(selectedRows(), std::vector<int>{1});
}

TEST_F(PolicyStatusTest, DisabledGreysTheChildrenAndCodeChangesRaiseNoClick) {
    ps->setEnabled(false);
    EXPECT_FALSE(frame->isEnabled());
    EXPECT_FALSE(list->isEnabled());
    EXPECT_FALSE(all->isEnabled());
    list->setEnabled(true);  // the host changes a child directly
    EXPECT_FALSE(ps->Enabled());
    form.clickRow(*list, 2);  // the disabled frame passes no input on
    EXPECT_TRUE(selectedRows().empty());

    form.click(*all);
    ps->setDefaultSetting("L");
    EXPECT_EQ(selectedRows(), std::vector<int>{1});
    EXPECT_EQ(clicks(), 0);
}

TEST_F(PolicyStatusTest, ResizeKeepsTheMinimumWidthAndFollowsTheHeight) {
    struct Case {
        Twips width, height;
        Twips controlWidth, frameWidth, listWidth, frameHeight;
    } cases[] = {
        {1000, 1580, 2905, 2805, 2445, 1530}, {4000, 2000, 4000, 3900, 3540, 1950},
        {2905, 51, 2905, 2805, 2445, 1},      {3000, 50, 3000, 2900, 2540, 0},
        {3000, 10, 3000, 2900, 2540, 0},
    };
    for (const Case& c : cases) {
        form.site("ps").resizeByHost(c.width, c.height);
        EXPECT_EQ(site->width(), c.controlWidth);
        EXPECT_EQ(frame->widthSize(), c.frameWidth);
        EXPECT_EQ(list->widthSize(), c.listWidth);
        EXPECT_EQ(frame->heightSize(), c.frameHeight);
    }
}

TEST_F(PolicyStatusTest, SettersNotifyTheHostUnderTheirNames) {
    site->clearRecords();
    ps->setBackColor(0x123456);
    ps->setTitleColor(0x10);
    ps->setForeColor(0x20);
    ps->setCrystalStyle(false);
    ps->setEnabled(true);
    ps->setLocked(false);
    ps->setDefaultSetting("I");
    EXPECT_EQ(site->notifications(),
              (std::vector<std::string>{"BackColor", "Titlecolor", "ForeColor", "CrystalStyle",
                                        "Enabled", "Locked"}));
    EXPECT_EQ(all->backColor(), 0x123456);  // BackColor paints the check box too
    EXPECT_EQ(list->backColor(), 0x20);
}

TEST_F(PolicyStatusTest, EveryKeySurvivesSaveAndReload) {
    ryx::testing::TempFolder tmp;
    ps->setBackColor(0x00112233);
    ps->setTitleColor(0x00445566);
    ps->setForeColor(0x00778899);
    ps->setCrystalStyle(false);
    ps->setLocked(true);
    ps->setEnabled(false);
    form.clickRow(*list, 0);  // not saved: a host restores selections through DefaultSetting
    (void)ps->ReturnedText();
    saveForm(form, tmp / "form.json");

    Form loaded;
    loadForm(loaded, tmp / "form.json");
    auto& again = dynamic_cast<RYXPolicyStatus&>(loaded.site("ps").control());
    EXPECT_EQ(again.BackColor(), 0x00112233);
    EXPECT_EQ(loaded.site("ps").child<HCheckBox>("ChkAll").backColor(), 0x00112233);
    EXPECT_EQ(again.TitleColor(), 0x00445566);
    EXPECT_EQ(again.ForeColor(), 0x00778899);  // a designer's list colour survives
    EXPECT_FALSE(again.CrystalStyle());
    EXPECT_TRUE(again.Locked());
    EXPECT_FALSE(again.Enabled());
    EXPECT_EQ(loaded.site("ps").child<HListBox>("LstPolicyStatus").selCount(), 0);
    EXPECT_EQ(again.ReturnedText(), "+");
}

TEST_F(PolicyStatusTest, LoadingMatchesKeysInAnyCaseSkipsBadValuesAndDefaultsMissingOnes) {
    ps->setForeColor(2);  // a missing "Forecolor" loads its default
    const char* doc = R"({"format": "ryx-form/1", "controls": {"ps": {"type": "RYXPolicyStatus",
        "properties": {"TITLECOLOR": 255, "backcolor": "not a colour", "Enabled": [1],
                       "Locked": -1, "crystalstyle": 0}}}})";
    loadFormJson(form, doc, "inline");
    EXPECT_EQ(ps->TitleColor(), 255);
    EXPECT_EQ(ps->BackColor(), 0x00C0FFFF);  // unreadable: left as it was
    EXPECT_TRUE(ps->Enabled());
    EXPECT_TRUE(ps->Locked());  // -1 is True
    EXPECT_FALSE(ps->CrystalStyle());
    EXPECT_EQ(ps->ForeColor(), 0x00E6FEFF);
}

}  // namespace
