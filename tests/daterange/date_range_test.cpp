#include "ryx/date_range.h"

#include <gtest/gtest.h>

#include "form_fixture.h"
#include "ryx/headless/form.h"
#include "ryx/headless/form_file.h"

using namespace ryx;
using namespace ryx::headless;
using ryx::testing::countEvents;

namespace {

constexpr const char* kEmpty = "__/__/____";

class DateRangeTest : public ::testing::Test {
  protected:
    void SetUp() override {
        form.setToday({2001, 8, 15});
        before = &form.addTextBox("txtBefore");
        dr = &form.add<RYXDateRange>("dr", 3000, 2000);
        after = &form.addTextBox("txtAfter");
        site = &form.site("dr");
        start = &site->child<HMaskedEdit>("MskDate", 0);
        end = &site->child<HMaskedEdit>("MskDate", 1);
        form.clearEvents();
        site->clearRecords();
    }

    void setUp(int style, int allowBlank, const char* s, const char* e) {
        dr->setDateStyle(style);
        dr->setAllowBlank(allowBlank);
        dr->setStartDate(s);
        dr->setEndDate(e);
    }
    void typeInto(HMaskedEdit& box, std::string_view text) {
        form.setFocus(box);
        form.type(text);
    }
    HImage& image(int16_t i) { return site->child<HImage>("ImgCalendar", i); }

    Form form;
    RYXDateRange* dr = nullptr;
    Site* site = nullptr;
    HMaskedEdit* start = nullptr;
    HMaskedEdit* end = nullptr;
    HTextBox* before = nullptr;
    HTextBox* after = nullptr;
};

// ---- appearance and persistence ------------------------------------------------------------

TEST_F(DateRangeTest, OneSizeFooterByStyleAndCheckedSetters) {
    site->resizeByHost(5000, 100);
    EXPECT_EQ(site->width(), 2430);
    EXPECT_EQ(site->height(), 1305);

    const char* footers[] = {"Enter Valid Dates", "Enter dates in same month",
                             "Enter dates in same year", "Enter dates in a Financial Year",
                             "Enter dates in a Financial Year"};  // 4 keeps the message
    for (int style = 0; style <= 4; ++style) {
        dr->setDateStyle(style);
        EXPECT_EQ(dr->FootNote(), footers[style]);
    }
    EXPECT_THROW(dr->setDateStyle(256), OverflowError);
    EXPECT_THROW(dr->setAllowBlank(-1), OverflowError);
    EXPECT_EQ(dr->DateStyle(), 4);

    site->clearRecords();
    dr->setForeColor(2);
    dr->setTitleColor(3);
    dr->setAllowBlank(3);
    for (int month : {13, 0})
        dr->setMonth(month);
    for (int year : {1599, 2201, 1600, 2200})
        dr->setYear(year);
    dr->setInnerColor(5);
    EXPECT_EQ(site->notifications(),
              (std::vector<std::string>{"ForeColor", "Titlecolor", "Month", "Year", "Year"}));
    EXPECT_EQ(site->surfaceBackColor(), 2);
    EXPECT_EQ(end->backColor(), 2);
    EXPECT_EQ(dr->Year(), 2200);
    EXPECT_EQ(dr->InnerColor(), 0);
}

TEST_F(DateRangeTest, DisabledGreysTheDateTextAndLockedTakesNoInput) {
    dr->setEnabled(false);
    EXPECT_FALSE(site->child<HFrame>("fraDateRange").isEnabled());
    EXPECT_FALSE(site->child<HLabel>("lblFooter").isEnabled());
    EXPECT_EQ(end->foreColor(), kSystemLight3D);
    EXPECT_TRUE(image(0).isEnabled());
    dr->setEnabled(true);
    EXPECT_EQ(end->foreColor(), kBlack);

    dr->setLocked(true);
    form.click(image(0));
    EXPECT_FALSE(dr->ImageClick);
    EXPECT_EQ(countEvents(form, "dr", EventId::ButtonClick), 0);
}

TEST_F(DateRangeTest, EveryKeySurvivesSaveAndReload) {
    ryx::testing::TempFolder tmp;
    dr->setMonth(5);
    dr->setYear(2004);
    dr->setAllowBlank(2);
    dr->setDateStyle(1);  // its footer message is saved as "FootNote"
    dr->setCrystalStyle(false);
    dr->setLocked(true);
    dr->setEnabled(false);
    dr->setShowCalendar(false);
    dr->setForeColor(0x111111);
    dr->setBackColor(0x222222);
    dr->setTitleColor(0x333333);
    dr->setCalendarPosition(3);
    dr->setCaption("Period");
    dr->setStartDate("15/08/2001");  // typed dates are not saved
    saveForm(form, tmp / "form.json");

    Form loaded;
    loadForm(loaded, tmp / "form.json");
    EXPECT_EQ(formToJson(loaded), formToJson(form));
    auto& again = dynamic_cast<RYXDateRange&>(loaded.site("dr").control());
    EXPECT_EQ(again.FootNote(), "Enter dates in same month");
    EXPECT_EQ(again.ForeColor(), 0x111111);
    EXPECT_EQ(loaded.site("dr").child<HMaskedEdit>("MskDate", 0).text(), kEmpty);
}

TEST_F(DateRangeTest, LoadingIgnoresDamagedValuesKeyByKey) {
    dr->setMonth(4);
    dr->setYear(2003);
    loadFormJson(form, R"({"format": "ryx-form/1", "controls": {"dr": {"type": "RYXDateRange",
        "properties": {"Month": 13, "Year": 1500, "datestyle": 300, "ALLOWBLANK": 1,
                       "FootNote": "Saved words", "Caption": [1]}}}})",
                 "inline");
    EXPECT_EQ(dr->Month(), 4);
    EXPECT_EQ(dr->Year(), 2003);
    EXPECT_EQ(dr->DateStyle(), 0);
    EXPECT_EQ(dr->AllowBlank(), 1);
    EXPECT_EQ(dr->FootNote(), "Saved words");
    EXPECT_EQ(dr->Caption(), "&Date Range");
}

