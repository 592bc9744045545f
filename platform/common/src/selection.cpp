#include "ryx/common/selection.h"

#include <algorithm>

#include "ryx/host.h"

namespace ryx::common {

void Selection::select(int32_t anchor, int32_t caret, int32_t textLength) {
    anchor = std::clamp(anchor, 0, textLength);
    caret = std::clamp(caret, 0, textLength);
    start_ = std::min(anchor, caret);
    length_ = std::max(anchor, caret) - start_;
    caretAtStart_ = caret < anchor;
}

void Selection::setLength(int32_t v, int32_t textLength) {
    select(start_, start_ + std::clamp(v, 0, textLength - start_), textLength);
}

bool Selection::move(int16_t keyCode, int16_t shift, int32_t textLength) {
    const bool extend = (shift & ryx::shift::Shift) != 0;
    int32_t target = 0;
    switch (keyCode) {
        case vk::Home:
            target = 0;
            break;
        case vk::End:
            target = textLength;
            break;
        case vk::Left:
            target = (!extend && length_ > 0) ? start_ : caret() - 1;
            break;
        case vk::Right:
            target = (!extend && length_ > 0) ? end() : caret() + 1;
            break;
        default:
            return false;
    }
    select(extend ? anchor() : target, target, textLength);
    return true;
}

}  // namespace ryx::common
