#include <gtest/gtest.h>

#include <QLineEdit>

#include "qt_fixture.h"
#include "ryx/qt/widgets.h"

using namespace ryx;
using namespace ryx::qt;

namespace {

QString boxText(DateRangeWidget& dr, int16_t index) {
    return static_cast<QLineEdit*>(dr.childWidget("MskDate", index))->text();
}

}  // namespace

// The same keys as the headless tests type give the same box texts: the field never skips a
// separator on its own, so "/" completes the day and month as the control intends.
TEST(DateRangeWidget, TypingWithTheSlashHelpGivesTheHeadlessResults) {
    struct Case {
        const char* typed;
        const char* shown;
    } cases[] = {
        {"15/", "15/__/____"},      {"1/5/2000", "01/05/2000"}, {"15/05/2000", "15/05/2000"},
        {"15052000", "15/05/2000"}, {"45/", "__/__/____"},
    };
    for (const Case& c : cases) {
        ryx::testing::QtWindow w;
        auto& dr = w.add<DateRangeWidget>();
        w.finish();
        QWidget* start = dr.childWidget("MskDate", 0);
        start->setFocus();
        QTest::keyClicks(start, c.typed);
        EXPECT_EQ(boxText(dr, 0).toStdString(), c.shown) << c.typed;
    }
}

TEST(DateRangeWidget, TabAndArrowsMoveTheFocusAndLeavingABoxRepairsIt) {
    ryx::testing::QtWindow w;
    auto& dr = w.add<DateRangeWidget>();
    w.finish();
    dr.control().setDateStyle(RYXDtRgStyle::RYXDtRgFinancialYear);
    w.before->setFocus();
    QTest::keyClick(w.before, Qt::Key_Tab);
    EXPECT_EQ(w.focusName(), "MskDate(0)");
    QTest::keyClicks(QApplication::focusWidget(), "15/05/2001");
    QTest::keyClick(QApplication::focusWidget(), Qt::Key_Return);  // swallowed: no move
    EXPECT_EQ(w.focusName(), "MskDate(0)");
    QTest::keyClick(QApplication::focusWidget(), Qt::Key_Down);
    EXPECT_EQ(w.focusName(), "MskDate(1)");
    QTest::keyClicks(QApplication::focusWidget(), "10/02/2003");
    QTest::keyClick(QApplication::focusWidget(), Qt::Key_Tab);
    EXPECT_EQ(w.focusName(), "after");
    EXPECT_EQ(boxText(dr, 1).toStdString(), "10/02/2002");  // moved into the start's year
    EXPECT_EQ(dr.control().StartDate(), Variant("Date( 2001,05,15)"));
    QTest::keyClick(w.after, Qt::Key_Tab, Qt::ShiftModifier);
    QTest::keyClick(QApplication::focusWidget(), Qt::Key_Up);
    EXPECT_EQ(w.focusName(), "MskDate(0)");
}

TEST(DateRangeWidget, TheYearFieldTakesNoSlash) {
    ryx::testing::QtWindow w;
    auto& dr = w.add<DateRangeWidget>();
    w.finish();
    QWidget* start = dr.childWidget("MskDate", 0);
    start->setFocus();
    QTest::keyClicks(start, "15052");
    QTest::keyClicks(start, "/");
    EXPECT_EQ(boxText(dr, 0).toStdString(), "15/05/2___");
    EXPECT_EQ(static_cast<QLineEdit*>(start)->cursorPosition(), 7);
}

TEST(DateRangeWidget, CalendarImagesAskTheHostUnlessLocked) {
    ryx::testing::QtWindow w;
    auto& dr = w.add<DateRangeWidget>();
    w.finish();
    std::vector<int> asked;
    QObject::connect(&dr, &ControlHost::ButtonClick,
                     [&](EventArgs& a) { asked.push_back(a.Index.toInt32()); });
    QTest::mouseClick(dr.childWidget("ImgCalendar", 1), Qt::LeftButton);
    EXPECT_EQ(asked, std::vector<int>{1});
    EXPECT_TRUE(dr.control().ImageClick);

    dr.control().ImageClick = false;
    dr.control().setLocked(true);
    QTest::mouseClick(dr.childWidget("ImgCalendar", 0), Qt::LeftButton);
    EXPECT_EQ(asked, std::vector<int>{1});
    EXPECT_FALSE(dr.control().ImageClick);
}
