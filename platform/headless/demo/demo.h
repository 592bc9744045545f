// The scripted report-selection session: one part per control, each placing its control on
// the form, acting as a user would and printing what the host reads.
#pragma once

#include <iostream>
#include <string>

#include "ryx/headless/form.h"

namespace demo {

inline void show(const std::string& what, const std::string& value) {
    std::cout << "  " << what << ": " << value << "\n";
}

void policyStatus(ryx::headless::Form& form);
void dateRange(ryx::headless::Form& form);
void rangeSelector(ryx::headless::Form& form);
void agencySelection(ryx::headless::Form& form);

}  // namespace demo
