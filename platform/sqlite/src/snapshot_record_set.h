// The rows of one query kept in memory, with a cursor over them.
//
// Each column keeps its values end to end in blocks of text of about a megabyte, with the end
// of each value within its block, its top bit marking a null value. A million agencies take a
// few dozen allocations and little more memory than their text; the text is never copied to a
// larger buffer as it grows; and reading one column down all the records, as the criterion
// text reads the codes, goes through that column's bytes alone.
#pragma once

#include <cstddef>
#include <cstdint>
#include <optional>
#include <span>
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
    size_t readField(int position, size_t first,
                     std::span<std::optional<std::string_view>> values) const override;

  private:
    class Column {
      public:
        explicit Column(std::string name) : name_(std::move(name)) {}
        const std::string& name() const { return name_; }
        void append(std::string_view text);
        void appendNull();
        // The values of the records from `first` on, as many as `values` holds.
        void read(size_t first, std::span<std::optional<std::string_view>> values) const;

      private:
        static constexpr uint32_t kNull = uint32_t{1} << 31;
        struct Block {
            std::string text;
            size_t first, end;  // the records whose values it holds
        };
        Block& blockFor(size_t length);
        size_t blockOf(size_t record) const;

        std::string name_;
        std::vector<Block> blocks_;
        std::vector<uint32_t> ends_;    // where each value ends in its block, or'ed with kNull
        mutable size_t lastBlock_ = 0;  // where the last reading began
    };

    void valueAdded();
    [[noreturn]] void failAt(size_t record, int position) const;
    [[noreturn]] void fail(const std::string& what) const;

    std::vector<Column> columns_;
    std::string origin_;
    size_t column_ = 0;   // of the record being built
    size_t records_ = 0;  // complete records
    size_t position_ = 0;
};

}  // namespace ryx::sqlite