// ---- default dates and reading -------------------------------------------------------------

TEST_F(DateRangeTest, DefaultDatesFollowTheStyleMonthYearAndToday) {
    struct Case {
        int style, month, year, todayMonth;  // today is the 15th of that month in 2001
        const char *startBox, *first, *last;
    } cases[] = {{0, 0, 0, 8, "", "01/08/2001", "31/08/2001"},
                 {0, 2, 2004, 8, "", "01/02/2004", "29/02/2004"},
                 {1, 0, 0, 8, "10/02/2000", "01/08/2001", "29/02/2000"},
                 {2, 0, 0, 8, "10/03/2001", "01/01/2001", "31/12/2001"},
                 {3, 0, 0, 8, "", "01/04/2001", "31/03/2002"},
                 {3, 0, 0, 4, "", "01/04/2001", "31/03/2002"},
                 {3, 0, 0, 3, "", "01/04/2000", "31/03/2001"},
                 {3, 0, 0, 2, "15/02/2001", "01/04/2000", "31/03/2001"},
                 {3, 2, 0, 8, "", "01/02/2000", "31/03/2000"},
                 {3, 2, 0, 2, "", "01/02/2001", "31/03/2001"},
                 {3, 0, 2005, 8, "", "01/04/2005", "31/03/2006"},
                 {4, 0, 0, 8, "", "01//2001", "01//2001"}};
    for (const Case& c : cases) {
        Form f;
        f.setToday({2001, c.todayMonth, 15});
        auto& control = f.add<RYXDateRange>("dr");
        control.setDateStyle(c.style);
        control.setMonth(c.month);
        control.setYear(c.year);
        control.setStartDate(c.startBox);
        EXPECT_EQ(control.d_DefaultDate(0), c.first) << c.style << " " << c.todayMonth;
        EXPECT_EQ(control.d_DefaultDate(1), c.last) << c.style << " " << c.startBox;
        EXPECT_FALSE(isDate(control.d_DefaultDate(2)));
    }
}

