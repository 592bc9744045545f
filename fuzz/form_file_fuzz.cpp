// Form files from arbitrary bytes: a clear error or a loaded form, never a crash; and what
// loaded saves a document that loads into the same form again.
#include <cstddef>
#include <cstdint>
#include <cstdio>
#include <cstdlib>
#include <string_view>

#include "ryx/errors.h"
#include "ryx/headless/form.h"
#include "ryx/headless/form_file.h"

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size) {
    const std::string_view text(reinterpret_cast<const char*>(data), size);
    ryx::headless::Form form;
    try {
        ryx::headless::loadFormJson(form, text, "fuzz input");
    } catch (const ryx::FormFileError&) {
        return 0;
    }
    // Whatever loaded can be saved and loaded again, and nothing changes on the way.
    const std::string saved = ryx::headless::formToJson(form);
    ryx::headless::Form again;
    ryx::headless::loadFormJson(again, saved, "saved form");
    if (ryx::headless::formToJson(again) != saved) {
        std::fprintf(stderr, "form file: saved again differently:\n%s\n---\n%s\n", saved.c_str(),
                     ryx::headless::formToJson(again).c_str());
        std::abort();
    }
    return 0;
}
