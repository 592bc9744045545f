// The control types a form file may name, and how to create each.
#include "control_types.h"

#include "ryx/date_range.h"
#include "ryx/agency_selection.h"
#include "ryx/policy_status.h"
#include "ryx/range_selector.h"

namespace ryx::headless {
namespace {

template <class C>
std::unique_ptr<HostedControl> make(Container& site) {
    return std::make_unique<C>(site);
}

struct ControlType {
    std::string_view name;
    std::unique_ptr<HostedControl> (*create)(Container&);
};

constexpr ControlType kControlTypes[] = {
    {"RYXPolicyStatus", &make<RYXPolicyStatus>},
    {"RYXDateRange", &make<RYXDateRange>},
    {"RYXRangeSelector", &make<RYXRangeSelector>},
    {"RYXAgencySelection", &make<RYXAgencySelection>},
};

}  // namespace

std::unique_ptr<HostedControl> createControl(std::string_view type, Container& site) {
    for (const ControlType& t : kControlTypes)
        if (t.name == type) return t.create(site);
    return nullptr;
}

bool isControlType(std::string_view type) {
    for (const ControlType& t : kControlTypes)
        if (t.name == type) return true;
    return false;
}

}  // namespace ryx::headless
