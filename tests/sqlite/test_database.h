// Agency databases for the tests: real SQLite files in a test's temporary folder, made with
// SQLite itself or with the sqlite3 command-line program.
#pragma once

#include <gtest/gtest.h>
#include <sqlite3.h>

#include <cstdio>
#include <cstdlib>
#include <filesystem>
#include <optional>
#include <string>
#include <utility>
#include <vector>

namespace ryx::testing {

using AgencyRow = std::pair<std::string, std::optional<std::string>>;  // code, name (or null)

inline std::string sqlText(const std::string& s) {
    std::string quoted = "'";
    for (char c : s) {
        if (c == '\'') quoted += '\'';
        quoted += c;
    }
    return quoted + "'";
}

// SQL that creates the agency table with the given rows, in the given order.
inline std::string agencyTable(const std::vector<AgencyRow>& rows) {
    std::string sql = "CREATE TABLE AgMast (AgencyCd TEXT, Name TEXT);\n";
    for (const auto& [code, name] : rows)
        sql += "INSERT INTO AgMast VALUES (" + sqlText(code) + ", " +
               (name ? sqlText(*name) : "NULL") + ");\n";
    return sql;
}

// Runs SQL on a database file, creating the file when it is missing.
inline void runSql(const std::filesystem::path& file, const std::string& sql) {
    sqlite3* db = nullptr;
    ASSERT_EQ(sqlite3_open(file.c_str(), &db), SQLITE_OK);
    char* error = nullptr;
    const int rc = sqlite3_exec(db, sql.c_str(), nullptr, nullptr, &error);
    const std::string message = error ? error : "";
    sqlite3_free(error);
    sqlite3_close(db);
    ASSERT_EQ(rc, SQLITE_OK) << message;
}

// Runs SQL through the sqlite3 command-line program; false when the program is not installed.
inline bool runSqliteProgram(const std::filesystem::path& file, const std::string& sql) {
    if (std::system("command -v sqlite3 >/dev/null 2>&1") != 0) return false;
    const std::string command = "sqlite3 -bail '" + file.string() + "'";
    FILE* pipe = popen(command.c_str(), "w");
    if (!pipe) return false;
    std::fputs(sql.c_str(), pipe);
    EXPECT_EQ(pclose(pipe), 0) << "sqlite3 failed on " << file;
    return true;
}

// Another program writing to the database: holds the exclusive lock of a write for its life,
// so that no one can read the file meanwhile.
class WriterLock {
  public:
    explicit WriterLock(const std::filesystem::path& file) {
        EXPECT_EQ(sqlite3_open(file.c_str(), &db_), SQLITE_OK);
        EXPECT_EQ(sqlite3_exec(db_, "BEGIN EXCLUSIVE", nullptr, nullptr, nullptr), SQLITE_OK);
    }
    ~WriterLock() {
        sqlite3_exec(db_, "ROLLBACK", nullptr, nullptr, nullptr);
        sqlite3_close(db_);
    }
    WriterLock(const WriterLock&) = delete;
    WriterLock& operator=(const WriterLock&) = delete;

  private:
    sqlite3* db_ = nullptr;
};

}  // namespace ryx::testing
