#include "demo.h"
#include "ryx/policy_status.h"

namespace demo {
namespace {

void showCriterion(ryx::RYXPolicyStatus& ps) {
    ps.setCrystalStyle(true);
    show("ReturnedText (formula syntax)", ps.ReturnedText());
    ps.setCrystalStyle(false);
    show("ReturnedText (plain syntax)  ", ps.ReturnedText());
    ps.setCrystalStyle(true);
    show("DefaultSetting               ", "\"" + ps.DefaultSetting().toString() + "\"");
}

}  // namespace

void policyStatus(ryx::headless::Form& form) {
    using namespace ryx::headless;
    auto& status = form.add<ryx::RYXPolicyStatus>("PolicyStatus1", 2905, 1580);
    auto& site = form.site("PolicyStatus1");

    std::cout << "Policy status: the user clicks \"In - Force\" and \"Fully PaidUp\"\n";
    form.clickRow(site.child<HListBox>("LstPolicyStatus"), 0);
    form.clickRow(site.child<HListBox>("LstPolicyStatus"), 3);
    showCriterion(status);
    const ryx::Variant saved = status.DefaultSetting();

    std::cout << "Policy status: the user checks \"All Policies\"\n";
    form.click(site.child<HCheckBox>("ChkAll"));
    showCriterion(status);

    std::cout << "Policy status: the host restores the saved choice \"" << saved.toString()
              << "\" on a fresh control\n";
    auto& again = form.add<ryx::RYXPolicyStatus>("PolicyStatus2", 2905, 1580);
    again.setDefaultSetting(saved);
    showCriterion(again);
}

}  // namespace demo
