#include "ryx/common/list_rows.h"

#include <algorithm>
#include <cstring>
#include <limits>

#include "ryx/errors.h"

namespace ryx::common {

void ListRows::clear() {
    runs_.clear();
    owned_.clear();
    flags_.clear();
}

void ListRows::add(std::string_view text) {
    if (count() == std::numeric_limits<int32_t>::max())
        throw OverflowError("a list holds at most 2147483647 rows");
    if (runs_.empty() || runs_.back().text) runs_.push_back({count(), 0, owned_.size(), {}});
    owned_.emplace_back(text);
    ++runs_.back().count;
    flags_.push_back(0);
}

void ListRows::add(int32_t rows, ListBox::RowText text) {
    if (rows <= 0) return;
    if (rows > std::numeric_limits<int32_t>::max() - count())
        throw OverflowError("a list holds at most 2147483647 rows");
    runs_.push_back({count(), rows, 0, std::move(text)});
    flags_.resize(flags_.size() + static_cast<size_t>(rows), 0);
}

std::string ListRows::text(int32_t row) const {
    const auto run = std::prev(std::upper_bound(
        runs_.begin(), runs_.end(), row, [](int32_t r, const Run& run) { return r < run.first; }));
    if (!run->text) return owned_[run->owned + static_cast<size_t>(row - run->first)];
    std::string text;
    run->text(row - run->first, text);
    return text;
}

// The first flag that differs is found a block at a time, and the rest are written in one go:
// selecting a million rows costs two passes over a byte a row at memory speed.
bool ListRows::setSelected(int32_t first, int32_t last, bool v) {
    uint8_t* const begin = flags_.data() + first;
    const auto length = static_cast<size_t>(last - first) + 1;
    auto* differs = static_cast<uint8_t*>(std::memchr(begin, v ? 0 : 1, length));
    if (!differs) return false;
    std::memset(differs, v ? 1 : 0, length - static_cast<size_t>(differs - begin));
    return true;
}

}  // namespace ryx::common
