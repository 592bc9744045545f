#pragma once

#include <memory>
#include <string_view>

#include "ryx/host.h"

namespace ryx::headless {

// A new control of the named type on the given site (Initialize only); null when unknown.
std::unique_ptr<HostedControl> createControl(std::string_view type, Container& site);
bool isControlType(std::string_view type);

}  // namespace ryx::headless
