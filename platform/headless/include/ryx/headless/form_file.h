// Form files of a headless form (the document is described in ryx/common/form_document.h).
#pragma once

#include <filesystem>
#include <string>
#include <string_view>
#include <vector>

#include "ryx/headless/form.h"

namespace ryx::headless {

// What a load passed over: controls of unknown type or of another type than the form holds.
struct LoadReport {
    std::vector<std::string> skipped;
};

// The document for the form's controls, each written through its WriteProperties.
std::string formToJson(const Form& form);
// FormFileError naming the file and the reason when it cannot be written.
void saveForm(const Form& form, const std::filesystem::path& file);

// Applies a form document: each control named in it is loaded through ReadProperties (placed
// first when the form does not hold it yet), then resized. A property that cannot be read
// leaves that property as it was; a document that is not a form file at all is a
// FormFileError naming `source` and the problem.
LoadReport loadFormJson(Form& form, std::string_view json, std::string_view source);
LoadReport loadForm(Form& form, const std::filesystem::path& file);

}  // namespace ryx::headless
