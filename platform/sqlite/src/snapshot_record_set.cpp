#include "snapshot_record_set.h"

#include "ryx/errors.h"
#include "ryx/property_bag.h"

namespace ryx::sqlite {

SnapshotRecordSet::SnapshotRecordSet(std::vector<std::string> columns, std::string origin)
    : columns_(std::move(columns)), origin_(std::move(origin)) {
    if (columns_.empty()) fail("the query gives no columns");
}

void SnapshotRecordSet::append(std::string_view text) {
    text_ += text;
    ends_.push_back(text_.size());
    null_.push_back(false);
    valueAdded();
}

void SnapshotRecordSet::appendNull() {
    ends_.push_back(text_.size());
    null_.push_back(true);
    valueAdded();
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
    const size_t cell = position_ * columns_.size() + static_cast<size_t>(position);
    if (null_[cell]) return std::nullopt;
    const size_t begin = cell == 0 ? 0 : ends_[cell - 1];
    return std::string(text_.data() + begin, ends_[cell] - begin);
}

void SnapshotRecordSet::fail(const std::string& what) const {
    throw DataSourceError("agency records of \"" + origin_ + "\": " + what);
}

}  // namespace ryx::sqlite
