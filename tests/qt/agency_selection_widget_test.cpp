#include <gtest/gtest.h>

#include <QCheckBox>
#include <QPushButton>

#include "../sqlite/test_database.h"
#include "qt_fixture.h"
#include "ryx/qt/widgets.h"
#include "ryx/sqlite/sqlite_record_source.h"

using namespace ryx;
using namespace ryx::qt;

namespace {

class AgencyWidgetTest : public ::testing::Test {
  protected:
    void SetUp() override { ControlHost::setRecordSourceFactory(sqlite::makeRecordSource); }
    void TearDown() override { ControlHost::setRecordSourceFactory(nullptr); }
    ryx::testing::TempFolder tmp;
};

TEST_F(AgencyWidgetTest, BoxesRowsAndDeselectAllGiveTheHeadlessCriteria) {
    const auto db = tmp / "agencies.db";
    ryx::testing::runSql(
        db, ryx::testing::agencyTable({{"B2", "Beta"}, {"A1", "Alpha"}, {"C3", "Gamma"}}));
    ryx::testing::QtWindow w;
    auto& ag = w.add<AgencySelectionWidget>();
    w.finish();
    ag.control().setDatabaseName(db.string());
    int clicks = 0;
    QObject::connect(&ag, &ControlHost::Click, [&](EventArgs&) { ++clicks; });

    QTest::mouseClick(ag.childWidget("chkAgmast", 0), Qt::LeftButton);  // "All Agencies"
    EXPECT_EQ(ag.control().ReturnedText(), "+");
    EXPECT_EQ(clicks, 1);
    ryx::testing::clickRow(ag.childWidget("LstAgMast"), 2);  // B2 off: pick mode
    EXPECT_FALSE(static_cast<QCheckBox*>(ag.childWidget("chkAgmast", 0))->isChecked());
    EXPECT_EQ(ag.control().ReturnedText(), R"(["*","A1","C3"])");

    QTest::mouseClick(ag.childWidget("chkAgmast", 1), Qt::LeftButton);  // "Your Agencies"
    EXPECT_EQ(ag.control().ReturnedText(), "-");
    QTest::mouseClick(ag.childWidget("cmdDeselect"), Qt::LeftButton);
    EXPECT_EQ(ag.control().ReturnedText(), "+");
    EXPECT_EQ(ag.control().DefaultSetting(), Variant());
    EXPECT_EQ(w.focusName(), "LstAgMast");
    ryx::testing::clickRow(ag.childWidget("LstAgMast"), 3);
    ag.control().setCrystalStyle(false);
    EXPECT_EQ(ag.control().ReturnedText(), "C3");
}

TEST_F(AgencyWidgetTest, TheFrameAccessKeyPutsTheFocusInTheList) {
    ryx::testing::QtWindow w;
    auto& ag = w.add<AgencySelectionWidget>();
    w.finish();
    w.before->setFocus();
    QTest::keyClick(&w.window(), Qt::Key_A, Qt::AltModifier);
    EXPECT_EQ(w.focusName(), "LstAgMast");

    w.before->setFocus();
    ag.control().setLocked(true);
    QTest::keyClick(&w.window(), Qt::Key_A, Qt::AltModifier);
    EXPECT_EQ(w.focusName(), "before");
}

// A million agencies reach the Qt list, and selecting them all stays a single pass.
TEST_F(AgencyWidgetTest, AMillionAgenciesFillTheListAndSelect) {
    const auto db = tmp / "big.db";
    ryx::testing::runSql(db,
                         "CREATE TABLE AgMast (AgencyCd TEXT, Name TEXT);"
                         "WITH RECURSIVE n(x) AS (SELECT 1 UNION ALL SELECT x + 1 FROM n "
                         "WHERE x < 1000000) INSERT INTO AgMast "
                         "SELECT printf('A%07d', x), 'Agency ' || x FROM n;");
    ryx::testing::QtWindow w;
    auto& ag = w.add<AgencySelectionWidget>();
    w.finish();
    ag.control().setDatabaseName(db.string());
    QApplication::processEvents();
    auto* view = qobject_cast<QListView*>(ag.childWidget("LstAgMast"));
    EXPECT_EQ(view->model()->rowCount(), 1000001);
    view->scrollToBottom();
    QApplication::processEvents();
    EXPECT_EQ(view->model()->index(1000000, 0).data().toString(), "A1000000  Agency 1000000");

    QTest::mouseClick(ag.childWidget("chkAgmast", 1), Qt::LeftButton);  // "Your Agencies"
    EXPECT_EQ(ag.control().ReturnedText(), "-");
    ryx::testing::clickRow(ag.childWidget("LstAgMast"), 1);  // the first agency off
    const std::string text = ag.control().ReturnedText();
    EXPECT_EQ(text.size(), 2 + 999999 * 11 - 1);
    EXPECT_EQ(text.substr(0, 13), R"(["A0000002",")");
    EXPECT_EQ(text.substr(text.size() - 11), R"("A1000000"])");
}

}  // namespace
