#include "control_type_catalogue.h"

#include <array>

namespace ryx {
namespace {

constexpr auto Digits = RYXANDigits;
constexpr auto Upper = RYXANUAlphaNumeric;
constexpr auto Free = RYXANUserKeys;

// In the order the keys are tried. "phsdept" leaves the key filter as it is.
constexpr std::array<ControlTypeRow, 30> kRows{{
    {"policyno", "Policies", 10, Digits},
    {"phspolicyno", "Policies", 10, Digits},
    {"filterpolicyno", "Policies", 10, Digits},
    {"name", "Clients", 21, Free},
    {"filterclient", "Clients", 21, Free},
    {"filtername", "Clients", 21, Free},
    {"phsname", "Clients", 25, Free},
    {"phsperson", "Persons", 21, Free},
    {"familycode", "Families", 4, Upper},
    {"phsfamily", "Families", 4, Upper},
    {"filterfamily", "Families", 4, Upper},
    {"branchno", "Branches", 4, Upper},
    {"location", "Locations", 20, Free},
    {"pincode", "PinCodes", 6, Digits},
    {"plan", "Plans", 3, Digits},
    {"proposalno", "Proposals", 10, Digits},
    {"filterproposalno", "Proposals", 10, Digits},
    {"phsdept", "Department", 4, std::nullopt},
    {"bankbranchrec", "Bank Branch", 15, Free},
    {"bankbranchppf", "Bank Branch", 15, Free},
    {"accountnorec", "Account No.", 10, Free},
    {"accountnoppf", "Account No.", 10, Free},
    {"companynamesch", "Company Name", 25, Free},
    {"applicationnosch", "Application No.", 10, Free},
    {"applicationnofd", "Application No.", 10, Free},
    {"applicationnoulip", "Application No.", 20, Free},
    {"certificatenosch", "Certificate No.", 10, Free},
    {"certificatenoulip", "Certificate No.", 10, Free},
    {"certificatenonsc", "Certificate No.", 20, Free},
    {"receiptnonsc", "Receipt No.", 25, Free},
}};

constexpr ControlTypeRow kUnknown{"", "", 0, std::nullopt};

// Only basic Latin letters fold: every key is made of them.
bool sameKey(std::string_view text, std::string_view key) {
    if (text.size() != key.size()) return false;
    for (size_t i = 0; i < text.size(); ++i) {
        char c = text[i];
        if (c >= 'A' && c <= 'Z') c = static_cast<char>(c - 'A' + 'a');
        if (c != key[i]) return false;
    }
    return true;
}

}  // namespace

const ControlTypeRow& controlTypeRow(std::string_view controlType) {
    for (const ControlTypeRow& row : kRows)
        if (sameKey(controlType, row.key)) return row;
    return kUnknown;
}

}  // namespace ryx
