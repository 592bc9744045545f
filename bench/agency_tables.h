// The agency databases the benchmarks read: SQLite files made once per run in a temporary
// folder, with random codes and realistic names, in two layouts: the plain table, and the
// same table with a covering index on (AgencyCd, Name) that SQLite uses for the control's query.
#pragma once

#include <cstddef>
#include <filesystem>
#include <string>
#include <vector>

namespace ryx::bench {

// The query the agency control runs.
inline constexpr const char* kAgencyQuery =
    "select AgencyCd,Name from AgMast Where AgencyCd<>'*' order by AgencyCd";

struct AgencyTable {
    size_t rows = 0;
    bool covering = false;  // with the index on (AgencyCd, Name)
    std::filesystem::path file;
    size_t rawBytes = 0;  // the bytes of every code and name, nothing else
};

class AgencyTables {
  public:
    // Makes a table of each size, in both layouts, under a new temporary folder.
    explicit AgencyTables(const std::vector<size_t>& sizes);
    ~AgencyTables();
    AgencyTables(const AgencyTables&) = delete;
    AgencyTables& operator=(const AgencyTables&) = delete;

    const AgencyTable& get(size_t rows, bool covering) const;
    const std::vector<AgencyTable>& all() const { return tables_; }

  private:
    std::filesystem::path folder_;
    std::vector<AgencyTable> tables_;
};

// The rows of a table in the query's order, through the plain SQLite C API.
std::vector<std::string> readCodes(const std::filesystem::path& file);

}  // namespace ryx::bench
