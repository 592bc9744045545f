// A scripted report-selection session on a headless form: the controls are placed as a host
// places them, a user clicks and types, and what the host would read is printed.
#include <cstdio>
#include <filesystem>
#include <iostream>
#include <string>

#include "ryx/headless/form.h"
#include "ryx/headless/form_file.h"
#include "ryx/policy_status.h"

using namespace ryx;
using ryx::headless::Form;

namespace {

void show(const char* what, const std::string& value) {
    std::cout << "  " << what << ": " << value << "\n";
}

void showPolicyStatus(RYXPolicyStatus& ps) {
    ps.setCrystalStyle(true);
    show("ReturnedText (formula syntax)", ps.ReturnedText());
    ps.setCrystalStyle(false);
    show("ReturnedText (plain syntax)  ", ps.ReturnedText());
    ps.setCrystalStyle(true);
    show("DefaultSetting               ", "\"" + ps.DefaultSetting().toString() + "\"");
}

}  // namespace

int main() {
    Form form;
    form.setUserMode(true);
    auto& status = form.add<RYXPolicyStatus>("PolicyStatus1", 2905, 1580);
    auto& site = form.site("PolicyStatus1");
    auto& list = site.child<headless::HListBox>("LstPolicyStatus");
    auto& all = site.child<headless::HCheckBox>("ChkAll");

    std::cout << "Policy status: the user clicks \"In - Force\" and \"Fully PaidUp\"\n";
    form.clickRow(list, 0);
    form.clickRow(list, 3);
    showPolicyStatus(status);
    const Variant saved = status.DefaultSetting();

    std::cout << "Policy status: the user checks \"All Policies\"\n";
    form.click(all);
    showPolicyStatus(status);

    std::cout << "Policy status: the host restores the saved choice \"" << saved.toString()
              << "\" on a fresh control\n";
    auto& again = form.add<RYXPolicyStatus>("PolicyStatus2", 2905, 1580);
    again.setDefaultSetting(saved);
    showPolicyStatus(again);

    const auto file = std::filesystem::temp_directory_path() / "ryx-demo-form.json";
    headless::saveForm(form, file);
    std::cout << "The form's properties are saved in " << file.string() << "\n";
    return 0;
}
