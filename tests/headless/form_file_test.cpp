#include "ryx/headless/form_file.h"

#include <gtest/gtest.h>

#include <fstream>

#include "form_fixture.h"
#include "ryx/errors.h"
#include "ryx/policy_status.h"

using namespace ryx;
using namespace ryx::headless;

namespace {

void writeFile(const std::filesystem::path& p, std::string_view text) {
    std::ofstream(p, std::ios::binary) << text;
}

std::string readFile(const std::filesystem::path& p) {
    std::ifstream in(p, std::ios::binary);
    return {std::istreambuf_iterator<char>(in), {}};
}

TEST(FormFile, WhatIsNotAFormFileIsAClearErrorNamingTheFile) {
    ryx::testing::TempFolder tmp;
    struct Case {
        const char* content;  // null: no file at all
        const char* reason;
    } cases[] = {
        {nullptr, "No such file"},
        {"", "invalid JSON"},
        {"{\"format\": \"ryx-form/1\", \"controls\": {", "invalid JSON"},
        {"[1, 2]", "not a JSON object"},
        {"{}", "no \"format\""},
        {"{\"format\": \"other/2\", \"controls\": {}}", "\"other/2\""},
        {"{\"format\": \"ryx-form/1\"}", "no \"controls\""},
        {"{\"format\": \"ryx-form/1\", \"controls\": []}", "no \"controls\""},
        {"\xff\xfe garbage", "invalid JSON"},
    };
    int n = 0;
    for (const Case& c : cases) {
        const auto file = tmp / ("form" + std::to_string(n++) + ".json");
        if (c.content) writeFile(file, c.content);
        Form form;
        try {
            loadForm(form, file);
            ADD_FAILURE() << "no error for " << (c.content ? c.content : "a missing file");
        } catch (const FormFileError& e) {
            const std::string message = e.what();
            EXPECT_NE(message.find(file.string()), std::string::npos) << message;
            EXPECT_NE(message.find(c.reason), std::string::npos) << message;
        }
        EXPECT_TRUE(form.sites().empty());
    }
}

// Found by fuzzing: the JSON reader reports a number beyond the range of a double with an
// error of its own kind, which ended the program instead of becoming a FormFileError.
TEST(FormFile, ANumberTooLargeForADoubleIsAClearErrorNotACrash) {
    Form form;
    EXPECT_THROW(loadFormJson(form, R"({"format": "ryx-form/1", "controls": {"x": 1e999}})", "f"),
                 FormFileError);
}

TEST(FormFile, ControlsOfUnknownOrOtherTypesArePassedOver) {
    Form form;
    form.add<RYXPolicyStatus>("ps");
    const char* doc = R"({"format": "ryx-form/1", "controls": {
        "ps": {"type": "RYXDateRangeX", "properties": {}},
        "other": {"type": "NoSuchControl"},
        "bare": 5,
        "fresh": {"type": "RYXPolicyStatus", "properties": {"Titlecolor": 7}}}})";
    LoadReport report = loadFormJson(form, doc, "inline");
    EXPECT_EQ(report.skipped.size(), 3u);
    ASSERT_NE(form.findSite("fresh"), nullptr);
    EXPECT_EQ(dynamic_cast<RYXPolicyStatus&>(form.site("fresh").control()).TitleColor(), 7);
}

TEST(FormFile, SavingReplacesTheFileWholeAndLeavesNoTemporaryFile) {
    ryx::testing::TempFolder tmp;
    const auto file = tmp / "form.json";
    writeFile(file, "old contents");
    Form form;
    auto& ps = form.add<RYXPolicyStatus>("ps \"quoted\" \xc3\xa9");
    ps.setCrystalStyle(false);
    saveForm(form, file);
    EXPECT_EQ(std::distance(std::filesystem::directory_iterator(tmp.path()), {}), 1);
    const std::string text = readFile(file);
    EXPECT_NE(text.find("\"format\": \"ryx-form/1\""), std::string::npos);

    Form loaded;
    loadForm(loaded, file);
    ASSERT_EQ(loaded.sites().size(), 1u);
    EXPECT_EQ(loaded.sites()[0]->name(), "ps \"quoted\" \xc3\xa9");
    EXPECT_FALSE(dynamic_cast<RYXPolicyStatus&>(loaded.sites()[0]->control()).CrystalStyle());
}

// Found in review: every save made the form file readable by everyone, and a form file reached
// through a link was replaced by a plain file.
TEST(FormFile, ASaveKeepsTheFilesPermissionsAndItsLink) {
    ryx::testing::TempFolder tmp;
    Form form;
    form.add<RYXPolicyStatus>("ps");
    const auto file = tmp / "private.json";
    writeFile(file, "old");
    std::filesystem::permissions(
        file, std::filesystem::perms::owner_read | std::filesystem::perms::owner_write);
    saveForm(form, file);
    EXPECT_EQ(std::filesystem::status(file).permissions(),
              std::filesystem::perms::owner_read | std::filesystem::perms::owner_write);

    const auto link = tmp / "link.json";
    std::filesystem::create_symlink("private.json", link);
    dynamic_cast<RYXPolicyStatus&>(form.site("ps").control()).setCrystalStyle(false);
    saveForm(form, link);
    EXPECT_TRUE(std::filesystem::is_symlink(link));
    EXPECT_NE(readFile(file).find("\"CrystalStyle\": false"), std::string::npos);
}

TEST(FormFile, ASaveThatCannotBeWrittenNamesTheFile) {
    ryx::testing::TempFolder tmp;
    Form form;
    form.add<RYXPolicyStatus>("ps");
    const auto file = tmp / "missing-folder" / "form.json";
    try {
        saveForm(form, file);
        FAIL() << "no error";
    } catch (const FormFileError& e) {
        EXPECT_NE(std::string(e.what()).find(file.string()), std::string::npos);
    }
}

}  // namespace
