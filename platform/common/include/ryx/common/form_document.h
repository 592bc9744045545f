// The form file of a host: the properties of every control on a form, as a JSON document
//   {"format": "ryx-form/1",
//    "controls": {"<name>": {"type": "RYXPolicyStatus", "properties": {...}}}}
// Writing is atomic (a temporary file in the same folder, flushed to disk, then renamed over
// the old one), so a crash in the middle of a save leaves the previous file whole.
#pragma once

#include <filesystem>
#include <span>
#include <string>
#include <string_view>
#include <vector>

#include "ryx/host.h"
#include "ryx/property_bag.h"

namespace ryx::common {

inline constexpr std::string_view kFormFormat = "ryx-form/1";

struct FormControl {
    std::string name;
    const HostedControl* control;
};

// One control of a form document: its name, type and saved properties. A property whose value
// cannot be read (an array, an object) is kept as unreadable, so that loading skips that one key.
struct FormEntry {
    std::string name;
    std::string type;  // empty when the document names none
    MemoryPropertyBag properties;
};

// The document for the controls, each written through its WriteProperties.
std::string formToJson(std::span<const FormControl> controls);
// FormFileError naming the file and the reason when it cannot be written.
void writeFormFile(const std::filesystem::path& file, std::string_view document);

// The controls of a document; a document that is not a form file at all is a FormFileError
// naming `source` and the problem.
std::vector<FormEntry> parseForm(std::string_view document, std::string_view source);
// The text of a form file; FormFileError naming the file when it cannot be read.
std::string readFormFile(const std::filesystem::path& file);

}  // namespace ryx::common
