// Builds an SQLite database file from an SQL script:
//   ryx-build-database <script.sql> <database.db>
// The database is written under a temporary name and renamed into place when the whole
// script has run, so a failed build never leaves a half-made file behind.
#include <sqlite3.h>

#include <cstdio>
#include <filesystem>
#include <fstream>
#include <iostream>
#include <sstream>
#include <string>

int main(int argc, char** argv) {
    if (argc != 3) {
        std::cerr << "usage: ryx-build-database <script.sql> <database.db>\n";
        return 2;
    }
    const std::filesystem::path script = argv[1], target = argv[2];
    std::ifstream in(script);
    if (!in) {
        std::cerr << "cannot read " << script << "\n";
        return 1;
    }
    std::stringstream sql;
    sql << in.rdbuf();

    std::filesystem::path temp = target;
    temp += ".tmp";
    std::filesystem::remove(temp);
    sqlite3* db = nullptr;
    int rc =
        sqlite3_open_v2(temp.c_str(), &db, SQLITE_OPEN_READWRITE | SQLITE_OPEN_CREATE, nullptr);
    char* error = nullptr;
    if (rc == SQLITE_OK) rc = sqlite3_exec(db, sql.str().c_str(), nullptr, nullptr, &error);
    if (rc != SQLITE_OK) {
        std::cerr << script.string() << ": " << (error ? error : sqlite3_errmsg(db)) << "\n";
        sqlite3_free(error);
        sqlite3_close(db);
        std::filesystem::remove(temp);
        return 1;
    }
    sqlite3_close(db);
    std::filesystem::rename(temp, target);
    return 0;
}