TEST_F(DateRangeTest, ReadingFillsBlankDatesThatMayNotBeBlank) {
    struct Case {
        int style, allowBlank;
        bool readEnd;
        const char *start, *end, *startAfter, *endAfter;
    } cases[] = {{0, 0, false, "", "", "01/08/2001", kEmpty},
                 {3, 2, false, "", "", "01/04/2001", kEmpty},
                 {0, 1, false, "", "", kEmpty, kEmpty},
                 {0, 0, true, "", "", kEmpty, kEmpty},  // the end needs a start
                 {0, 0, true, "10/02/2004", "", "10/02/2004", "29/02/2004"},
                 {0, 2, true, "10/02/2004", "", "10/02/2004", kEmpty},
                 {1, 0, true, "15/03/2000", "20/05/2000", "15/03/2000", "31/03/2000"},
                 {1, 0, true, "15/03/2000", "10/03/2000", "15/03/2000", "10/03/2000"},  // left
                 {2, 1, true, "15/03/2000", "10/01/2001", "15/03/2000", "31/12/2000"},
                 {3, 0, true, "15/02/2001", "10/06/2001", "15/02/2001", "31/03/2001"},
                 {3, 0, true, "15/05/2000", "10/02/2001", "15/05/2000", "10/02/2001"}};
    for (const Case& c : cases) {
        setUp(c.style, c.allowBlank, c.start, c.end);
        (void)(c.readEnd ? dr->EndDate() : dr->StartDate());
        EXPECT_EQ(start->text(), c.startAfter) << c.start << " .. " << c.end;
        EXPECT_EQ(end->text(), c.endAfter) << c.start << " .. " << c.end;
    }
}

TEST_F(DateRangeTest, DatesComeBackInBothSyntaxesAndBlankAsEmpty) {
    dr->setStartDate("15/08/2001");
    EXPECT_EQ(dr->StartDate(), Variant("Date( 2001,08,15)"));
    dr->setCrystalStyle(false);
    EXPECT_EQ(dr->StartDate(), Variant("15/08/2001"));

    std::pair<Variant, const char*> cases[] = {{"", kEmpty},
                                               {"hello", kEmpty},
                                               {Variant(), kEmpty},
                                               {"11/11/1111", kEmpty},
                                               {"1 /5 /2000", "01/05/2000"},
                                               {"5-6-01", "05/06/2001"}};
    for (const auto& [value, box] : cases) {
        site->clearRecords();
        dr->setEndDate(value);
        EXPECT_EQ(end->text(), box);
        EXPECT_EQ(site->notifications(), std::vector<std::string>{"EndDate"});
    }
    dr->setEndDate("11/11/1111");
    dr->ImageClick = true;  // no fill: the blank end reads as nothing at all
    EXPECT_TRUE(dr->EndDate().isEmpty());
}

TEST_F(DateRangeTest, ReadingSeesWhatTheUserTypedWithoutLeavingTheBox) {
    typeInto(*start, "150801");
    EXPECT_EQ(start->text(), "15/08/01__");
    EXPECT_EQ(dr->StartDate(), Variant("Date( 2001,08,15)"));
    EXPECT_EQ(start->text(), "15/08/2001");
    typeInto(*end, "05132000");
    EXPECT_EQ(dr->EndDate(), Variant("Date( 2000,12,05)"));
}

// ---- range rules ---------------------------------------------------------------------------

