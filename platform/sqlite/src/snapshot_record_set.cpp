#include "snapshot_record_set.h"

#include <algorithm>

#include "ryx/errors.h"
#include "ryx/property_bag.h"

namespace ryx::sqlite {
namespace {

// Large enough that a million agencies fill a few dozen blocks, small enough that the spare
// room of the last one hardly counts. A longer value has a block of its own.
constexpr size_t kBlockBytes = size_t{1} << 20;

}  // namespace

// ---- one column --------------------------------------------------------------------------

void SnapshotRecordSet::Column::append(std::string_view text) {
    std::string& block = blockFor(text.size()).text;
    block += text;
    ends_.push_back(static_cast<uint32_t>(block.size()));
}

void SnapshotRecordSet::Column::appendNull() {
    ends_.push_back(static_cast<uint32_t>(blockFor(0).text.size()) | kNull);
}

// The block that takes a value of `length` bytes: the last one while the value fits in it, or
// while it is empty; it counts the value as its own.
SnapshotRecordSet::Column::Block& SnapshotRecordSet::Column::blockFor(size_t length) {
    if (blocks_.empty() ||
        (!blocks_.back().text.empty() && blocks_.back().text.size() + length > kBlockBytes)) {
        Block next{{}, ends_.size(), ends_.size()};
        // After the first block the records are many: take each block's room at once.
        if (!blocks_.empty()) next.text.reserve(std::max(kBlockBytes, length));
        blocks_.push_back(std::move(next));
    }
    ++blocks_.back().end;
    return blocks_.back();
}

void SnapshotRecordSet::Column::read(size_t first,
                                     std::span<std::optional<std::string_view>> values) const {
    const size_t last = first + values.size();
    for (size_t block = blockOf(first), record = first; record < last; ++block) {
        const char* text = blocks_[block].text.data();
        uint32_t begin = record == blocks_[block].first ? 0 : ends_[record - 1] & ~kNull;
        for (const size_t stop = std::min(blocks_[block].end, last); record < stop; ++record) {
            const uint32_t end = ends_[record];
            if (end & kNull)
                values[record - first].reset();
            else
                values[record - first].emplace(text + begin, end - begin);
            begin = end & ~kNull;
        }
    }
}

// The block of a record: the one where the last reading began, or the next, or found by
// halving, so that reading the records in order never searches.
size_t SnapshotRecordSet::Column::blockOf(size_t record) const {
    auto holds = [&](size_t block) {
        return block < blocks_.size() && record >= blocks_[block].first &&
               record < blocks_[block].end;
    };
    if (!holds(lastBlock_) && !holds(++lastBlock_)) {
        const auto after = std::upper_bound(blocks_.begin(), blocks_.end(), record,
                                            [](size_t r, const Block& b) { return r < b.first; });
        lastBlock_ = static_cast<size_t>(after - blocks_.begin()) - 1;
    }
    return lastBlock_;
}

// ---- the records -------------------------------------------------------------------------

SnapshotRecordSet::SnapshotRecordSet(std::vector<std::string> columns, std::string origin)
    : origin_(std::move(origin)) {
    if (columns.empty()) fail("the query gives no columns");
    for (std::string& name : columns)
        columns_.emplace_back(std::move(name));
}

// A value longer than SQLite ever gives (2 GiB) would need the null mark's bit.
void SnapshotRecordSet::append(std::string_view text) {
    if (text.size() >= size_t{1} << 31)
        fail("a value of " + std::to_string(text.size()) + " bytes is too long to hold");
    columns_[column_].append(text);
    valueAdded();
}

void SnapshotRecordSet::appendNull() {
    columns_[column_].appendNull();
    valueAdded();
}

void SnapshotRecordSet::valueAdded() {
    if (++column_ == columns_.size()) {
        column_ = 0;
        ++records_;
    }
}

void SnapshotRecordSet::moveNext() {
    if (eof()) fail("there is no current record to move on from");
    ++position_;
}

std::optional<std::string> SnapshotRecordSet::field(std::string_view name) const {
    for (size_t column = 0; column < columns_.size(); ++column)
        if (columns_[column].name() == name || keysEqual(columns_[column].name(), name))
            return field(static_cast<int>(column));
    fail("the query gives no field named \"" + std::string(name) + "\"");
}

std::optional<std::string> SnapshotRecordSet::field(int position) const {
    if (eof() && position >= 0 && static_cast<size_t>(position) < columns_.size())
        fail("there is no current record");
    const std::optional<std::string_view> value = fieldAt(position_, position);
    if (!value) return std::nullopt;
    return std::string(*value);
}

size_t SnapshotRecordSet::readField(int position, size_t first,
                                    std::span<std::optional<std::string_view>> values) const {
    if (position < 0 || static_cast<size_t>(position) >= columns_.size() || first >= records_)
        failAt(first, position);
    const size_t count = std::min(values.size(), records_ - first);
    columns_[static_cast<size_t>(position)].read(first, values.first(count));
    return count;
}

void SnapshotRecordSet::failAt(size_t record, int position) const {
    if (position < 0 || static_cast<size_t>(position) >= columns_.size())
        fail("there is no field at position " + std::to_string(position) + " of " +
             std::to_string(columns_.size()));
    fail("there is no record " + std::to_string(record + 1) + " of " + std::to_string(records_));
}

void SnapshotRecordSet::fail(const std::string& what) const {
    throw DataSourceError("agency records of \"" + origin_ + "\": " + what);
}

}  // namespace ryx::sqlite
