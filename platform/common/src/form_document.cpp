#include "ryx/common/form_document.h"

#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

#include <cerrno>
#include <cstring>
#include <fstream>
#include <limits>
#include <nlohmann/json.hpp>
#include <sstream>

#include "ryx/errors.h"
#include "ryx/property_bag.h"

namespace ryx::common {
namespace {

using nlohmann::json;

json toJson(const Variant& v) {
    switch (v.type()) {
        case Variant::Type::Empty:
            return nullptr;
        case Variant::Type::Boolean:
            return v.toBool();
        case Variant::Type::Integer:
        case Variant::Type::Long:
            return v.toInt32();
        case Variant::Type::Double:
            return v.toDouble();
        case Variant::Type::String:
            return v.toString();
    }
    return nullptr;
}

Variant integerVariant(double v) {
    if (v >= std::numeric_limits<int16_t>::min() && v <= std::numeric_limits<int16_t>::max())
        return Variant(static_cast<int16_t>(v));
    if (v >= std::numeric_limits<int32_t>::min() && v <= std::numeric_limits<int32_t>::max())
        return Variant(static_cast<int32_t>(v));
    return Variant(v);
}

void putValue(MemoryPropertyBag& bag, const std::string& key, const json& value) {
    switch (value.type()) {
        case json::value_t::null:
            bag.writeProperty(key, Variant(), Variant());
            break;
        case json::value_t::boolean:
            bag.writeProperty(key, value.get<bool>(), Variant());
            break;
        case json::value_t::number_integer:
            bag.writeProperty(key, integerVariant(static_cast<double>(value.get<int64_t>())), {});
            break;
        case json::value_t::number_unsigned:
            bag.writeProperty(key, integerVariant(static_cast<double>(value.get<uint64_t>())), {});
            break;
        case json::value_t::number_float:
            bag.writeProperty(key, value.get<double>(), {});
            break;
        case json::value_t::string:
            bag.writeProperty(key, value.get<std::string>(), {});
            break;
        case json::value_t::array:
            bag.putUnreadable(key, "an array");
            break;
        default:
            bag.putUnreadable(key, "an object");
            break;
    }
}

[[noreturn]] void notAForm(std::string_view source, const std::string& why) {
    throw FormFileError(std::string(source) + " is not a form file: " + why);
}

std::string systemError(const std::string& what, const std::filesystem::path& file) {
    return what + " " + file.string() + ": " + std::strerror(errno);
}

void writeAll(int fd, std::string_view data, const std::filesystem::path& tmp) {
    size_t done = 0;
    while (done < data.size()) {
        ssize_t n = ::write(fd, data.data() + done, data.size() - done);
        if (n < 0 && errno == EINTR) continue;
        if (n < 0) throw FormFileError(systemError("cannot write", tmp));
        done += static_cast<size_t>(n);
    }
}

// The new file keeps the permissions of the one it replaces (a private form stays private);
// a new form file gets those of any new file.
mode_t modeFor(const std::filesystem::path& file) {
    struct stat st {};
    if (::stat(file.c_str(), &st) == 0) return st.st_mode & 07777;
    const mode_t mask = ::umask(0);
    ::umask(mask);
    return 0666 & ~mask;
}

void syncFolder(const std::filesystem::path& folder) {
    int fd = ::open(folder.c_str(), O_RDONLY | O_DIRECTORY);
    if (fd < 0) return;
    ::fsync(fd);
    ::close(fd);
}

}  // namespace

std::string formToJson(std::span<const FormControl> controls) {
    json entries = json::object();
    for (const FormControl& c : controls) {
        MemoryPropertyBag bag;
        c.control->WriteProperties(bag);
        json props = json::object();
        for (const auto& e : bag.entries())
            props[e.key] = toJson(e.value);
        entries[c.name] = {{"type", std::string(c.control->typeName())},
                           {"properties", std::move(props)}};
    }
    json doc = {{"format", std::string(kFormFormat)}, {"controls", std::move(entries)}};
    return doc.dump(2, ' ', false, json::error_handler_t::replace) + "\n";
}

void writeFormFile(const std::filesystem::path& name, std::string_view data) {
    // A form file reached through a link is replaced where it lies, and the link stays.
    std::error_code ec;
    const std::filesystem::path file =
        std::filesystem::is_symlink(name, ec) ? std::filesystem::weakly_canonical(name, ec) : name;
    std::filesystem::path folder = file.parent_path();
    if (folder.empty()) folder = ".";
    std::string pattern = (folder / ("." + file.filename().string() + ".XXXXXX")).string();
    int fd = ::mkstemp(pattern.data());
    if (fd < 0) throw FormFileError(systemError("cannot save form file", file));
    const std::filesystem::path tmp = pattern;
    try {
        ::fchmod(fd, modeFor(file));
        writeAll(fd, data, tmp);
        if (::fsync(fd) != 0) throw FormFileError(systemError("cannot flush", tmp));
        if (::close(fd) != 0) {
            fd = -1;
            throw FormFileError(systemError("cannot close", tmp));
        }
        fd = -1;
        if (::rename(tmp.c_str(), file.c_str()) != 0)
            throw FormFileError(systemError("cannot replace form file", file));
    } catch (...) {
        if (fd >= 0) ::close(fd);
        ::unlink(tmp.c_str());
        throw;
    }
    syncFolder(folder);
}

std::vector<FormEntry> parseForm(std::string_view text, std::string_view source) {
    json doc;
    try {
        doc = json::parse(text);
    } catch (const json::exception& e) {  // a syntax error, or a number out of range
        notAForm(source, std::string("invalid JSON (") + e.what() + ")");
    }
    if (!doc.is_object()) notAForm(source, "the document is not a JSON object");
    auto format = doc.find("format");
    if (format == doc.end() || !format->is_string()) notAForm(source, "it has no \"format\" entry");
    if (format->get<std::string>() != kFormFormat)
        notAForm(source, "its format is \"" + format->get<std::string>() + "\", expected \"" +
                             std::string(kFormFormat) + "\"");
    auto controls = doc.find("controls");
    if (controls == doc.end() || !controls->is_object())
        notAForm(source, "it has no \"controls\" object");

    std::vector<FormEntry> entries;
    for (const auto& [name, entry] : controls->items()) {
        FormEntry& e = entries.emplace_back();
        e.name = name;
        if (!entry.is_object()) continue;
        if (auto type = entry.find("type"); type != entry.end() && type->is_string())
            e.type = type->get<std::string>();
        auto props = entry.find("properties");
        if (props != entry.end() && props->is_object())
            for (const auto& [key, value] : props->items())
                putValue(e.properties, key, value);
    }
    return entries;
}

std::string readFormFile(const std::filesystem::path& file) {
    std::ifstream in(file, std::ios::binary);
    if (!in) throw FormFileError(systemError("cannot open form file", file));
    std::ostringstream text;
    text << in.rdbuf();
    if (in.bad()) throw FormFileError(systemError("cannot read form file", file));
    return text.str();
}

}  // namespace ryx::common
