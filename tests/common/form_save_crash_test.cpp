// A form file survives a crash in the middle of a save: a process killed at any moment while it
// saves leaves on disk either the whole form saved before or the whole form being saved, never
// a mixture, a cut-off file or no file.
#include <signal.h>
#include <sys/wait.h>
#include <unistd.h>

#include <gtest/gtest.h>

#include <chrono>
#include <random>
#include <thread>

#include "form_fixture.h"
#include "ryx/agency_selection.h"
#include "ryx/common/form_document.h"
#include "ryx/date_range.h"
#include "ryx/headless/form_file.h"
#include "ryx/policy_status.h"
#include "ryx/range_selector.h"

using namespace ryx;
using namespace ryx::headless;
namespace fs = std::filesystem;

namespace {

// A screen of the four controls. The second state has a footnote long enough that writing it
// takes a while, so that kills land inside the write as well as between saves.
void buildScreen(Form& form, bool second) {
    auto& dates = form.add<RYXDateRange>("dates");
    auto& range = form.add<RYXRangeSelector>("range");
    form.add<RYXAgencySelection>("agencies", 2820, 1740);
    auto& statuses = form.add<RYXPolicyStatus>("statuses");
    dates.setDateStyle(second ? 3 : 1);
    range.setCaption(second ? "Policies" : "Clients");
    range.setFootNote(second ? std::string(300000, 'x') : "Short");
    statuses.setCrystalStyle(!second);
}

std::chrono::microseconds timeOfOneSave(const Form& form, const fs::path& file) {
    const auto start = std::chrono::steady_clock::now();
    for (int i = 0; i < 5; ++i)
        saveForm(form, file);
    return std::chrono::duration_cast<std::chrono::microseconds>(
        (std::chrono::steady_clock::now() - start) / 5);
}

// A child process that saves the two states in turn until it is killed; returns once it has
// started saving.
pid_t startSaving(const Form (&states)[2], const fs::path& file) {
    int ready[2];
    if (pipe(ready) != 0) return -1;
    const pid_t child = fork();
    if (child == 0) {
        close(ready[0]);
        if (write(ready[1], "s", 1) != 1) _exit(1);
        for (unsigned i = 1;; ++i)
            saveForm(states[i % 2], file);
    }
    close(ready[1]);
    char started;
    if (read(ready[0], &started, 1) != 1) ADD_FAILURE() << "the saving process did not start";
    close(ready[0]);
    return child;
}

TEST(FormSaveCrash, AProcessKilledWhileSavingLeavesTheOldFormOrTheNewOneWhole) {
    ryx::testing::TempFolder tmp;
    const fs::path file = tmp / "screen.json";
    Form states[2];
    buildScreen(states[0], false);
    buildScreen(states[1], true);
    const std::string documents[2] = {formToJson(states[0]), formToJson(states[1])};
    const auto save = timeOfOneSave(states[1], file);
    saveForm(states[0], file);

    std::random_device seed;
    std::mt19937 random(seed());
    // Kill points spread over a few saves: before the first ends, inside one, between two.
    std::uniform_int_distribution<long> delay(0, 2 * save.count() + 200);
    int found[2] = {0, 0};
    constexpr int kKills = 100;
    for (int kill = 0; kill < kKills; ++kill) {
        const pid_t child = startSaving(states, file);
        ASSERT_GT(child, 0);
        std::this_thread::sleep_for(std::chrono::microseconds(delay(random)));
        ::kill(child, SIGKILL);
        int status = 0;
        waitpid(child, &status, 0);
        ASSERT_TRUE(WIFSIGNALED(status) && WTERMSIG(status) == SIGKILL);

        const std::string onDisk = common::readFormFile(file);
        const int which = onDisk == documents[0] ? 0 : onDisk == documents[1] ? 1 : -1;
        ASSERT_NE(which, -1) << "kill " << kill << " left " << onDisk.size() << " bytes that are "
                             << "neither form (" << documents[0].size() << " or "
                             << documents[1].size() << " bytes)";
        ++found[which];
        Form loaded;
        EXPECT_TRUE(loadForm(loaded, file).skipped.empty());
        EXPECT_EQ(loaded.sites().size(), 4u);
    }
    // The kills fell both before and after the new form replaced the old one.
    EXPECT_GT(found[0], 0);
    EXPECT_GT(found[1], 0);
    // Nothing but the form and the hidden temporary files of interrupted saves was written.
    for (const auto& entry : fs::directory_iterator(tmp.path())) {
        const std::string name = entry.path().filename().string();
        EXPECT_TRUE(name == "screen.json" || name.starts_with(".screen.json.")) << name;
    }
    RecordProperty("kills", kKills);
    RecordProperty("oldFormFound", found[0]);
    RecordProperty("newFormFound", found[1]);
    RecordProperty("microsecondsPerSave", static_cast<int>(save.count()));
}

}  // namespace
