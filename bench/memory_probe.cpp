// Peak resident memory of one fill, measured by a fresh process on itself: the resident size
// before the fill, then the high-water mark after it.
#include <sqlite3.h>

#include <cstdio>
#include <cstring>
#include <fstream>
#include <string>

#include "benchmarks.h"
#include "ryx/agency_selection.h"
#include "ryx/headless/form.h"
#include "ryx/sqlite/sqlite_record_source.h"

namespace ryx::bench {
namespace {

// A "Vm...:" line of /proc/self/status, in bytes.
size_t statusBytes(const char* key) {
    std::ifstream status("/proc/self/status");
    std::string line;
    const size_t keyLength = std::strlen(key);
    while (std::getline(status, line))
        if (line.compare(0, keyLength, key) == 0) return std::stoull(line.substr(keyLength)) * 1024;
    return 0;
}

// Lowers the high-water mark to the present resident size, where the kernel allows it.
void resetPeak() {
    std::ofstream clear("/proc/self/clear_refs");
    clear << "5";
}

void fillAgency(const char* file) {
    headless::Form form;
    form.setRecordSourceFactory(sqlite::makeRecordSource);
    auto& control = form.add<RYXAgencySelection>("ag", 2820, 1740);
    const size_t before = statusBytes("VmRSS:");
    resetPeak();
    control.setDatabaseName(file);
    std::printf("%zu\n", statusBytes("VmHWM:") - before);
}

void fillStrings(const char* file) {
    const size_t before = statusBytes("VmRSS:");
    resetPeak();
    std::vector<std::string> values;
    sqlite3* db = nullptr;
    sqlite3_open_v2(file, &db, SQLITE_OPEN_READONLY, nullptr);
    sqlite3_stmt* query = nullptr;
    sqlite3_prepare_v2(db, kAgencyQuery, -1, &query, nullptr);
    while (sqlite3_step(query) == SQLITE_ROW)
        for (int column = 0; column < 2; ++column)
            values.emplace_back(reinterpret_cast<const char*>(sqlite3_column_text(query, column)),
                                static_cast<size_t>(sqlite3_column_bytes(query, column)));
    sqlite3_finalize(query);
    sqlite3_close(db);
    std::printf("%zu\n", statusBytes("VmHWM:") - before);
}

}  // namespace

int memoryProbe(const char* how, const char* file) {
    if (std::strcmp(how, "agency") == 0)
        fillAgency(file);
    else if (std::strcmp(how, "strings") == 0)
        fillStrings(file);
    else
        return 2;
    return 0;
}

size_t measureFillMemory(const std::string& self, const AgencyTable& table, const char* how) {
    const std::string command =
        "'" + self + "' --memory-probe " + how + " '" + table.file.string() + "'";
    FILE* child = popen(command.c_str(), "r");
    if (!child) return 0;
    size_t bytes = 0;
    if (std::fscanf(child, "%zu", &bytes) != 1) bytes = 0;
    return pclose(child) == 0 ? bytes : 0;
}

}  // namespace ryx::bench
