#include <gtest/gtest.h>

#include <QCheckBox>
#include <QImage>

#include "qt_fixture.h"
#include "ryx/qt/widgets.h"

using namespace ryx;
using namespace ryx::qt;

TEST(PolicyStatusWidget, ClicksGiveTheSameCriterionAsOnTheHeadlessForm) {
    ryx::testing::QtWindow w;
    auto& ps = w.add<PolicyStatusWidget>();
    w.finish();
    int clicks = 0;
    QObject::connect(&ps, &ControlHost::Click, [&](EventArgs&) { ++clicks; });

    ryx::testing::clickRow(ps.childWidget("LstPolicyStatus"), 0);
    ryx::testing::clickRow(ps.childWidget("LstPolicyStatus"), 3);
    EXPECT_EQ(ps.control().ReturnedText(), R"(["I","F"])");
    EXPECT_EQ(clicks, 2);

    QTest::mouseClick(ps.childWidget("ChkAll"), Qt::LeftButton);
    EXPECT_EQ(ps.control().ReturnedText(), "+");
    EXPECT_TRUE(static_cast<QCheckBox*>(ps.childWidget("ChkAll"))->isChecked());
    ryx::testing::clickRow(ps.childWidget("LstPolicyStatus"), 5);
    EXPECT_FALSE(static_cast<QCheckBox*>(ps.childWidget("ChkAll"))->isChecked());
    EXPECT_EQ(ps.control().DefaultSetting(), Variant("ILRFSD"));
}

TEST(PolicyStatusWidget, EnterAndArrowsMoveTheFocusAlongTheTabOrder) {
    ryx::testing::QtWindow w;
    auto& ps = w.add<PolicyStatusWidget>();
    w.finish();
    w.before->setFocus();
    QTest::keyClick(w.before, Qt::Key_Tab);
    EXPECT_EQ(w.focusName(), "LstPolicyStatus");
    QTest::keyClick(QApplication::focusWidget(), Qt::Key_Return);
    EXPECT_EQ(w.focusName(), "ChkAll");
    QTest::keyClick(QApplication::focusWidget(), Qt::Key_Up);
    EXPECT_EQ(w.focusName(), "LstPolicyStatus");
    QTest::keyClick(QApplication::focusWidget(), Qt::Key_Tab);
    QTest::keyClick(QApplication::focusWidget(), Qt::Key_Down);
    EXPECT_EQ(w.focusName(), "after");

    // A host handler that swallows the Enter stops the move.
    QObject::connect(&ps, &ControlHost::KeyPress, [](EventArgs& a) {
        if (a.KeyAscii == 13) a.KeyAscii = 0;
    });
    ps.childWidget("LstPolicyStatus")->setFocus();
    QTest::keyClick(QApplication::focusWidget(), Qt::Key_Return);
    EXPECT_EQ(w.focusName(), "LstPolicyStatus");
}

TEST(PolicyStatusWidget, LockedTakesNoInputAndLooksTheSame) {
    ryx::testing::QtWindow w;
    auto& ps = w.add<PolicyStatusWidget>();
    w.finish();
    ryx::testing::clickRow(ps.childWidget("LstPolicyStatus"), 1);
    QApplication::processEvents();
    const QImage unlocked = ps.grab().toImage();

    ps.control().setLocked(true);
    QApplication::processEvents();
    EXPECT_EQ(ps.grab().toImage(), unlocked);
    ryx::testing::clickRow(ps.childWidget("LstPolicyStatus"), 2);
    QTest::mouseClick(ps.childWidget("ChkAll"), Qt::LeftButton);
    EXPECT_EQ(ps.control().ReturnedText(), R"(["L"])");
    w.before->setFocus();
    QTest::keyClick(w.before, Qt::Key_Tab);
    EXPECT_EQ(w.focusName(), "after");  // the tab order passes over a locked control

    ps.control().setLocked(false);
    ryx::testing::clickRow(ps.childWidget("LstPolicyStatus"), 2);
    EXPECT_EQ(ps.control().ReturnedText(), R"(["L","P"])");
}
