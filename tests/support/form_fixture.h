// Helpers shared by the tests that drive controls through a headless form.
#pragma once

#include <gtest/gtest.h>

#include <unistd.h>

#include <algorithm>
#include <filesystem>
#include <string>
#include <vector>

#include "ryx/headless/form.h"

namespace ryx {
// Shows a Variant's kind and value in test failures.
inline void PrintTo(const Variant& v, std::ostream* os) {
    *os << v.describe();
}
}  // namespace ryx

namespace ryx::testing {

// Counts the events of one number that a control raised.
inline int countEvents(const headless::Form& form, std::string_view control, EventId id) {
    return static_cast<int>(std::count_if(
        form.events().begin(), form.events().end(),
        [&](const headless::RaisedEvent& e) { return e.control == control && e.id == id; }));
}

// The names of the events a control raised, in order, as their numbers.
inline std::vector<int> eventNumbers(const headless::Form& form, std::string_view control) {
    std::vector<int> ids;
    for (const auto& e : form.events())
        if (e.control == control) ids.push_back(static_cast<int>(e.id));
    return ids;
}

// A folder of its own for one test, removed afterwards.
class TempFolder {
  public:
    TempFolder() {
        const auto* info = ::testing::UnitTest::GetInstance()->current_test_info();
        path_ = std::filesystem::temp_directory_path() /
                ("ryx-test-" + std::string(info->test_suite_name()) + "-" + info->name() + "-" +
                 std::to_string(::getpid()));
        std::filesystem::remove_all(path_);
        std::filesystem::create_directories(path_);
    }
    ~TempFolder() { std::filesystem::remove_all(path_); }
    const std::filesystem::path& path() const { return path_; }
    std::filesystem::path operator/(std::string_view name) const { return path_ / name; }

  private:
    std::filesystem::path path_;
};

}  // namespace ryx::testing
