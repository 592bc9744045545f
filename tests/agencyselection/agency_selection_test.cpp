#include "ryx/agency_selection.h"

#include <gtest/gtest.h>

#include "../sqlite/test_database.h"
#include "form_fixture.h"
#include "ryx/headless/form_file.h"
#include "ryx/sqlite/sqlite_record_source.h"

using namespace ryx;
using namespace ryx::headless;
using ryx::testing::agencyTable;

namespace {

// A user's steps: a row number clicks that row; these click the boxes and the button.
constexpr int kAll = -1, kYours = -2, kDeselect = -3;
const std::string kTable =
    agencyTable({{"B2", "Beta"}, {"A1", "Alpha"}, {"*", "Star"}, {"C3", {}}});
using Rows = std::vector<int>;

class AgencySelectionTest : public ::testing::Test {
  protected:
    void SetUp() override {
        ryx::testing::runSql(db, kTable);
        form.setRecordSourceFactory(ryx::sqlite::makeRecordSource);
        before = &form.addTextBox("txtBefore");
        ag = &form.add<RYXAgencySelection>("ag", 2820, 1740);
        site = &form.site("ag");
        list = &site->child<HListBox>("LstAgMast");
        all = &site->child<HCheckBox>("chkAgmast", 0);
        yours = &site->child<HCheckBox>("chkAgmast", 1);
        button = &site->child<HCommandButton>("cmdDeselect");
        frame = &site->child<HFrame>("fraAgencySelection");
    }
    void act(std::initializer_list<int> steps) {
        Node* targets[] = {button, yours, all};
        for (int s : steps)
            s >= 0 ? form.clickRow(*list, s) : form.click(*targets[s + 3]);
    }
    Rows selected() const {
        Rows rows;
        for (int r = 0; r < list->listCount(); ++r)
            if (list->selected(r)) rows.push_back(r);
        return rows;
    }
    int clicks() const { return ryx::testing::countEvents(form, "ag", EventId::Click); }

