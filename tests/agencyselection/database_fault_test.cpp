// The agency list against database files that go wrong under it: each fault reaches the host
// as a DataSourceError naming the file and the reason, the list is emptied before the failing
// read, the control goes on working without rows, and it reads the table again once the file
// is right and DatabaseName is assigned again.
#include <gtest/gtest.h>

#include <fstream>
#include <functional>
#include <memory>

#include "../sqlite/test_database.h"
#include "form_fixture.h"
#include "ryx/agency_selection.h"
#include "ryx/sqlite/sqlite_record_source.h"

using namespace ryx;
using namespace ryx::headless;
using ryx::testing::agencyTable;
using ryx::testing::runSql;
namespace fs = std::filesystem;

namespace {

const std::string kTable = agencyTable({{"B2", "Beta"}, {"A1", "Alpha"}, {"C3", "Gamma"}});

class DatabaseFaultTest : public ::testing::Test {
  protected:
    void SetUp() override {
        form.setRecordSourceFactory(ryx::sqlite::makeRecordSource);
        ag = &form.add<RYXAgencySelection>("ag", 2820, 1740);
        Site& site = form.site("ag");
        list = &site.child<HListBox>("LstAgMast");
        all = &site.child<HCheckBox>("chkAgmast", 0);
        yours = &site.child<HCheckBox>("chkAgmast", 1);
        deselect = &site.child<HCommandButton>("cmdDeselect");
    }
    // A file made elsewhere and renamed over the database, as a copy from a server arrives.
    void replaceWith(const std::string& sql) {
        const fs::path next = tmp / "next.db";
        fs::remove(next);
        runSql(next, sql);
        fs::rename(next, db);
    }
    void fill() { ag->setDatabaseName(db.string()); }
    // Assigning the database fails with the file's name and the reason, and leaves no rows.
    void expectFault(const std::string& reason) {
        try {
            fill();
            ADD_FAILURE() << "the database was read";
        } catch (const DataSourceError& e) {
            EXPECT_NE(std::string(e.what()).find(db.string()), std::string::npos) << e.what();
            EXPECT_NE(std::string(e.what()).find(reason), std::string::npos) << e.what();
        }
        EXPECT_EQ(list->listCount(), 0);
    }
    std::vector<std::string> rows() const {
        std::vector<std::string> r;
        for (int32_t i = 0; i < list->listCount(); ++i)
            r.push_back(list->list(i));
        return r;
    }

    ryx::testing::TempFolder tmp;
    fs::path db = tmp / "agencies.db";
    Form form;
    RYXAgencySelection* ag = nullptr;
    HListBox* list = nullptr;
    HCheckBox *all = nullptr, *yours = nullptr;
    HCommandButton* deselect = nullptr;
};

TEST_F(DatabaseFaultTest, EachFaultIsReportedAndTheControlReadsTheFileAgainOnceItIsRight) {
    std::unique_ptr<ryx::testing::WriterLock> writer;
    struct Fault {
        const char* what;
        const char* reason;
        std::function<void()> breakFile;
    } faults[] = {
        {"missing file", "No such file or directory", [&] { fs::remove(db); }},
        {"text file named like a database", "file is not a database",
         [&] { std::ofstream(db, std::ios::trunc) << "Agencies\n"
                                                  << std::string(600, '-'); }},
        {"empty file", "no such table: AgMast", [&] { std::ofstream(db, std::ios::trunc); }},
        {"no AgMast table", "no such table: AgMast",
         [&] { replaceWith("CREATE TABLE Branches (Code TEXT, Name TEXT);"); }},
        {"AgMast without Name", "no such column: Name",
         [&] { replaceWith("CREATE TABLE AgMast (AgencyCd TEXT, AgencyName TEXT);"); }},
        {"another program writing", "database is locked",
         [&] { writer = std::make_unique<ryx::testing::WriterLock>(db); }},
    };
    for (const Fault& fault : faults) {
        SCOPED_TRACE(fault.what);
        replaceWith(kTable);
        fill();
        form.clickRow(*list, 1);
        form.clickRow(*list, 3);
        EXPECT_EQ(ag->ReturnedText(), R"(["A1","C3"])");

        fault.breakFile();
        expectFault(fault.reason);
        expectFault(fault.reason);  // and again, from an empty list

        // Without rows the boxes still work; a pick has no table to name its codes from.
        form.click(*all);
        EXPECT_EQ(ag->ReturnedText(), "+");
        form.click(*yours);
        EXPECT_EQ(ag->ReturnedText(), "-");
        form.click(*deselect);
        EXPECT_EQ(all->value() + yours->value(), 0);
        EXPECT_THROW(ag->ReturnedText(), DataSourceError);

        writer.reset();
        replaceWith(kTable);
        fill();
        EXPECT_EQ(rows(),
                  (std::vector<std::string>{"*   Others", "A1  Alpha", "B2  Beta", "C3  Gamma"}));
        form.clickRow(*list, 2);
        EXPECT_EQ(ag->ReturnedText(), R"(["B2"])");
    }
}

TEST_F(DatabaseFaultTest, AFileDeletedAfterTheFillKeepsTheRowsAndTheirCodesUntilTheNextRead) {
    replaceWith(kTable);
    fill();
    form.clickRow(*list, 0);
    form.clickRow(*list, 2);
    fs::remove(db);
    // What the list shows was read whole: its codes come from that reading, not from the file.
    EXPECT_EQ(rows().size(), 4u);
    EXPECT_EQ(ag->ReturnedText(), R"(["*","B2"])");
    ag->setCrystalStyle(false);
    EXPECT_EQ(ag->ReturnedText(), "*B2");

    expectFault("No such file or directory");
    EXPECT_FALSE(fs::exists(db));  // never created by the attempt
    replaceWith(kTable);
    fill();
    EXPECT_EQ(rows().size(), 4u);
}

TEST_F(DatabaseFaultTest, AFileReplacedBetweenTwoFillsNeverMixesTheTwoTables) {
    replaceWith(kTable);
    fill();
    form.clickRow(*list, 2);  // B2

    // Replaced by a table with other codes: the rows shown and the codes returned stay those
    // of the first reading until the list is filled again.
    replaceWith(agencyTable({{"Z9", "Zeta"}, {"A0", "Aleph"}}));
    EXPECT_EQ(list->list(2), "B2  Beta");
    EXPECT_EQ(ag->ReturnedText(), R"(["B2"])");
    form.clickRow(*list, 3);
    EXPECT_EQ(ag->ReturnedText(), R"(["B2","C3"])");

    fill();
    EXPECT_EQ(rows(), (std::vector<std::string>{"*   Others", "A0  Aleph", "Z9  Zeta"}));
    EXPECT_EQ(list->selCount(), 0);  // the old picks went with the old rows
    form.clickRow(*list, 2);
    EXPECT_EQ(ag->ReturnedText(), R"(["Z9"])");

    // Replaced by something that is no database at all: reported like any other fault.
    fs::remove(db);
    std::ofstream(db) << "not a database";
    expectFault("file is not a database");
}

}  // namespace
