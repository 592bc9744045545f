#include "demo.h"
#include "ryx/range_selector.h"

namespace demo {

void rangeSelector(ryx::headless::Form& form) {
    using namespace ryx::headless;
    auto& range = form.add<ryx::RYXRangeSelector>("RangeSelector1");
    auto& site = form.site("RangeSelector1");
    site.onEvent = [](ryx::EventId id, ryx::EventArgs& args) {
        if (id == ryx::EventId::ButtonClick)
            show("ButtonClick Index", args.Index.toString() + " (the host offers its list)");
    };
    std::cout << "Range selector: the host sets ControlType \"policyno\"\n";
    range.setControlType("policyno");
    show("Frame caption", site.child<HFrame>("fraRangeSelector").caption());
    show("Footer       ", site.child<HLabel>("lblFooter").caption());

    std::cout << "Range selector: the user types \"10a00\", Enter, \"25x00\" (letters are "
                 "dropped)\n";
    form.focusControl(site);
    form.type("10a00\r25x00");
    show("StartText", "\"" + range.StartText() + "\"");
    show("EndText  ", "\"" + range.EndText() + "\"");

    std::cout << "Range selector: the host sets EndText \"999\", below the start\n";
    range.setEndText("999");
    show("EndText  ", "\"" + range.EndText() + "\" (kept)");

    std::cout << "Range selector: the user presses Alt+P in the end box\n";
    form.press('P', ryx::shift::Alt);
}

}  // namespace demo