    ryx::testing::TempFolder tmp;
    std::filesystem::path db = tmp / "agencies.db";
    Form form;
    RYXAgencySelection* ag = nullptr;
    Site* site = nullptr;
    HListBox* list = nullptr;
    HCheckBox *all = nullptr, *yours = nullptr;
    HCommandButton* button = nullptr;
    HFrame* frame = nullptr;
    HTextBox* before = nullptr;
};

TEST_F(AgencySelectionTest, FillsOthersThenTheAgenciesInCodeOrderAfresh) {
    const auto cli = tmp / "cli.db";  // made by the sqlite3 program, not by SQLite in-process
    if (!ryx::testing::runSqliteProgram(cli, kTable)) GTEST_SKIP() << "no sqlite3 program";
    act({kAll});
    form.clearEvents();
    for (int time = 0; time < 2; ++time) {
        ag->setDatabaseName(cli.string());
        ASSERT_EQ(list->listCount(), 4);  // one set of rows, their flags discarded
        EXPECT_EQ(list->list(0) + "|" + list->list(1) + "|" + list->list(2) + "|" + list->list(3),
                  "*   Others|A1  Alpha|B2  Beta|C3  ");
        EXPECT_TRUE(selected().empty());
        act({2});
    }
    EXPECT_EQ(ryx::testing::eventNumbers(form, "ag"), (std::vector<int>{1, 1}));  // the picks
    EXPECT_EQ(ag->DatabaseName(), cli.string());

    form.setUserMode(false);  // the designer only keeps the name
    ag->setDatabaseName("missing.db");
    EXPECT_EQ(list->listCount(), 4);
    EXPECT_EQ(ag->DatabaseName(), "missing.db");
}

TEST_F(AgencySelectionTest, YourAgenciesWithOnlyTheOthersRow) {
    ryx::testing::runSql(tmp / "empty.db", agencyTable({{"*", "Star"}}));
    ag->setDatabaseName((tmp / "empty.db").string());
    act({kYours});  // with "*   Others" alone: checked, row 0 clear, no current row
    EXPECT_EQ(list->listCount(), 1);
    EXPECT_EQ(yours->value(), 1);
    EXPECT_TRUE(selected().empty());
    EXPECT_EQ(list->listIndex(), -1);
    EXPECT_EQ(ag->ReturnedText(), "-");
}

TEST_F(AgencySelectionTest, ReturnedTextAndDefaultSettingInEveryMode) {
    ag->setDatabaseName(db.string());
    struct Case {
        Rows steps;
        const char *formula, *plain;
        Variant setting;
    } cases[] = {
        {{}, "+", "+", {}},
        {{0, 1, 2}, R"(["*","A1","B2"])", "*A1B2", "*"},
        {{2, 1}, R"(["A1","B2"])", "A1B2", {}},
        {{0}, R"(["*"])", "*", "*"},
        {{kAll}, "+", "+", "+"},
        {{kYours}, "-", "-", "-"},
        {{kYours, 2}, R"(["A1","C3"])", "A1C3", {}},
        {{kAll, 0}, R"(["A1","B2","C3"])", "A1B2C3", {}},
        {{kAll, kDeselect}, "+", "+", {}},
        {{1, kYours, kAll}, "+", "+", "+"},
    };
    for (const Case& c : cases) {
        SCOPED_TRACE(c.formula);
        act({kDeselect});
        for (int s : c.steps)
            act({s});
        ag->setCrystalStyle(true);
        EXPECT_EQ(ag->ReturnedText(), c.formula);
        EXPECT_EQ(ag->ReturnedText(), c.formula);  // the records are read again from the first
        ag->setCrystalStyle(false);
        EXPECT_EQ(ag->ReturnedText(), c.plain);
        EXPECT_EQ(ag->DefaultSetting(), c.setting);
    }

    ryx::testing::runSql(tmp / "q.db",
                         agencyTable({{"A\"1", "x"}, {"B,2", "y"}, {R"(C"]+)", "z"}}));
    ag->setDatabaseName((tmp / "q.db").string());
    act({1, 2, 3});
    EXPECT_EQ(ag->ReturnedText(), R"(A"1B,2C"]+)");
    ag->setCrystalStyle(true);  // a quote inside a code is written twice
    EXPECT_EQ(ag->ReturnedText(), R"(["A""1","B,2","C""]+"])");
}

TEST_F(AgencySelectionTest, BoxesRowsAndDeselectAllKeepTheWidgetsConsistent) {
    ag->setDatabaseName(db.string());
    act({kAll, kAll});  // a click on a checked box leaves it checked
    EXPECT_EQ(all->value(), 1);
    EXPECT_EQ(selected(), (Rows{0, 1, 2, 3}));
    EXPECT_EQ(list->listIndex(), 0);
    act({kYours});
    EXPECT_EQ(all->value() * 10 + yours->value(), 1);
    EXPECT_EQ(selected(), (Rows{1, 2, 3}));
    EXPECT_EQ(list->listIndex(), 1);
    act({3});  // a row makes it a pick
    EXPECT_EQ(yours->value(), 0);
    EXPECT_EQ(selected(), (Rows{1, 2}));
    act({kDeselect});
    EXPECT_TRUE(selected().empty());
    EXPECT_EQ(form.focused(), list);
    EXPECT_EQ(clicks(), 4);  // Deselect All raises none

    // Alt with the keypad divide key, in the list or on the surface, while the control takes
    // input; the key alone does nothing.
    struct Case {
        bool surface, enabled;
        int16_t shift;
        int16_t after;
    } cases[] = {{false, true, 0, 1},
                 {false, true, shift::Alt, 0},
                 {true, false, shift::Alt, 1},
                 {true, true, shift::Alt, 0}};
    for (const Case& c : cases) {
        act({kAll});
        c.surface ? form.focusControl(*site) : form.setFocus(*list);
        ag->setEnabled(c.enabled);
        form.press(vk::Divide, c.shift);
        EXPECT_EQ(all->value(), c.after);
        EXPECT_EQ(selected().empty(), c.after == 0);
        ag->setEnabled(true);
    }
}

TEST_F(AgencySelectionTest, DefaultSettingMakesTheChoiceAgain) {
    ag->setDatabaseName(db.string());
    struct Case {
        Rows steps;
        Variant value;
        Rows rows;
        int boxes;  // "All Agencies" * 10 + "Your Agencies"
        int clicks;
    } cases[] = {
        {{}, "+", {0, 1, 2, 3}, 10, 1},     {{}, "-", {1, 2, 3}, 1, 1},
        {{2}, "*", {0, 2}, 0, 1},           {{kYours}, "*", {0, 1, 2, 3}, 0, 1},
        {{kAll}, "+", {0, 1, 2, 3}, 10, 0}, {{1}, int16_t{5}, {1}, 0, 0},
        {{1}, Variant(), {1}, 0, 0},        {{1}, "+-", {1}, 0, 0},
    };
    for (const Case& c : cases) {
        SCOPED_TRACE(c.value.toString());
        act({kDeselect});
        for (int s : c.steps)
            act({s});
        form.clearEvents();
        ag->setDefaultSetting(c.value);
        EXPECT_EQ(selected(), c.rows);
        EXPECT_EQ(all->value() * 10 + yours->value(), c.boxes);
        EXPECT_EQ(clicks(), c.clicks);
    }
    ag->setEnabled(false);  // the boxes still do their work, without a Click; the list does none
    ag->setDefaultSetting("-");
    ag->setDefaultSetting("*");
    EXPECT_EQ(selected(), (Rows{0, 1, 2, 3}));
    EXPECT_EQ(yours->value(), 1);
    EXPECT_EQ(clicks(), 0);
}

TEST_F(AgencySelectionTest, HostClickHandlersCannotUnsettleTheGuards) {
    ag->setDatabaseName(db.string());
    int calls = 0;
    site->onEvent = [&](EventId id, EventArgs&) {
        if (id == EventId::Click && ++calls == 1) ag->setDefaultSetting("+");
        if (id == EventId::Click && calls == 2) throw std::runtime_error("host failed");
    };
    act({1});  // the list's guard is set: the box is checked, the rows stay as picked
    EXPECT_EQ(all->value(), 1);
    EXPECT_EQ(selected(), Rows{1});
    EXPECT_EQ(ag->ReturnedText(), "+");
    EXPECT_THROW(act({2}), std::runtime_error);
    act({kYours});
    EXPECT_EQ(selected(), (Rows{1, 2, 3}));
    EXPECT_EQ(calls, 3);
}

TEST_F(AgencySelectionTest, KeysMouseAndAccessKeys) {
    ag->setDatabaseName(db.string());
    form.setFocus(*yours);
    form.press('B');
    form.press(vk::Return);  // Enter is the host's: no focus move
    EXPECT_EQ(form.focused(), yours);
    form.click(*all);
    form.mouseMove(*all, 1, 0, 5, 5);
    form.setFocus(*list);
    form.press('C');
    form.doubleClick(*list);
    form.focusControl(*site);
    form.press('D');
    form.mouseDown(site->surface(), 1, 0, 5, 5);
    EXPECT_EQ(ryx::testing::eventNumbers(form, "ag"), (std::vector<int>{4, 5, 6, 4, 5, 6, 1, 2}));
    EXPECT_EQ(form.events()[0].args.Index, Variant(int16_t{1}));
    EXPECT_EQ(form.events()[1].args.KeyAscii, 'b');
    EXPECT_TRUE(form.events()[7].args.Index.isEmpty());

    form.setFocus(*before);
    form.press('A', shift::Alt);
    EXPECT_EQ(form.focused(), list);
    form.accessKey(*site, vk::Return);
    EXPECT_EQ(form.focused(), yours);
    int16_t key = 'x';
    ag->AccessKeyPress(key);
    EXPECT_EQ(key, 0);
    list->setEnabled(false);  // a list the host disabled takes no focus, and nothing fails
    EXPECT_NO_THROW(form.press('A', shift::Alt));
    EXPECT_NO_THROW(act({kDeselect}));
    EXPECT_EQ(form.focused(), button);
}

TEST_F(AgencySelectionTest, LockedTakesNoInputAndDisabledGreysEveryChild) {
    ag->setDatabaseName(db.string());
    ag->setLocked(true);
    act({kAll, 1, kDeselect});
    form.setFocus(*before);
    form.press('A', shift::Alt);
    EXPECT_EQ(form.focused(), before);
    EXPECT_EQ(all->value(), 0);
    EXPECT_TRUE(selected().empty());
    EXPECT_TRUE(list->isEnabled() && all->isEnabled() && button->isEnabled());
    ag->setLocked(false);
    ag->setEnabled(false);
    for (Node* n : std::initializer_list<Node*>{frame, list, all, yours, button})
        EXPECT_FALSE(n->isEnabled()) << n->displayName();
    form.press('A', shift::Alt);
    EXPECT_EQ(form.focused(), before);
}

TEST_F(AgencySelectionTest, LayoutAtCreationAndOnResize) {
    form.create("RYXAgencySelection", "fresh");
    EXPECT_EQ(form.site("fresh").child<HListBox>("LstAgMast").heightSize(), 900);
    EXPECT_EQ(form.site("fresh").child<HCommandButton>("cmdDeselect").left(), 1455);
    form.site("fresh").control().InitProperties();
    EXPECT_EQ(form.site("fresh").child<HListBox>("LstAgMast").widthSize(), 3000 - 150);
    EXPECT_EQ(form.site("fresh").notifications(),
              (std::vector<std::string>{"CrystalStyle", "Enabled", "Locked"}));
    struct Case {
        Twips width, controlWidth, listWidth, buttonLeft;
    } cases[] = {{1000, 2820, 2460, 1555}, {4000, 4000, 3640, 2735}};
    for (const Case& c : cases) {
        site->resizeByHost(c.width, 3000);
        EXPECT_EQ(site->width(), c.controlWidth);
        EXPECT_EQ(frame->widthSize(), c.controlWidth);
        EXPECT_EQ(frame->heightSize(), 1740);  // a taller control shows its surface below
        EXPECT_EQ(list->widthSize(), c.listWidth);
        EXPECT_EQ(button->left(), c.buttonLeft);
    }
}

TEST_F(AgencySelectionTest, ColoursAndEveryKeySurviveSaveAndReload) {
    site->clearRecords();
    ag->setForeColor(0x123456);
    EXPECT_EQ(ag->ButtonBackColor(), 0x0080C0FF);
    ag->setForeColor(Color(0x80000005));
    EXPECT_EQ(ag->ButtonBackColor(), kSystemLight3D);
    EXPECT_EQ(site->surfaceBackColor(), Color(0x80000005));
    ag->setButtonBackColor(0x000102);
    ag->setBackColor(0x030405);
    ag->setTitleColor(0x060708);
    ag->setCrystalStyle(false);
    ag->setLocked(true);
    ag->setEnabled(false);
    EXPECT_EQ(yours->backColor(), 0x030405);
    EXPECT_EQ(site->notifications(),
              (std::vector<std::string>{"ForeColor", "ForeColor", "BackColor", "TitleColor",
                                        "CrystalStyle", "Locked", "Enabled"}));

    Form loaded;
    saveForm(form, tmp / "form.json");
    loadForm(loaded, tmp / "form.json");
    auto& again = dynamic_cast<RYXAgencySelection&>(loaded.site("ag").control());
    EXPECT_EQ(again.ForeColor(), Color(0x80000005));
    EXPECT_EQ(again.ButtonBackColor(), 0x000102);  // not the colour ForeColor gave it
    EXPECT_EQ(again.BackColor(), 0x030405);
    EXPECT_EQ(again.TitleColor(), 0x060708);
    EXPECT_FALSE(again.CrystalStyle() || again.Enabled());
    EXPECT_TRUE(again.Locked());

    loadFormJson(loaded, R"({"format": "ryx-form/1", "controls": {"ag": {"type":
        "RYXAgencySelection", "properties": {"forecolor": 99, "TitleColor": "red"}}}})",
                 "inline");
    EXPECT_EQ(again.ButtonBackColor(), 0x0080C0FF);  // as loading ForeColor left it
    EXPECT_EQ(again.TitleColor(), 0x060708);         // unreadable: left as it was
    EXPECT_TRUE(again.CrystalStyle() && again.Enabled() && !again.Locked());
}

TEST_F(AgencySelectionTest, AHundredThousandAgenciesAllPicked) {
    ryx::testing::runSql(tmp / "big.db",
                         "CREATE TABLE AgMast (AgencyCd TEXT, Name TEXT);"
                         "WITH RECURSIVE n(i) AS (SELECT 1 UNION ALL SELECT i + 1 "
                         "FROM n WHERE i < 100000) INSERT INTO AgMast SELECT "
                         "printf('AG%06d', i), 'Agency ' || i FROM n;");
    ag->setDatabaseName((tmp / "big.db").string());
    ASSERT_EQ(list->listCount(), 100001);
    act({kAll, 0, 0});  // every row picked, neither box
    const std::string formula = ag->ReturnedText();
    EXPECT_EQ(formula.size(), 5u + 100000u * 11u);
    EXPECT_EQ(formula.substr(0, 16), R"(["*","AG000001",)");
    EXPECT_EQ(formula.substr(formula.size() - 12), R"(,"AG100000"])");
    ag->setCrystalStyle(false);
    const std::string plain = ag->ReturnedText();
    EXPECT_EQ(plain.size(), 1u + 100000u * 8u);
    EXPECT_EQ(plain.substr(plain.size() - 16), "AG099999AG100000");
}

}  // namespace
