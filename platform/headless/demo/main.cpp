// A scripted report-selection session on a headless form: the controls are placed as a host
// places them, a user clicks and types, and what the host would read is printed.
#include <filesystem>
#include <iostream>

#include "demo.h"
#include "ryx/headless/form_file.h"

int main() {
    ryx::headless::Form form;
    form.setUserMode(true);

    demo::policyStatus(form);
    demo::dateRange(form);
    demo::rangeSelector(form);
    demo::agencySelection(form);

    const auto file = std::filesystem::temp_directory_path() / "ryx-demo-form.json";
    ryx::headless::saveForm(form, file);
    std::cout << "The form's properties are saved in " << file.string() << "\n";
    return 0;
}
