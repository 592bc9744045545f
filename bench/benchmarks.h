// The benchmark pairs: each registers "<name>/subject" (the library) and "<name>/baseline"
// (the same work done plainly), and adds a row for the ratio table.
#pragma once

#include <string>
#include <vector>

#include "agency_tables.h"
#include "ratio_table.h"

namespace ryx::bench {

struct Pair {
    std::string name;  // benchmark name without the "/subject" or "/baseline" ending
    std::string what;  // the row's caption in the ratio table
    double target;
};

// 1000000 as "1,000,000".
std::string rowsText(size_t rows);

// Fill, criterion text and selection on the headless agency control.
void registerAgencyBenchmarks(const AgencyTables& tables, std::vector<Pair>& pairs);
// The Qt agency list against a QStringListModel; a no-op without Qt.
void registerQtBenchmarks(const AgencyTables& tables, std::vector<Pair>& pairs);

// Peak resident memory of one fill, in a fresh process: "agency" fills the headless control,
// "strings" copies both columns into a vector of strings. Returns bytes, or 0 on failure.
size_t measureFillMemory(const std::string& self, const AgencyTable& table, const char* how);
// The child's side: fills as told and prints the peak's growth in bytes. The exit status.
int memoryProbe(const char* how, const char* file);

}  // namespace ryx::bench
