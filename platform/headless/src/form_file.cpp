#include "ryx/headless/form_file.h"

#include "ryx/common/form_document.h"

namespace ryx::headless {

std::string formToJson(const Form& form) {
    std::vector<common::FormControl> controls;
    for (const auto& s : form.sites())
        controls.push_back({s->name(), &s->control()});
    return common::formToJson(controls);
}

void saveForm(const Form& form, const std::filesystem::path& file) {
    common::writeFormFile(file, formToJson(form));
}

LoadReport loadFormJson(Form& form, std::string_view text, std::string_view source) {
    LoadReport report;
    for (common::FormEntry& entry : common::parseForm(text, source)) {
        const std::string& name = entry.name;
        if (entry.type.empty()) {
            report.skipped.push_back(name + ": no control type");
            continue;
        }
        Site* s = form.findSite(name);
        if (s && s->control().typeName() != entry.type) {
            report.skipped.push_back(name + ": the form holds a " +
                                     std::string(s->control().typeName()) + ", the file a " +
                                     entry.type);
            continue;
        }
        if (!s) {
            if (!form.create(entry.type, name)) {
                report.skipped.push_back(name + ": unknown control type " + entry.type);
                continue;
            }
            s = &form.site(name);
        }
        s->control().ReadProperties(entry.properties);
        s->resizeByHost(s->width(), s->height());
    }
    return report;
}

LoadReport loadForm(Form& form, const std::filesystem::path& file) {
    return loadFormJson(form, common::readFormFile(file), file.string());
}

}  // namespace ryx::headless
