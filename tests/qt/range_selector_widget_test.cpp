#include <gtest/gtest.h>

#include <QLineEdit>

#include "qt_fixture.h"
#include "ryx/qt/widgets.h"

using namespace ryx;
using namespace ryx::qt;

TEST(RangeSelectorWidget, KeyFiltersGiveTheSameTextsAsOnTheHeadlessForm) {
    struct Case {
        RYXRgSelTxtType type;
        const char* typed;
        const char* text;
    } cases[] = {
        {RYXANUAlphaNumeric, "a-b c", "AB C"},
        {RYXANDigits, "12a 3", "12 3"},
        {RYXANUserKeys, "a-b", "a-b"},
    };
    for (const Case& c : cases) {
        ryx::testing::QtWindow w;
        auto& rs = w.add<RangeSelectorWidget>();
        w.finish();
        rs.control().setTextType(c.type);
        QWidget* start = rs.childWidget("RYXT", 0);
        start->setFocus();
        QTest::keyClicks(start, c.typed);
        EXPECT_EQ(rs.control().StartText(), c.text) << c.typed;
        EXPECT_EQ(static_cast<QLineEdit*>(start)->text().toStdString(), c.text);
    }
}

TEST(RangeSelectorWidget, EnterMovesOnAndAltPAsksForTheListOfTheFocusedBox) {
    ryx::testing::QtWindow w;
    auto& rs = w.add<RangeSelectorWidget>();
    w.finish();
    rs.control().setControlType("policyno");
    std::vector<int> asked;
    QObject::connect(&rs, &ControlHost::ButtonClick,
                     [&](EventArgs& a) { asked.push_back(a.Index.toInt32()); });

    w.before->setFocus();
    QTest::keyClick(w.before, Qt::Key_Tab);  // entering the control puts the focus in the start box
    EXPECT_EQ(w.focusName(), "RYXT(0)");
    QTest::keyClicks(QApplication::focusWidget(), "1000");
    QTest::keyClick(QApplication::focusWidget(), Qt::Key_Return);
    EXPECT_EQ(w.focusName(), "RYXT(1)");
    QTest::keyClick(QApplication::focusWidget(), Qt::Key_P, Qt::AltModifier);
    QTest::keyClicks(QApplication::focusWidget(), "2500");
    QTest::keyClick(QApplication::focusWidget(), Qt::Key_Down);
    EXPECT_EQ(w.focusName(), "after");
    EXPECT_EQ(asked, std::vector<int>{1});
    EXPECT_EQ(rs.control().StartText(), "1000");
    EXPECT_EQ(rs.control().EndText(), "2500");
}
