// One QWidget per control: each owns its core control (control()) and places a new instance
// at the control's design size. Events arrive as the signals of ControlHost.
#pragma once

#include "ryx/agency_selection.h"
#include "ryx/date_range.h"
#include "ryx/policy_status.h"
#include "ryx/qt/control_host.h"
#include "ryx/range_selector.h"

namespace ryx::qt {

class PolicyStatusWidget : public ControlWidget<RYXPolicyStatus> {
  public:
    explicit PolicyStatusWidget(QWidget* parent = nullptr, bool newInstance = true)
        : ControlWidget(parent, 2905, 1580, newInstance) {}
};

class AgencySelectionWidget : public ControlWidget<RYXAgencySelection> {
public:
    explicit AgencySelectionWidget(QWidget* parent = nullptr, bool newInstance = true)
        : ControlWidget(parent, 2820, 1740, newInstance) {}
};

class DateRangeWidget : public ControlWidget<RYXDateRange> {
  public:
    explicit DateRangeWidget(QWidget* parent = nullptr, bool newInstance = true)
        : ControlWidget(parent, 2430, 1305, newInstance) {}
};

class RangeSelectorWidget : public ControlWidget<RYXRangeSelector> {
  public:
    explicit RangeSelectorWidget(QWidget* parent = nullptr, bool newInstance = true)
        : ControlWidget(parent, 3615, 1200, newInstance) {}
};

}  // namespace ryx::qt
