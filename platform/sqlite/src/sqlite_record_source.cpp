#include "ryx/sqlite/sqlite_record_source.h"

#include <sqlite3.h>

#include <cstring>

#include "ryx/errors.h"
#include "snapshot_record_set.h"

namespace ryx::sqlite {
namespace {

// How long a refresh waits for another program's write to end before it reports the file
// as locked. Long enough for an ordinary commit, short enough not to freeze the form.
constexpr int kBusyWaitMs = 250;

struct CloseDatabase {
    void operator()(sqlite3* db) const { sqlite3_close_v2(db); }
};
struct FinalizeStatement {
    void operator()(sqlite3_stmt* st) const { sqlite3_finalize(st); }
};
using Database = std::unique_ptr<sqlite3, CloseDatabase>;
using Statement = std::unique_ptr<sqlite3_stmt, FinalizeStatement>;

// The file name as an SQLite URI that means that file and nothing else. Passed as it stands,
// a name beginning with "file:" could carry parameters when URIs are enabled in the process
// ("immutable=1" reads without taking any lock, "vfs=" changes the file layer); encoded, every
// character is part of the path.
std::string fileUri(std::string_view path) {
    static constexpr char kHex[] = "0123456789ABCDEF";
    std::string uri = path.starts_with('/') ? "file://" : "file:";
    for (unsigned char c : path) {
        const bool plain =
            (c >= 'A' && c <= 'Z') || (c >= 'a' && c <= 'z') || (c >= '0' && c <= '9') ||
            std::string_view("-._~/").find(static_cast<char>(c)) != std::string_view::npos;
        if (plain) {
            uri += static_cast<char>(c);
        } else {
            uri += '%';
            uri += kHex[c >> 4];
            uri += kHex[c & 15];
        }
    }
    return uri + "?mode=ro";
}

[[noreturn]] void fail(const std::string& file, std::string_view doing, sqlite3* db) {
    std::string reason = db ? sqlite3_errmsg(db) : "out of memory";
    if (db) {
        if (int err = sqlite3_system_errno(db); err != 0 && sqlite3_errcode(db) == SQLITE_CANTOPEN)
            reason += std::string(" (") + std::strerror(err) + ")";
    }
    throw DataSourceError("cannot " + std::string(doing) + " the agency database \"" + file +
                          "\": " + reason);
}

}  // namespace

SqliteRecordSource::SqliteRecordSource(const DataSourceDesign& design)
    : name_(design.name), connect_(design.connect), query_(design.recordSource) {}

SqliteRecordSource::~SqliteRecordSource() = default;

void SqliteRecordSource::refresh() {
    records_.reset();
    if (database_.empty())
        throw DataSourceError("cannot open the agency database: no database name is set");
    if (const size_t nul = database_.find('\0'); nul != std::string::npos)
        throw DataSourceError("cannot open the agency database \"" + database_.substr(0, nul) +
                              "\\0...\": the name holds a NUL character");

    sqlite3* raw = nullptr;
    const int opened = sqlite3_open_v2(
        fileUri(database_).c_str(), &raw,
        SQLITE_OPEN_READONLY | SQLITE_OPEN_URI | SQLITE_OPEN_NOMUTEX,  // used by this call alone
        nullptr);
    Database db(raw);
    if (opened != SQLITE_OK) fail(database_, "open", db.get());
    sqlite3_busy_timeout(db.get(), kBusyWaitMs);

    sqlite3_stmt* rawStatement = nullptr;
    if (sqlite3_prepare_v2(db.get(), query_.c_str(), static_cast<int>(query_.size()), &rawStatement,
                           nullptr) != SQLITE_OK)
        fail(database_, "read", db.get());
    Statement statement(rawStatement);
    if (!statement) fail(database_, "read", db.get());  // a query of blanks or comments only

    const int columns = sqlite3_column_count(statement.get());
    std::vector<std::string> names;
    for (int c = 0; c < columns; ++c)
        names.emplace_back(sqlite3_column_name(statement.get(), c));
    auto records = std::make_unique<SnapshotRecordSet>(std::move(names), database_);

    int step;
    while ((step = sqlite3_step(statement.get())) == SQLITE_ROW) {
        for (int c = 0; c < columns; ++c) {
            if (sqlite3_column_type(statement.get(), c) == SQLITE_NULL) {
                records->appendNull();
                continue;
            }
            // Numbers come in SQLite's own text form; text and blobs as their bytes.
            const auto* text =
                reinterpret_cast<const char*>(sqlite3_column_text(statement.get(), c));
            if (!text) fail(database_, "read", db.get());
            records->append({text, static_cast<size_t>(sqlite3_column_bytes(statement.get(), c))});
        }
    }
    if (step != SQLITE_DONE) fail(database_, "read", db.get());
    records_ = std::move(records);
}

RecordSet& SqliteRecordSource::recordset() {
    if (!records_) {
        if (database_.empty())
            throw DataSourceError("no agency records are open: no database name is set");
        throw DataSourceError("no agency records are open: the agency database \"" + database_ +
                              "\" has not been read");
    }
    return *records_;
}

std::unique_ptr<RecordSource> makeRecordSource(const DataSourceDesign& design) {
    return std::make_unique<SqliteRecordSource>(design);
}

}  // namespace ryx::sqlite
