// The agency data source of a host that has set up no database engine: it keeps the name it is
// given, and every attempt to read fails with an error that says so.
#pragma once

#include <string>

#include "ryx/host.h"

namespace ryx::common {

class MissingRecordSource : public RecordSource {
  public:
    explicit MissingRecordSource(const DataSourceDesign& d) : query_(d.recordSource) {}
    void setDatabaseName(std::string_view name) override { name_ = name; }
    std::string databaseName() const override { return name_; }
    std::string recordSource() const override { return query_; }
    void refresh() override { fail(); }
    RecordSet& recordset() override { fail(); }

  private:
    [[noreturn]] void fail() const;
    std::string name_, query_;
};

}  // namespace ryx::common
