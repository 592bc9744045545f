#include <filesystem>
#include <system_error>

#include "demo.h"
#include "ryx/agency_selection.h"
#include "ryx/sqlite/sqlite_record_source.h"

namespace demo {
namespace {

// The sample database that the build makes beside the demo program (<build>/data).
std::string sampleDatabase() {
    std::error_code error;
    const auto program = std::filesystem::read_symlink("/proc/self/exe", error);
    if (!error) {
        const auto beside = program.parent_path() / "data" / "agencies.db";
        if (std::filesystem::exists(beside)) return beside.string();
    }
    return RYX_SAMPLE_DATABASE;
}

void showCriterion(ryx::RYXAgencySelection& agencies) {
    agencies.setCrystalStyle(true);
    show("ReturnedText (formula syntax)", agencies.ReturnedText());
    agencies.setCrystalStyle(false);
    show("ReturnedText (plain syntax)  ", agencies.ReturnedText());
    agencies.setCrystalStyle(true);
    show("DefaultSetting               ", "\"" + agencies.DefaultSetting().toString() + "\"");
}

}  // namespace

void agencySelection(ryx::headless::Form& form) {
    using namespace ryx::headless;
    form.setRecordSourceFactory(ryx::sqlite::makeRecordSource);
    auto& agencies = form.add<ryx::RYXAgencySelection>("AgencySelection1", 2820, 1740);
    auto& site = form.site("AgencySelection1");
    auto& list = site.child<HListBox>("LstAgMast");

    const std::string database = sampleDatabase();
    agencies.setDatabaseName(database);
    std::cout << "Agency selection: " << list.listCount() - 1 << " agencies from "
              << std::filesystem::path(database).filename().string() << "\n";

    std::cout << "Agency selection: the user clicks \"" << list.list(2) << "\", \"" << list.list(5)
              << "\" and \"" << list.list(0) << "\"\n";
    form.clickRow(list, 2);
    form.clickRow(list, 5);
    form.clickRow(list, 0);
    showCriterion(agencies);

    std::cout << "Agency selection: the user checks \"Your Agencies\"\n";
    form.click(site.child<HCheckBox>("chkAgmast", 1));
    showCriterion(agencies);

    std::cout << "Agency selection: the user clicks \"Deselect All\"\n";
    form.click(site.child<HCommandButton>("cmdDeselect"));
    showCriterion(agencies);
}

}  // namespace demo
