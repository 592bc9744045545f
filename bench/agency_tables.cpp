#include "agency_tables.h"

#include <sqlite3.h>
#include <unistd.h>

#include <array>
#include <random>
#include <stdexcept>
#include <string_view>

namespace ryx::bench {
namespace {

constexpr std::array<std::string_view, 24> kSurnames = {
    "Sharma", "Patel",    "Mehta",     "Iyer",      "Nair",   "Kapoor",   "Desai",      "Banerjee",
    "Reddy",  "Joshi",    "Fernandes", "Khan",      "Singh",  "Menon",    "Chatterjee", "Rao",
    "Harris", "Whitaker", "Okafor",    "Lindqvist", "Murphy", "Thompson", "Gallagher",  "Brooks"};
constexpr std::array<std::string_view, 12> kFirstNames = {"Priya", "Arjun",  "Lakshmi", "Rahul",
                                                          "Anita", "Vikram", "Sarah",   "James",
                                                          "Meera", "Thomas", "Kavita",  "David"};
constexpr std::array<std::string_view, 12> kPlaces = {
    "Harbour View", "Northgate", "Riverside", "Hillcrest",  "Lakeside", "Eastfield",
    "Coastal",      "Metro",     "Westbrook", "Greenfield", "Sunrise",  "Kingsway"};
constexpr std::array<std::string_view, 6> kTrades = {
    "Insurance Agency",   "Insurance Consultants", "Insurance Brokers Ltd",
    "Financial Services", "Assurance Associates",  "Risk Advisers"};

// An agency name as an office would register it: "A. K. Sharma Insurance Agency",
// "Mehta & Sons Insurance Brokers Ltd", "Harbour View Financial Services".
std::string agencyName(std::mt19937_64& random) {
    auto pick = [&random](const auto& words) {
        return std::string(words[random() % words.size()]);
    };
    std::string name;
    switch (random() % 4) {
        case 0:
            name = std::string(1, static_cast<char>('A' + random() % 26)) + ". " +
                   static_cast<char>('A' + random() % 26) + ". " + pick(kSurnames);
            break;
        case 1:
            name = pick(kSurnames) + " & Sons";
            break;
        case 2:
            name = pick(kPlaces);
            break;
        default:
            name = pick(kFirstNames) + " " + pick(kSurnames);
            break;
    }
    return name + " " + pick(kTrades);
}

// A random code of six letters and digits, as agencies are numbered by head office.
std::string agencyCode(std::mt19937_64& random) {
    static constexpr std::string_view kChars = "ABCDEFGHIJKLMNOPQRSTUVWXYZ0123456789";
    std::string code(6, ' ');
    for (char& c : code)
        c = kChars[random() % kChars.size()];
    return code;
}

void check(int result, sqlite3* db, const char* doing) {
    if (result != SQLITE_OK && result != SQLITE_DONE && result != SQLITE_ROW)
        throw std::runtime_error(std::string(doing) + ": " + sqlite3_errmsg(db));
}

void exec(sqlite3* db, const std::string& sql) {
    check(sqlite3_exec(db, sql.c_str(), nullptr, nullptr, nullptr), db, sql.c_str());
}

// Writes the table and returns the raw bytes of its codes and names.
size_t makeTable(const std::filesystem::path& file, size_t rows, bool covering) {
    sqlite3* db = nullptr;
    check(sqlite3_open(file.c_str(), &db), db, "open");
    exec(db, "PRAGMA journal_mode=OFF; PRAGMA synchronous=OFF; BEGIN");
    exec(db, "CREATE TABLE AgMast (AgencyCd TEXT, Name TEXT)");
    sqlite3_stmt* insert = nullptr;
    check(sqlite3_prepare_v2(db, "INSERT INTO AgMast VALUES (?, ?)", -1, &insert, nullptr), db,
          "prepare");
    std::mt19937_64 random(rows);  // the same rows in both layouts, and in every run
    size_t raw = 0;
    for (size_t i = 0; i < rows; ++i) {
        const std::string code = agencyCode(random), name = agencyName(random);
        raw += code.size() + name.size();
        sqlite3_bind_text(insert, 1, code.data(), static_cast<int>(code.size()), SQLITE_STATIC);
        sqlite3_bind_text(insert, 2, name.data(), static_cast<int>(name.size()), SQLITE_STATIC);
        check(sqlite3_step(insert), db, "insert");
        sqlite3_reset(insert);
    }
    sqlite3_finalize(insert);
    if (covering) exec(db, "CREATE INDEX AgMastCodeName ON AgMast (AgencyCd, Name)");
    exec(db, "COMMIT");
    sqlite3_close(db);
    return raw;
}

}  // namespace

AgencyTables::AgencyTables(const std::vector<size_t>& sizes) {
    folder_ = std::filesystem::temp_directory_path() / ("ryx-bench-" + std::to_string(::getpid()));
    std::filesystem::remove_all(folder_);
    std::filesystem::create_directories(folder_);
    for (size_t rows : sizes) {
        for (bool covering : {false, true}) {
            AgencyTable t{rows, covering,
                          folder_ / ("agencies-" + std::to_string(rows) +
                                     (covering ? "-covering" : "") + ".db")};
            t.rawBytes = makeTable(t.file, rows, covering);
            tables_.push_back(t);
        }
    }
}

AgencyTables::~AgencyTables() {
    std::error_code ignored;
    std::filesystem::remove_all(folder_, ignored);
}

const AgencyTable& AgencyTables::get(size_t rows, bool covering) const {
    for (const AgencyTable& t : tables_)
        if (t.rows == rows && t.covering == covering) return t;
    throw std::out_of_range("no agency table of " + std::to_string(rows) + " rows");
}

std::vector<std::string> readCodes(const std::filesystem::path& file) {
    sqlite3* db = nullptr;
    check(sqlite3_open_v2(file.c_str(), &db, SQLITE_OPEN_READONLY, nullptr), db, "open");
    sqlite3_stmt* query = nullptr;
    check(sqlite3_prepare_v2(db, kAgencyQuery, -1, &query, nullptr), db, "prepare");
    std::vector<std::string> codes;
    while (sqlite3_step(query) == SQLITE_ROW)
        codes.emplace_back(reinterpret_cast<const char*>(sqlite3_column_text(query, 0)),
                           static_cast<size_t>(sqlite3_column_bytes(query, 0)));
    sqlite3_finalize(query);
    sqlite3_close(db);
    return codes;
}

}  // namespace ryx::bench
