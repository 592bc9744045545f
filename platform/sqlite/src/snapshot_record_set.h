// The rows of one query kept in memory, with a cursor over them.
//
// The values lie end to end, record by record, in blocks of text of about a megabyte, with the
// end of each value within its block and a null mark beside it: a million agencies take a few
// dozen allocations and little more memory than their text, and the text is never copied to a
// larger buffer as it grows.
#pragma once

#include <cstddef>
#include <cstdint>
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

    bool eof() const override { return position_ >= records_; }
    bool bof() const override { return records_ == 0; }
    void moveFirst() override { position_ = 0; }
    void moveNext() override;
    // Names match without regard to letter case, as the database's own column names do.
    std::optional<std::string> field(std::string_view name) const override;
    std::optional<std::string> field(int position) const override;
    size_t recordCount() const override { return records_; }
    std::optional<std::string_view> fieldAt(size_t record, int position) const override;

  private:
    struct Block {
        std::string text;
        size_t firstValue;  // the index of the first value it holds
    };

    void valueAdded(uint32_t end, bool null);
    std::string_view value(size_t index) const;
    [[noreturn]] void fail(const std::string& what) const;

    std::vector<std::string> columns_;
    std::string origin_;
    std::vector<Block> blocks_;
    std::vector<uint32_t> ends_;  // where each value ends in its block
    std::vector<bool> null_;
    size_t column_ = 0;   // of the record being built
    size_t records_ = 0;  // complete records
    size_t position_ = 0;
    mutable size_t lastBlock_ = 0;  // where the last value read lay: reading goes mostly forward
};

}  // namespace ryx::sqlite
