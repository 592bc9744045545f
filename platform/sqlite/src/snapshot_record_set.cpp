#include "snapshot_record_set.h"

#include <algorithm>
#include <limits>

#include "ryx/errors.h"
#include "ryx/property_bag.h"

namespace ryx::sqlite {
namespace {

// Large enough that a million agencies fill a few dozen blocks, small enough that the spare
// room of the last one hardly counts. A longer value has a block of its own.
constexpr size_t kBlockBytes = size_t{1} << 20;

}  // namespace

SnapshotRecordSet::SnapshotRecordSet(std::vector<std::string> columns, std::string origin)
    : columns_(std::move(columns)), origin_(std::move(origin)) {
    if (columns_.empty()) fail("the query gives no columns");
}

void SnapshotRecordSet::append(std::string_view text) {
    if (text.size() > std::numeric_limits<uint32_t>::max())
        fail("a value of " + std::to_string(text.size()) + " bytes is too long to hold");
    if (blocks_.empty() ||
        (!blocks_.back().text.empty() && blocks_.back().text.size() + text.size() > kBlockBytes)) {
        Block next{{}, ends_.size()};
        // After the first block the records are many: take each block's room at once.
        if (!blocks_.empty()) next.text.reserve(std::max(kBlockBytes, text.size()));
        blocks_.push_back(std::move(next));
    }
    std::string& block = blocks_.back().text;
    block += text;
    valueAdded(static_cast<uint32_t>(block.size()), false);
}

void SnapshotRecordSet::appendNull() {
    if (blocks_.empty()) blocks_.push_back({{}, 0});
    valueAdded(static_cast<uint32_t>(blocks_.back().text.size()), true);
}

void SnapshotRecordSet::valueAdded(uint32_t end, bool null) {
    ends_.push_back(end);
    null_.push_back(null);
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
        if (columns_[column] == name || keysEqual(columns_[column], name))
            return field(static_cast<int>(column));
    fail("the query gives no field named \"" + std::string(name) + "\"");
}

std::optional<std::string> SnapshotRecordSet::field(int position) const {
    if (position < 0 || static_cast<size_t>(position) >= columns_.size())
        fail("there is no field at position " + std::to_string(position) + " of " +
             std::to_string(columns_.size()));
    if (eof()) fail("there is no current record");
    const std::optional<std::string_view> value = fieldAt(position_, position);
    if (!value) return std::nullopt;
    return std::string(*value);
}

std::optional<std::string_view> SnapshotRecordSet::fieldAt(size_t record, int position) const {
    if (position < 0 || static_cast<size_t>(position) >= columns_.size())
        fail("there is no field at position " + std::to_string(position) + " of " +
             std::to_string(columns_.size()));
    if (record >= records_)
        fail("there is no record " + std::to_string(record + 1) + " of " +
             std::to_string(records_));
    const size_t index = record * columns_.size() + static_cast<size_t>(position);
    if (null_[index]) return std::nullopt;
    return value(index);
}

// The block of the value read last is tried first, then the one after it, so that reading the
// records in order never searches.
std::string_view SnapshotRecordSet::value(size_t index) const {
    auto holds = [&](size_t block) {
        return blocks_[block].firstValue <= index &&
               (block + 1 == blocks_.size() || index < blocks_[block + 1].firstValue);
    };
    if (!holds(lastBlock_)) {
        if (lastBlock_ + 1 < blocks_.size() && holds(lastBlock_ + 1)) {
            ++lastBlock_;
        } else {
            const auto after =
                std::upper_bound(blocks_.begin(), blocks_.end(), index,
                                 [](size_t i, const Block& b) { return i < b.firstValue; });
            lastBlock_ = static_cast<size_t>(after - blocks_.begin()) - 1;
        }
    }
    const Block& block = blocks_[lastBlock_];
    const size_t begin = index == block.firstValue ? 0 : ends_[index - 1];
    return {block.text.data() + begin, ends_[index] - begin};
}

void SnapshotRecordSet::fail(const std::string& what) const {
    throw DataSourceError("agency records of \"" + origin_ + "\": " + what);
}

}  // namespace ryx::sqlite
