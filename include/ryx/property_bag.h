// The property bag a host saves a control's properties in, and an in-memory one.
#pragma once

#include <string>
#include <string_view>
#include <vector>

#include "ryx/variant.h"

namespace ryx {

// Keys match without regard to letter case: "Backcolor" finds "BackColor".
class PropertyBag {
  public:
    virtual ~PropertyBag() = default;
    // The value saved under key, or `def` when there is none. A value that cannot be read
    // (of a kind the bag does not hold) is an error, which loading swallows key by key.
    virtual Variant readProperty(std::string_view key, const Variant& def) const = 0;
    // Saves value under key; a later write of the same key replaces the earlier one.
    virtual void writeProperty(std::string_view key, const Variant& value, const Variant& def) = 0;
};

// Case-insensitive comparison of two keys (ASCII letters fold; other bytes compare as is).
bool keysEqual(std::string_view a, std::string_view b);

// A bag in memory that keeps its entries in the order they were first written, with the
// spelling of the last write. Every written value is kept, defaults included, so a saved form
// shows every key.
class MemoryPropertyBag : public PropertyBag {
  public:
    struct Entry {
        std::string key;
        Variant value;
        // Why the value cannot be read ("an array"), or empty when it can.
        std::string unreadable;
    };

    Variant readProperty(std::string_view key, const Variant& def) const override;
    void writeProperty(std::string_view key, const Variant& value, const Variant& def) override;

    // Adds an entry whose value cannot be read; reading it raises TypeMismatchError.
    void putUnreadable(std::string_view key, std::string why);

    const std::vector<Entry>& entries() const { return entries_; }
    bool contains(std::string_view key) const { return find(key) != nullptr; }

  private:
    const Entry* find(std::string_view key) const;
    Entry& slot(std::string_view key);

    std::vector<Entry> entries_;
};

}  // namespace ryx
