// A list longer than the batches the criterion text reads the records in, with picks in runs
// and alone, and a code that needs its quote doubled.
#include <gtest/gtest.h>

#include "../sqlite/test_database.h"
#include "form_fixture.h"
#include "ryx/agency_selection.h"
#include "ryx/sqlite/sqlite_record_source.h"

using namespace ryx;
using namespace ryx::headless;
using ryx::testing::AgencyRow;

namespace {

TEST(AgencyLongList, RowsAndCriterionTextsFollowTheRecords) {
    // Codes in code order: K0000 ... K0699, one holding a quote.
    std::vector<AgencyRow> rows;
    for (int i = 0; i < 700; ++i) {
        char code[8];
        std::snprintf(code, sizeof code, "K%04d", i);
        rows.emplace_back(i == 300 ? "K0300\"q" : code, "Agency " + std::to_string(i));
    }
    ryx::testing::TempFolder tmp;
    const auto db = tmp / "long.db";
    ryx::testing::runSql(db, "BEGIN;" + ryx::testing::agencyTable(rows) + "COMMIT;");

    Form form;
    form.setRecordSourceFactory(sqlite::makeRecordSource);
    auto& ag = form.add<RYXAgencySelection>("ag", 2820, 1740);
    auto& list = form.site("ag").child<HListBox>("LstAgMast");
    for (int fill = 0; fill < 2; ++fill)
        ag.setDatabaseName(db.string());
    ASSERT_EQ(list.listCount(), 701);
    for (int row : {700, 1, 301, 257, 0})
        EXPECT_EQ(list.list(row), row == 0 ? "*   Others"
                                           : rows[static_cast<size_t>(row - 1)].first + "  " +
                                                 *rows[static_cast<size_t>(row - 1)].second);

    // Runs across the batch edges (rows 250 to 270, 500 to 700) and single rows.
    std::vector<int> picks = {1, 2, 5};
    for (int r = 250; r <= 270; ++r)
        picks.push_back(r);
    picks.insert(picks.end(), {301, 302});
    for (int r = 500; r <= 700; ++r)
        picks.push_back(r);
    std::string formula, plain;
    for (int row : picks) {
        form.clickRow(list, row);
        std::string code = rows[static_cast<size_t>(row - 1)].first;
        plain += code;
        if (row == 301) code = "K0300\"\"q";
        formula += (formula.empty() ? "\"" : ",\"") + code + "\"";
    }
    ag.setCrystalStyle(false);
    EXPECT_EQ(ag.ReturnedText(), plain);
    ag.setCrystalStyle(true);
    EXPECT_EQ(ag.ReturnedText(), "[" + formula + "]");
    form.clickRow(list, 0);
    EXPECT_EQ(ag.ReturnedText(), "[\"*\"," + formula + "]");
}

}  // namespace
