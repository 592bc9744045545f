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

// SQL that creates the agency table with the given rows, in the given order.
inline std::string agencyTable(const std::vector<AgencyRow>& rows) {
    auto quoted = [](const std::string& s) {
        std::string q = "'";
        for (char c : s)
            q += c == '\'' ? std::string("''") : std::string(1, c);
        return q + "'";
    };
    std::string sql = "CREATE TABLE AgMast (AgencyCd TEXT, Name TEXT);\n";
    for (const auto& [code, name] : rows)
        sql += "INSERT INTO AgMast VALUES (" + quoted(code) + ", " +
               (name ? quoted(*name) : "NULL") + ");\n";
    return sql;
}

// Runs SQL on a database file, creating the file when it is missing.
inline void runSql(const std::filesystem::path& file, const std::string& sql) {
    sqlite3* db = nullptr;
    sqlite3_open(file.c_str(), &db);
    char* error = nullptr;
    EXPECT_EQ(sqlite3_exec(db, sql.c_str(), nullptr, nullptr, &error), SQLITE_OK) << error;
    sqlite3_free(error);
    sqlite3_close(db);
}

// Runs SQL through the sqlite3 command-line program; false when the program is not installed.
inline bool runSqliteProgram(const std::filesystem::path& file, const std::string& sql) {
    if (std::system("command -v sqlite3 >/dev/null 2>&1") != 0) return false;
    FILE* pipe = popen(("sqlite3 -bail '" + file.string() + "'").c_str(), "w");
    std::fputs(sql.c_str(), pipe);
    EXPECT_EQ(pclose(pipe), 0) << "sqlite3 failed on " << file;
    return true;
}

// Another program in the middle of a write: it holds the exclusive lock, so no one can read.
struct WriterLock {
    explicit WriterLock(const std::filesystem::path& file) {
        sqlite3_open(file.c_str(), &db);
        EXPECT_EQ(sqlite3_exec(db, "BEGIN EXCLUSIVE", nullptr, nullptr, nullptr), SQLITE_OK);
    }
    ~WriterLock() { sqlite3_close(db); }
    sqlite3* db = nullptr;
};

}  // namespace ryx::testing
