#include "ryx/sqlite/sqlite_record_source.h"

#include <gtest/gtest.h>

#include <fstream>

#include "form_fixture.h"
#include "ryx/errors.h"
#include "test_database.h"

using namespace ryx;
using ryx::sqlite::SqliteRecordSource;
using ryx::testing::AgencyRow;
using ryx::testing::agencyTable;
using ryx::testing::runSql;

namespace {

constexpr DataSourceDesign kAgencies{
    .name = "DatAgMast",
    .connect = ";pwd=KLMOTulip",
    .recordSource = "select AgencyCd,Name from AgMast Where AgencyCd<>'*' order by AgencyCd"};

// Every record of the set from its first, as code and name.
std::vector<AgencyRow> readAll(RecordSet& records) {
    std::vector<AgencyRow> rows;
    for (records.moveFirst(); !records.eof(); records.moveNext())
        rows.emplace_back(records.field(0).value_or("<null>"), records.field("Name"));
    return rows;
}

std::string errorOf(SqliteRecordSource& source) {
    try {
        source.refresh();
    } catch (const DataSourceError& e) {
        return e.what();
    }
    return "no error";
}

class SqliteRecordSourceTest : public ::testing::Test {
  protected:
    ryx::testing::TempFolder tmp;
    std::string file = (tmp / "agencies.db").string();
    SqliteRecordSource source{kAgencies};
};

TEST_F(SqliteRecordSourceTest, RefreshReadsTheQueryAndStandsOnTheFirstRecord) {
    runSql(file, agencyTable({{"B2", "Beta"}, {"*", "Others"}, {"A1", "Alpha"}, {"C3", {}}}));
    source.setDatabaseName(file);
    EXPECT_EQ(source.databaseName(), file);
    EXPECT_EQ(source.connect(), ";pwd=KLMOTulip");  // kept; a plain SQLite file has no password
    source.refresh();

    RecordSet& records = source.recordset();
    EXPECT_FALSE(records.bof());
    EXPECT_FALSE(records.eof());
    EXPECT_EQ(records.field("AgencyCd"), "A1");
    EXPECT_EQ(records.field("agencycd"), "A1");  // names match in any case, as in SQL
    EXPECT_EQ(records.field(1), "Alpha");
    records.moveNext();
    records.moveNext();
    EXPECT_EQ(records.field(0), "C3");
    EXPECT_EQ(records.field("Name"), std::nullopt);
    records.moveNext();
    EXPECT_TRUE(records.eof());
    EXPECT_FALSE(records.bof());
    EXPECT_THROW(records.moveNext(), DataSourceError);
    EXPECT_THROW(records.field(0), DataSourceError);  // no current record
    EXPECT_EQ(readAll(records),
              (std::vector<AgencyRow>{{"A1", "Alpha"}, {"B2", "Beta"}, {"C3", std::nullopt}}));

    records.moveFirst();
    EXPECT_THROW(records.field(2), DataSourceError);
    EXPECT_THROW(records.field(-1), DataSourceError);
    EXPECT_THROW(records.field("Branch"), DataSourceError);
}

TEST_F(SqliteRecordSourceTest, ValuesOfOtherKindsComeAsText) {
    runSql(file,
           "CREATE TABLE AgMast (AgencyCd, Name);"
           "INSERT INTO AgMast VALUES (12, 2.5), (X'4142', 'naïve'), ('', '');");
    source.setDatabaseName(file);
    source.refresh();
    EXPECT_EQ(readAll(source.recordset()),
              (std::vector<AgencyRow>{{"12", "2.5"}, {"", ""}, {"AB", "naïve"}}));  // SQL's order
}

TEST_F(SqliteRecordSourceTest, AnEmptyTableIsAtBothEnds) {
    runSql(file, agencyTable({{"*", "Others"}}));
    source.setDatabaseName(file);
    source.refresh();
    EXPECT_TRUE(source.recordset().eof());
    EXPECT_TRUE(source.recordset().bof());
}

TEST_F(SqliteRecordSourceTest, EveryFaultIsADataSourceErrorNamingTheFileAndTheReason) {
    const std::string missing = (tmp / "missing.db").string();
    const std::string text = (tmp / "notes.db").string();
    std::ofstream(text) << "Agency list, to be typed in later.\n" << std::string(200, 'x') << "\n";
    const std::string noTable = (tmp / "empty.db").string();
    runSql(noTable, "CREATE TABLE Branches (Code TEXT)");
    const std::string noName = (tmp / "codes.db").string();
    runSql(noName, "CREATE TABLE AgMast (AgencyCd TEXT)");
    runSql(file, agencyTable({{"A1", "Alpha"}}));

    struct Case {
        std::string name;
        std::string reason;
    } cases[] = {
        {missing, "unable to open database file (No such file or directory)"},
        {text, "file is not a database"},
        {noTable, "no such table: AgMast"},
        {noName, "no such column: Name"},
    };
    for (const Case& c : cases) {
        SCOPED_TRACE(c.name);
        source.setDatabaseName(file);
        source.refresh();
        source.setDatabaseName(c.name);
        const std::string message = errorOf(source);
        EXPECT_NE(message.find("\"" + c.name + "\""), std::string::npos) << message;
        EXPECT_NE(message.find(c.reason), std::string::npos) << message;
        // A failed refresh leaves no records of an earlier one behind.
        EXPECT_THROW(source.recordset(), DataSourceError);
    }
    EXPECT_FALSE(std::filesystem::exists(missing));  // never created

    {
        ryx::testing::WriterLock writer(file);
        source.setDatabaseName(file);
        const std::string message = errorOf(source);
        EXPECT_NE(message.find("\"" + file + "\": database is locked"), std::string::npos)
            << message;
    }

    source.setDatabaseName("");
    EXPECT_NE(errorOf(source).find("no database name is set"), std::string::npos);
    EXPECT_THROW(SqliteRecordSource(kAgencies).recordset(), DataSourceError);  // never read
}

TEST_F(SqliteRecordSourceTest, TheNameIsAFileNameNeverAnSqliteUri) {
    // Characters that mean something in a URI name a file like any other.
    const std::string odd = (tmp / "agencies ?#%20&mode=rwc.db").string();
    runSql(odd, agencyTable({{"A1", "Alpha"}}));
    source.setDatabaseName(odd);
    source.refresh();
    EXPECT_EQ(source.recordset().field(0), "A1");

    // As a URI this would read the file without taking a lock, while a writer has it; as a
    // file name it names no file. Either way nothing is read.
    runSql(file, agencyTable({{"A1", "Alpha"}}));
    ryx::testing::WriterLock writer(file);
    source.setDatabaseName("file:" + file + "?immutable=1");
    EXPECT_THROW(source.refresh(), DataSourceError);
    source.setDatabaseName(std::string("agencies.db\0x", 13));
    EXPECT_NE(errorOf(source).find(R"("agencies.db\0...": the name holds a NUL character)"),
              std::string::npos);
}

TEST_F(SqliteRecordSourceTest, TheRecordsAreASnapshotAndHoldNoLock) {
    runSql(file, agencyTable({{"A1", "Alpha"}, {"B2", "Beta"}}));
    source.setDatabaseName(file);
    source.refresh();
    source.recordset().moveNext();

    // Another program changes the table: it can write at once, and the records stay as read.
    runSql(file,
           "DELETE FROM AgMast WHERE AgencyCd = 'A1'; UPDATE AgMast SET Name = 'B';"
           "INSERT INTO AgMast VALUES ('A0', 'Zero');");
    EXPECT_EQ(source.recordset().field(0), "B2");
    EXPECT_EQ(readAll(source.recordset()),
              (std::vector<AgencyRow>{{"A1", "Alpha"}, {"B2", "Beta"}}));

    source.refresh();
    EXPECT_EQ(readAll(source.recordset()), (std::vector<AgencyRow>{{"A0", "Zero"}, {"B2", "B"}}));
}

TEST_F(SqliteRecordSourceTest, RefreshNeverWritesToTheFile) {
    runSql(file, agencyTable({{"A1", "Alpha"}}));
    const auto size = std::filesystem::file_size(file);
    const auto time = std::filesystem::last_write_time(file);
    source.setDatabaseName(file);
    source.refresh();
    source.refresh();
    EXPECT_EQ(std::filesystem::file_size(file), size);
    EXPECT_EQ(std::filesystem::last_write_time(file), time);
    EXPECT_FALSE(std::filesystem::exists(file + "-journal"));
    EXPECT_FALSE(std::filesystem::exists(file + "-wal"));
}

}  // namespace
