#include "ryx/property_bag.h"

#include "ryx/errors.h"

namespace ryx {

bool keysEqual(std::string_view a, std::string_view b) {
    if (a.size() != b.size()) return false;
    for (size_t i = 0; i < a.size(); ++i) {
        char x = a[i], y = b[i];
        if (x >= 'A' && x <= 'Z') x = static_cast<char>(x + 32);
        if (y >= 'A' && y <= 'Z') y = static_cast<char>(y + 32);
        if (x != y) return false;
    }
    return true;
}

const MemoryPropertyBag::Entry* MemoryPropertyBag::find(std::string_view key) const {
    for (const Entry& e : entries_)
        if (keysEqual(e.key, key)) return &e;
    return nullptr;
}

MemoryPropertyBag::Entry& MemoryPropertyBag::slot(std::string_view key) {
    for (Entry& e : entries_)
        if (keysEqual(e.key, key)) return e;
    return entries_.emplace_back();
}

Variant MemoryPropertyBag::readProperty(std::string_view key, const Variant& def) const {
    const Entry* e = find(key);
    if (!e) return def;
    if (!e->unreadable.empty())
        throw TypeMismatchError("property \"" + e->key + "\" holds " + e->unreadable);
    return e->value;
}

void MemoryPropertyBag::writeProperty(std::string_view key, const Variant& value, const Variant&) {
    Entry& e = slot(key);
    e.key = std::string(key);
    e.value = value;
    e.unreadable.clear();
}

void MemoryPropertyBag::putUnreadable(std::string_view key, std::string why) {
    Entry& e = slot(key);
    e.key = std::string(key);
    e.value = Variant();
    e.unreadable = std::move(why);
}

}  // namespace ryx
