// The rows of a list box and their selected flags, as every toolkit keeps them.
//
// A row added on its own keeps a copy of its text. Rows added many at once keep only the
// function that gives their texts, asked whenever a row's text is wanted: a list of a million
// agencies then holds one byte a row, its selected flag, and the texts stay where they are.
#pragma once

#include <cstdint>
#include <span>
#include <string>
#include <string_view>
#include <vector>

#include "ryx/host.h"

namespace ryx::common {

class ListRows {
  public:
    int32_t count() const { return static_cast<int32_t>(flags_.size()); }
    void clear();
    void add(std::string_view text);
    void add(int32_t count, ListBox::RowText text);
    // The text of a row in range.
    std::string text(int32_t row) const;

    bool selected(int32_t row) const { return flags_[static_cast<size_t>(row)] != 0; }
    std::span<const uint8_t> flags() const { return flags_; }
    // Sets the flags of the rows first to last (in range, first <= last); true when any of
    // them changed.
    bool setSelected(int32_t first, int32_t last, bool v);

  private:
    // Consecutive rows of one kind: copies kept in owned_ from `owned` on, or texts asked of
    // `text`.
    struct Run {
        int32_t first = 0;
        int32_t count = 0;
        size_t owned = 0;
        ListBox::RowText text;
    };

    std::vector<Run> runs_;
    std::vector<std::string> owned_;
    std::vector<uint8_t> flags_;
};

}  // namespace ryx::common
