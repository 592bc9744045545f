#include "ryx/policy_status.h"

#include <algorithm>
#include <array>

namespace ryx {
namespace {

// The eight statuses in list order, with the code each gives in the criterion. The letter a
// status has in DefaultSetting is the first letter of its text, so "Reduced PaidUp" is P in
// the criterion but R in DefaultSetting; "Record" takes no part in DefaultSetting.
struct Status {
    std::string_view text;
    std::string_view code;
};
constexpr std::array<Status, 8> kStatuses{{
    {"In - Force", "I"},
    {"Lapsed", "L"},
    {"Reduced PaidUp", "P"},
    {"Fully PaidUp", "F"},
    {"Surrendered", "S"},
    {"Matured", "M"},
    {"Death Claim", "D"},
    {"Record", "R"},
}};
constexpr int kSettingRows = 7;  // rows 0 to 6 have a DefaultSetting letter

constexpr std::array<std::string_view, 8> kItems{
    kStatuses[0].text, kStatuses[1].text, kStatuses[2].text, kStatuses[3].text,
    kStatuses[4].text, kStatuses[5].text, kStatuses[6].text, kStatuses[7].text};

constexpr Twips kMinWidth = 2905;
constexpr int kMaxSettingLength = 255;

// The form design of the children.
constexpr WidgetDesign kFrame{.kind = WidgetKind::Frame,
                              .name = "fraPolicyStatus",
                              .left = 0,
                              .top = 0,
                              .width = 2820,
                              .height = 1530,
                              .caption = "&Types Of Policies To Include",
                              .backColor = kFrameBackColor,
                              .foreColor = kTitleColor,
                              .font = kBoldFont,
                              .inFrame = false};
constexpr WidgetDesign kList{.kind = WidgetKind::ListBox,
                             .name = "LstPolicyStatus",
                             .left = 180,
                             .top = 255,
                             .width = 2415,
                             .height = 735,
                             .backColor = kEntryBackColor,
                             .foreColor = kBlack,
                             .tabIndex = 0,
                             .items = kItems};
constexpr WidgetDesign kCheck{.kind = WidgetKind::CheckBox,
                              .name = "ChkAll",
                              .left = 165,
                              .top = 1185,
                              .width = 1215,
                              .height = 210,
                              .caption = "All Policies",
                              .backColor = kFrameBackColor,
                              .foreColor = kBlack,
                              .tabIndex = 1};

size_t characterCount(std::string_view utf8) {
    return static_cast<size_t>(std::count_if(utf8.begin(), utf8.end(), [](char c) {
        return (static_cast<unsigned char>(c) & 0xC0) != 0x80;
    }));
}

}  // namespace

RYXPolicyStatus::RYXPolicyStatus(Container& site)
    : Control(site),
      fraPolicyStatus_(site.addFrame(kFrame)),
      LstPolicyStatus_(site.addListBox(kList)),
      ChkAll_(site.addCheckBox(kCheck)) {
    LstPolicyStatus_.setHandler([this](Notify what, EventArgs& a) { onList(what, a); });
    ChkAll_.setHandler([this](Notify what, EventArgs& a) { onCheck(what, a); });
}

// ---- criterion ---------------------------------------------------------------------------

std::string RYXPolicyStatus::ReturnedText() {
    returnedText_.clear();
    if (ChkAll_.value() == 1) {
        returnedText_ = "+";
        return returnedText_;
    }
    std::string text;
    const int32_t rows = std::min<int32_t>(LstPolicyStatus_.listCount(), kStatuses.size());
    for (int32_t row = 0; row < rows; ++row) {
        if (!LstPolicyStatus_.selected(row)) continue;
        if (!text.empty()) text += ',';
        std::string_view code = kStatuses[static_cast<size_t>(row)].code;
        if (crystal_) {
            text += '"';
            text += code;
            text += '"';
        } else {
            text += code;
        }
    }
    if (text.empty())
        text = "+";
    else if (crystal_)
        text = "[" + text + "]";
    returnedText_ = text;
    return returnedText_;
}

Variant RYXPolicyStatus::DefaultSetting() const {
    if (ChkAll_.value() == 1) return Variant("+");
    std::string letters;
    const int32_t rows = std::min<int32_t>(LstPolicyStatus_.listCount(), kSettingRows);
    for (int32_t row = 0; row < rows; ++row)
        if (LstPolicyStatus_.selected(row))
            letters += kStatuses[static_cast<size_t>(row)].text.front();
    if (letters.size() == kSettingRows) return Variant("+");
    return Variant(letters);
}

void RYXPolicyStatus::setDefaultSetting(const Variant& v) {
    const std::string text = v.toString();
    const size_t length = characterCount(text);
    if (length > kMaxSettingLength)
        throw OverflowError("DefaultSetting of " + std::to_string(length) +
                            " characters is longer than 255");
    if (text == "+" || length == kSettingRows) {
        ChkAll_.setValue(1);
        return;
    }
    for (char letter : text) {
        for (int row = 0; row < kSettingRows; ++row) {
            if (kStatuses[static_cast<size_t>(row)].text.front() == letter) {
                LstPolicyStatus_.setSelected(row, true);
                break;
            }
        }
    }
    LstPolicyStatus_.setListIndex(0);
}

// ---- widget handlers ---------------------------------------------------------------------

// Any change of the list's selection by the user unchecks "All Policies".
void RYXPolicyStatus::listClicked() {
    if (!acceptsInput() || listBusy_ || checkBusy_) return;
    {
        GuardScope busy(listBusy_);
        ChkAll_.setValue(0);
    }
    raise(EventId::Click);
}

// Checking or unchecking "All Policies" selects every row.
void RYXPolicyStatus::checkClicked() {
    if (listBusy_ || checkBusy_) return;
    GuardScope busy(checkBusy_);
    const int32_t rows = LstPolicyStatus_.listCount();
    if (rows > 0) LstPolicyStatus_.setSelectedRange(0, rows - 1, true);
    LstPolicyStatus_.setListIndex(0);
}

void RYXPolicyStatus::onList(Notify what, EventArgs& args) {
    switch (what) {
        case Notify::Click:
            listClicked();
            break;
        case Notify::KeyPress:
            relay(what, args);
            enterMovesFocus(args.KeyAscii);
            break;
        default:
            relay(what, args);
            break;  // DblClick, keys and mouse go to the host as they are
    }
}

void RYXPolicyStatus::onCheck(Notify what, EventArgs& args) {
    switch (what) {
        case Notify::Click:
            checkClicked();
            break;
        case Notify::KeyDown:
            relay(what, args);
            arrowMovesFocus(args.KeyCode);
            break;
        case Notify::KeyPress:
            enterMovesFocus(args.KeyAscii);
            break;
        default:
            break;  // key up and mouse events stay inside
    }
}

void RYXPolicyStatus::SurfaceEvent(Notify what, EventArgs& args) {
    relay(what, args);
    if (what == Notify::KeyPress && args.KeyAscii == vk::Return) inject("{TAB}");
}

void RYXPolicyStatus::AccessKeyPress(int16_t& KeyAscii) {
    enterMovesFocus(KeyAscii);
}

// ---- appearance --------------------------------------------------------------------------

Color RYXPolicyStatus::BackColor() const {
    return fraPolicyStatus_.backColor();
}

void RYXPolicyStatus::setBackColor(Color c) {
    fraPolicyStatus_.setBackColor(c);
    ChkAll_.setBackColor(c);
    notifyChanged("BackColor");
}

Color RYXPolicyStatus::TitleColor() const {
    return fraPolicyStatus_.foreColor();
}

void RYXPolicyStatus::setTitleColor(Color c) {
    fraPolicyStatus_.setForeColor(c);
    notifyChanged("Titlecolor");
}

Color RYXPolicyStatus::ForeColor() const {
    return LstPolicyStatus_.backColor();
}

void RYXPolicyStatus::setForeColor(Color c) {
    LstPolicyStatus_.setBackColor(c);
    notifyChanged("ForeColor");
}

void RYXPolicyStatus::setCrystalStyle(bool v) {
    crystal_ = v;
    notifyChanged("CrystalStyle");
}

void RYXPolicyStatus::applyEnabled(bool v) {
    fraPolicyStatus_.setEnabled(v);
    LstPolicyStatus_.setEnabled(v);
    ChkAll_.setEnabled(v);
}

// The list and check box keep their places; the frame follows the control's size, never
// narrower than the list needs. A height of 50 twips or less leaves a frame of height 0.
void RYXPolicyStatus::Resize() {
    Twips width = site().width();
    const Twips height = site().height();
    if (width < kMinWidth) {
        site().setSize(kMinWidth, height);
        width = kMinWidth;
    }
    fraPolicyStatus_.setWidth(width - 100);
    LstPolicyStatus_.setWidth(fraPolicyStatus_.width() - 360);
    fraPolicyStatus_.setHeight(std::max<Twips>(0, height - 50));
}

// ---- persistence -------------------------------------------------------------------------

void RYXPolicyStatus::InitProperties() {
    setEnabled(true);
    setLocked(false);
    fraPolicyStatus_.setForeColor(kTitleColor);
    fraPolicyStatus_.setBackColor(kFrameBackColor);
    LstPolicyStatus_.setBackColor(kEntryBackColor);
    setCrystalStyle(true);
    LstPolicyStatus_.setWidth(site().width() - 100);
}

void RYXPolicyStatus::ReadProperties(const PropertyBag& bag) {
    PropertyLoader load(bag);
    load.key("Titlecolor", kTitleColor,
             [&](const Variant& v) { fraPolicyStatus_.setForeColor(v.toInt32()); });
    load.key("Backcolor", kFrameBackColor,
             [&](const Variant& v) { fraPolicyStatus_.setBackColor(v.toInt32()); });
    load.key("Backcolor", kFrameBackColor,
             [&](const Variant& v) { ChkAll_.setBackColor(v.toInt32()); });
    // The list background is saved as "Forecolor", so a designer's choice survives a reload.
    load.key("Forecolor", kEntryBackColor,
             [&](const Variant& v) { LstPolicyStatus_.setBackColor(v.toInt32()); });
    load.key("Enabled", true, [&](const Variant& v) { setEnabled(v.toBool()); });
    load.key("Locked", false, [&](const Variant& v) { setLocked(v.toBool()); });
    load.key("ReturnedText", "", [&](const Variant& v) { returnedText_ = v.toString(); });
    load.key("CrystalStyle", true, [&](const Variant& v) { crystal_ = v.toBool(); });
}

void RYXPolicyStatus::WriteProperties(PropertyBag& bag) const {
    bag.writeProperty("ReturnedText", returnedText_, "");
    bag.writeProperty("Forecolor", LstPolicyStatus_.backColor(), kEntryBackColor);
    bag.writeProperty("Titlecolor", fraPolicyStatus_.foreColor(), kTitleColor);
    bag.writeProperty("Backcolor", fraPolicyStatus_.backColor(), kFrameBackColor);
    bag.writeProperty("Locked", locked_, false);
    bag.writeProperty("Enabled", enabled_, true);
    bag.writeProperty("CrystalStyle", crystal_, true);
}

}  // namespace ryx