TEST_F(DateRangeTest, LeavingTheEndBoxMovesOrClearsTheEnd) {
    struct Case {
        int style, allowBlank;
        const char *start, *end, *result;
    } cases[] = {{0, 0, "15/08/2001", "", "31/08/2001"},
                 {0, 1, "15/02/2004", "", "29/02/2004"},
                 {0, 2, "15/08/2001", "", kEmpty},
                 {0, 1, "", "10/02/2004", "10/02/2004"},
                 {0, 2, "20/02/2004", "10/02/2004", "29/02/2004"},
                 {0, 0, "20/02/2004", "10/02/2004", kEmpty},
                 {1, 0, "15/03/2000", "20/05/2000", "20/03/2000"},
                 {1, 0, "15/04/2000", "31/05/2000", kEmpty},  // no 31st of April
                 {1, 0, "15/03/2000", "14/03/2000", kEmpty},
                 {2, 0, "15/11/2000", "10/02/2001", kEmpty},
                 {2, 0, "15/03/2000", "10/05/2001", "10/05/2000"},
                 {2, 0, "15/03/2000", "20/03/2001", "20/03/2000"},
                 {2, 1, "15/03/2000", "10/03/2001", "31/12/2000"},
                 {2, 2, "15/03/2000", "10/03/2001", kEmpty},
                 {3, 0, "15/05/2000", "10/02/2001", "10/02/2001"},
                 {3, 0, "15/05/2000", "10/02/2002", "10/02/2001"},
                 {3, 0, "15/02/2001", "10/06/2001", "10/06/2000"},
                 {3, 0, "15/02/2001", "10/03/2002", "10/03/2001"},
                 {3, 0, "15/05/2000", "10/08/2001", "10/08/2000"},
                 {3, 3, "15/05/2000", "10/05/2001", "31/03/2001"},
                 {3, 0, "15/05/2000", "15/05/2001", "15/05/2000"},
                 {3, 0, "15/05/2000", "20/05/2001", "20/05/2000"},
                 {3, 0, "15/05/2001", "29/02/2004", kEmpty},  // 2002 has no 29th of February
                 {4, 0, "15/05/2000", "15/05/2000", "15/05/2000"},
                 {4, 0, "15/05/2000", "16/05/2000", kEmpty},
                 {0, 0, "10/02/2004", "20/03/2005", nullptr}};  // not touched
    for (const Case& c : cases) {
        form.setFocus(*end);
        setUp(c.style, c.allowBlank, c.start, c.end);
        site->clearRecords();
        form.setFocus(*start);  // the end box's own rules, without leaving the control
        EXPECT_EQ(end->text(), c.result ? c.result : c.end) << c.start << " .. " << c.end;
        EXPECT_EQ(site->notifications().size(), c.result ? 1u : 0u);
    }
}

TEST_F(DateRangeTest, LeavingTheStartBoxTidiesItOrFillsItOrClearsIt) {
    struct Case {
        int style, allowBlank;
        const char *typed, *result;
    } cases[] = {{0, 0, "150801", "15/08/2001"},
                 {0, 0, "", "01/08/2001"},
                 {3, 2, "", "01/04/2001"},
                 {0, 1, "", kEmpty},
                 {0, 3, "1", kEmpty},
                 {4, 0, "", kEmpty}};
    for (const Case& c : cases) {
        setUp(c.style, c.allowBlank, "", "");
        typeInto(*start, c.typed);
        form.setFocus(*end);
        EXPECT_EQ(start->text(), c.result) << c.style << " " << c.typed;
    }
}

TEST_F(DateRangeTest, LeavingTheControlChecksBothDates) {
    form.setFocus(*start);
    form.setFocus(*after);  // straight from the start box: the end is filled too
    EXPECT_EQ(end->text(), "31/08/2001");

    dr->setDateStyle(3);
    dr->setStartDate("");
    typeInto(*start, "15/5/2001");
    form.keys("{TAB}10022003{TAB}");
    EXPECT_EQ(form.focused(), after);
    EXPECT_EQ(dr->StartDate(), Variant("Date( 2001,05,15)"));
    EXPECT_EQ(dr->EndDate(), Variant("Date( 2002,02,10)"));  // in the start's financial year
}

