// The rows of one query kept in memory, with a cursor over them.
//
// The values of all records lie end to end in one text, record by record, with the end of
// each value and a null mark beside it: a million agencies take a few allocations, not a few
// million.
#pragma once

#include <cstddef>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include "ryx/host.h"

namespace ryx::sqlite {

class SnapshotRecordSet : public RecordSet {
  public:
    // `origin` names where the rows came from, for error messages.
    SnapshotRecordSet(std::vector<std::string> columns, std::string origin);

    // Appends the next value of the record being built, in column order.
    void append(std::string_view text);
    void appendNull();
    size_t recordCount() const { return records_; }

    bool eof() const override { return position_ >= records_; }
    bool bof() const override { return records_ == 0; }
    void moveFirst() override { position_ = 0; }
    void moveNext() override;
    // Names match without regard to letter case, as the database's own column names do.
    std::optional<std::string> field(std::string_view name) const override;
    std::optional<std::string> field(int position) const override;

  private:
    void valueAdded() {
        if (++column_ == columns_.size()) {
            column_ = 0;
            ++records_;
        }
    }
    [[noreturn]] void fail(const std::string& what) const;

    std::vector<std::string> columns_;
    std::string origin_;
    std::string text_;
    std::vector<size_t> ends_;  // where each value ends in text_
    std::vector<bool> null_;
    size_t column_ = 0;   // of the record being built
    size_t records_ = 0;  // complete records
    size_t position_ = 0;
};

}  // namespace ryx::sqlite
