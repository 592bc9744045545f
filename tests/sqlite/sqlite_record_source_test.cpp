#include "ryx/sqlite/sqlite_record_source.h"

#include <gtest/gtest.h>

#include <fstream>

#include "form_fixture.h"
#include "ryx/errors.h"
#include "test_database.h"

using namespace ryx;
using ryx::testing::AgencyRow;
using ryx::testing::agencyTable;
using ryx::testing::runSql;

namespace {

// Every record of the set from its first, as code and name.
std::vector<AgencyRow> readAll(RecordSet& records) {
    std::vector<AgencyRow> rows;
    for (records.moveFirst(); !records.eof(); records.moveNext())
        rows.emplace_back(records.field(0).value_or("<null>"), records.field("Name"));
    return rows;
}

class SqliteRecordSourceTest : public ::testing::Test {
  protected:
    ryx::testing::TempFolder tmp;
    std::string file = (tmp / "agencies.db").string();
    sqlite::SqliteRecordSource source{
        {.name = "DatAgMast",
         .connect = ";pwd=KLMOTulip",
         .recordSource = "select AgencyCd,Name from AgMast Where AgencyCd<>'*' order by AgencyCd"}};
};

TEST_F(SqliteRecordSourceTest, RefreshTakesTheQueryAndStandsOnItsFirstRecord) {
    // Characters that mean something in an SQLite URI name a file like any other.
    const std::string odd = (tmp / "agencies ?#%20&mode=rwc.db").string();
    runSql(odd, agencyTable({{"B2", "Beta"}, {"*", "Others"}, {"A1", "Alpha"}, {"C3", {}}}) +
                    "INSERT INTO AgMast VALUES (12, 2.5), (X'4142', 'naïve');");
    source.setDatabaseName(odd);
    source.refresh();
    RecordSet& records = source.recordset();
    EXPECT_FALSE(records.bof() || records.eof());
    EXPECT_EQ(records.field("agencycd"), "12");  // names match in any case, as in SQL
    EXPECT_EQ(readAll(records), (std::vector<AgencyRow>{{"12", "2.5"},
                                                        {"A1", "Alpha"},
                                                        {"B2", "Beta"},
                                                        {"C3", std::nullopt},
                                                        {"AB", "naïve"}}));
    EXPECT_TRUE(records.eof() && !records.bof());
    EXPECT_THROW(records.moveNext(), DataSourceError);
    EXPECT_THROW(records.field(0), DataSourceError);  // no current record
    records.moveFirst();
    EXPECT_THROW(records.field(2), DataSourceError);
    EXPECT_THROW(records.field("Branch"), DataSourceError);

    runSql(file, agencyTable({{"*", "Others"}}));
    source.setDatabaseName(file);
    source.refresh();
    EXPECT_TRUE(source.recordset().eof() && source.recordset().bof());  // empty: at both ends
}

// The faults of a database file itself are tried through the control (database_fault_test);
// these are the faults of the name.
TEST_F(SqliteRecordSourceTest, EveryFaultIsADataSourceErrorNamingTheFileAndTheReason) {
    runSql(file, agencyTable({{"A1", "Alpha"}}));
    ryx::testing::WriterLock writer(file);
    const std::string at = tmp.path().string() + "/";
    struct Case {
        std::string name, reason;
    } cases[] = {
        {at + "missing.db", "unable to open database file (No such file or directory)"},
        // As a URI this would read the locked file without taking a lock.
        {"file:" + file + "?immutable=1", "unable to open database file"},
        {std::string("agencies.db\0x", 13), "the name holds a NUL character"},
        {"", "no database name is set"},
    };
    for (const Case& c : cases) {
        source.setDatabaseName(c.name);
        try {
            source.refresh();
            ADD_FAILURE() << c.name << " read";
        } catch (const DataSourceError& e) {
            const std::string shown = c.name.substr(0, c.name.find('\0'));
            EXPECT_NE(std::string(e.what()).find(shown), std::string::npos) << e.what();
            EXPECT_NE(std::string(e.what()).find(c.reason), std::string::npos) << e.what();
        }
        EXPECT_THROW(source.recordset(), DataSourceError);  // nothing left of an earlier refresh
    }
    EXPECT_FALSE(std::filesystem::exists(at + "missing.db"));  // never created
}

TEST_F(SqliteRecordSourceTest, TheRecordsAreASnapshotAndTheFileIsNeverWrittenOrHeld) {
    runSql(file, agencyTable({{"A1", "Alpha"}, {"B2", "Beta"}}));
    const auto written = std::filesystem::last_write_time(file);
    source.setDatabaseName(file);
    source.refresh();
    EXPECT_EQ(std::filesystem::last_write_time(file), written);
    EXPECT_FALSE(std::filesystem::exists(file + "-journal"));

    // Another program can change the table at once; the records stay as they were read.
    runSql(file, "DELETE FROM AgMast WHERE AgencyCd = 'A1'; UPDATE AgMast SET Name = 'B';");
    EXPECT_EQ(readAll(source.recordset()),
              (std::vector<AgencyRow>{{"A1", "Alpha"}, {"B2", "Beta"}}));
    source.refresh();
    EXPECT_EQ(readAll(source.recordset()), (std::vector<AgencyRow>{{"B2", "B"}}));
    EXPECT_EQ(source.connect(), ";pwd=KLMOTulip");  // kept; a plain SQLite file has no password
}

}  // namespace