TEST_F(DateRangeTest, NoRuleRunsWhileLockedDisabledOrAfterACalendarClick) {
    for (int way = 0; way < 3; ++way) {
        Form f;
        auto& control = f.add<RYXDateRange>("dr");
        auto& box = f.site("dr").child<HMaskedEdit>("MskDate", 0);
        auto& outside = f.addTextBox("outside");
        f.setFocus(box);
        f.type("1508");
        if (way == 0) control.setLocked(true);
        if (way == 1) control.setEnabled(false);
        if (way == 2) f.click(f.site("dr").child<HImage>("ImgCalendar", 1));
        f.setFocus(outside);
        EXPECT_EQ(box.text(), "15/08/____") << way;
        EXPECT_EQ(f.site("dr").child<HMaskedEdit>("MskDate", 1).text(), kEmpty);
    }
}

TEST_F(DateRangeTest, CalendarImagesRaiseButtonClick) {
    form.click(image(1));
    form.click(image(1));
    EXPECT_TRUE(dr->ImageClick);
    ASSERT_EQ(countEvents(form, "dr", EventId::ButtonClick), 2);
    EXPECT_EQ(form.events().back().args.Index, Variant(int16_t{1}));
    EXPECT_TRUE(dr->StartDate().isEmpty());  // no fill while the host answers the click
    dr->ImageClick = false;
    EXPECT_EQ(dr->StartDate(), Variant("Date( 2001,08,01)"));
}

// ---- typing --------------------------------------------------------------------------------

TEST_F(DateRangeTest, SlashCompletesTheDayOrMonthAndTypingOverwrites) {
    const char* cases[][3] = {{"", "1/5/2000", "01/05/2000"},
                              {"", "15/05/2000", "15/05/2000"},
                              {"", "15052000", "15/05/2000"},
                              {"", "/", "01/__/____"},
                              {"", "45/", kEmpty},
                              {"", "12/13/", "12/__/____"},
                              {"", "15/05/20/01", "15/05/2001"},
                              {"", "3/11/", "03/11/____"},
                              {"28/02/2001", "10", "10/02/2001"}};
    for (auto [old, typed, text] : cases) {
        dr->setStartDate(old);
        typeInto(*start, typed);
        EXPECT_EQ(start->text(), text) << typed;
    }
}

TEST_F(DateRangeTest, EnterStaysAndArrowsMoveTheFocus) {
    form.setFocus(*end);
    form.press(vk::Return);
    EXPECT_EQ(form.focused(), end);
    ASSERT_EQ(ryx::testing::eventNumbers(form, "dr"), (std::vector<int>{4, 5}));
    EXPECT_EQ(form.events()[1].args.KeyAscii, 13);  // the host sees the Enter first
    EXPECT_EQ(form.events()[1].args.Index, Variant(int16_t{1}));

    form.press(vk::Up);
    EXPECT_EQ(form.focused(), start);
    form.press(vk::Up);
    EXPECT_EQ(form.focused(), before);
    form.setFocus(*start);
    form.keys("{DOWN}{DOWN}");
    EXPECT_EQ(form.focused(), after);
    form.focusControl(*site);  // Enter on the surface moves on
    form.press(vk::Return);
    EXPECT_EQ(form.focused(), after);
}

TEST_F(DateRangeTest, TheHostSeesEachKeyFirstAndMayChangeIt) {
    site->onEvent = [](EventId id, EventArgs& a) {
        if (id != EventId::KeyPress) return;
        if (a.KeyAscii == '/')
            a.KeyAscii = 0;
        else if (a.KeyAscii == '-')
            a.KeyAscii = '/';
    };
    typeInto(*start, "5-6-2001");
    EXPECT_EQ(start->text(), "05/06/2001");
    dr->setStartDate("");
    typeInto(*start, "5/06");  // a zeroed key: no rule at all
    EXPECT_EQ(start->text(), "50/6_/____");
}

TEST_F(DateRangeTest, ControlKeysActOnTheWholeSelection) {
    dr->setStartDate("15/08/2001");
    form.setFocus(*start);
    start->setSelLength(10);
    form.press('X', shift::Ctrl);
    EXPECT_EQ(start->text(), kEmpty);
}

}  // namespace
