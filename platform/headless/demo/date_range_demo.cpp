#include "demo.h"
#include "ryx/date_range.h"

namespace demo {
namespace {

void showDates(ryx::RYXDateRange& dr) {
    dr.setCrystalStyle(true);
    show("StartDate (formula syntax)", dr.StartDate().toString());
    show("EndDate   (formula syntax)", dr.EndDate().toString());
    dr.setCrystalStyle(false);
    show("StartDate (plain syntax)  ", dr.StartDate().toString());
    show("EndDate   (plain syntax)  ", dr.EndDate().toString());
    dr.setCrystalStyle(true);
}

}  // namespace

void dateRange(ryx::headless::Form& form) {
    using namespace ryx::headless;
    auto& dr = form.add<ryx::RYXDateRange>("DateRange1");
    auto& site = form.site("DateRange1");
    auto& start = site.child<HMaskedEdit>("MskDate", 0);
    auto& end = site.child<HMaskedEdit>("MskDate", 1);
    dr.setDateStyle(ryx::RYXDtRgStyle::RYXDtRgFinancialYear);

    std::cout << "Date range: financial-year style, the footer reads \"" << dr.FootNote() << "\"\n";
    form.setFocus(start);
    form.type("15/");
    show("start box after typing 15/     ", start.text());
    form.type("5/2001");
    show("start box after typing 5/2001  ", start.text());
    form.tab();
    form.type("10/02/2003");
    show("end box after typing 10/02/2003", end.text());
    form.tab();
    show("end box after a Tab out of it  ", end.text());
    showDates(dr);

    std::cout << "Date range: the host clears the end date and reads it again\n";
    dr.setEndDate("");
    showDates(dr);
}

}  // namespace demo
