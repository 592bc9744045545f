// Reading the snapshot in place: a record's field by position, a batch of records at a time,
// across the blocks the text is kept in.
#include <gtest/gtest.h>

#include <array>

#include "form_fixture.h"
#include "ryx/errors.h"
#include "ryx/sqlite/sqlite_record_source.h"
#include "test_database.h"

using namespace ryx;
using ryx::testing::AgencyRow;
namespace rt = ryx::testing;

namespace {

// Codes and names that fill several blocks of text: long names, a name longer than a block,
// nulls and empty texts, some of them where a block begins.
std::vector<AgencyRow> manyRows() {
    std::vector<AgencyRow> rows;
    for (int i = 0; i < 3000; ++i) {
        const std::string code = "C" + std::to_string(10000 + i);
        std::optional<std::string> name =
            std::string(static_cast<size_t>(i % 7) * 150, 'a' + i % 26);
        if (i % 11 == 0) name.reset();
        if (i == 1700) name = std::string(1536 * 1024, 'L');
        rows.emplace_back(code, name);
    }
    rows.emplace_back("C99999", "");
    return rows;
}

TEST(SnapshotReading, BatchesAndSingleFieldsMatchTheCursor) {
    rt::TempFolder tmp;
    const auto file = tmp / "agencies.db";
    rt::runSql(file, "BEGIN;" + rt::agencyTable(manyRows()) + "COMMIT;");
    sqlite::SqliteRecordSource source{
        {.name = "DatAgMast",
         .connect = "",
         .recordSource = "select AgencyCd,Name from AgMast order by AgencyCd"}};
    source.setDatabaseName(file.string());
    source.refresh();
    RecordSet& records = source.recordset();
    ASSERT_EQ(records.recordCount(), 3001u);

    std::vector<AgencyRow> byCursor;
    for (records.moveFirst(); !records.eof(); records.moveNext())
        byCursor.emplace_back(*records.field(0), records.field(1));
    EXPECT_EQ(byCursor, manyRows());

    // Batches from the start, from the middle, backwards, and single fields at random.
    for (size_t step : {size_t{256}, size_t{7}, size_t{1}}) {
        std::array<std::optional<std::string_view>, 256> batch;
        std::vector<AgencyRow> read(3001);
        for (size_t first = 0; first < 3001;) {
            const size_t got = records.readField(0, first, std::span(batch).first(step));
            for (size_t i = 0; i < got; ++i)
                read[first + i].first = std::string(*batch[i]);
            first += got;
        }
        for (size_t first = 3001; first > 0;) {
            first = first > step ? first - step : 0;
            const size_t got = records.readField(1, first, std::span(batch).first(step));
            for (size_t i = 0; i < got; ++i)
                if (batch[i]) read[first + i].second = std::string(*batch[i]);
        }
        EXPECT_EQ(read, byCursor) << "batches of " << step;
    }
    for (size_t record : {2999u, 0u, 1700u, 11u, 3000u, 1701u, 1699u})
        EXPECT_EQ(records.fieldAt(record, 1), byCursor[record].second) << record;
    EXPECT_EQ(records.fieldAt(3000, 1), "");  // an empty text is not a null

    std::array<std::optional<std::string_view>, 4> four;
    EXPECT_EQ(records.readField(0, 2999, four), 2u);
    EXPECT_THROW(records.readField(0, 3001, four), DataSourceError);
    EXPECT_THROW(records.fieldAt(0, 2), DataSourceError);
    EXPECT_THROW(records.fieldAt(0, -1), DataSourceError);
}

}  // namespace
