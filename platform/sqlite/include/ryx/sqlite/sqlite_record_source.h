// The agency table's record source over an SQLite database file.
//
// The file named by the database name is opened read-only and is never created: a wrong name
// is an error, not a new empty database. A refresh runs the record source query once and keeps
// its rows in memory, so the record set is a snapshot of the table as it was at the refresh,
// whatever changes in the file afterwards, and no lock on the file is held between refreshes.
//
// The connect text (";pwd=..." in the agency control's design) is kept as given: a plain SQLite
// file has no password, so the password part is not used.
#pragma once

#include <memory>
#include <string>
#include <string_view>

#include "ryx/host.h"

namespace ryx::sqlite {

class SnapshotRecordSet;

class SqliteRecordSource : public RecordSource {
  public:
    explicit SqliteRecordSource(const DataSourceDesign& design);
    ~SqliteRecordSource() override;
    SqliteRecordSource(const SqliteRecordSource&) = delete;
    SqliteRecordSource& operator=(const SqliteRecordSource&) = delete;

    void setDatabaseName(std::string_view name) override { database_ = name; }
    std::string databaseName() const override { return database_; }
    std::string recordSource() const override { return query_; }
    // Opens the file, runs the query and takes the snapshot, positioned on its first record.
    // DataSourceError naming the file and SQLite's reason when the file cannot be opened or
    // read (missing, not a database, no such table or column, locked by a writer). A failed
    // refresh leaves no record set open.
    void refresh() override;
    // The snapshot of the last refresh; DataSourceError when none is open.
    RecordSet& recordset() override;

    const std::string& name() const { return name_; }
    const std::string& connect() const { return connect_; }

  private:
    std::string name_, connect_, query_, database_;
    std::unique_ptr<SnapshotRecordSet> records_;
};

// Creates the record sources of a form's controls over SQLite files; suitable for
// Form::setRecordSourceFactory.
std::unique_ptr<RecordSource> makeRecordSource(const DataSourceDesign& design);

}  // namespace ryx::sqlite
