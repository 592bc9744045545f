// The kinds of item a range selector is set up for, looked up by ControlType.
#pragma once

#include <cstdint>
#include <optional>
#include <string_view>

#include "ryx/range_selector.h"

namespace ryx {

struct ControlTypeRow {
    std::string_view key;       // lower case
    std::string_view itemWord;  // plural noun shown in the captions; empty for an unknown key
    int32_t maxLength;          // of both boxes; 0 means no limit
    std::optional<RYXRgSelTxtType> textType;  // none: the current key filter stays
};

// The row for a control type: its key matched whole, without regard to the case of basic
// Latin letters; an unknown text gives the row with no item word and no limit.
const ControlTypeRow& controlTypeRow(std::string_view controlType);

}  // namespace ryx
