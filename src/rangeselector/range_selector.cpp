#include "ryx/range_selector.h"

#include <cmath>

#include "control_type_catalogue.h"

namespace ryx {
namespace {

constexpr Twips kWidth = 3615;
constexpr Twips kHeight = 1200;

// The pop-up button serves one box at a time, and where it stands records which: above the
// threshold it serves the start box, below it the end box.
constexpr Twips kPopAtCreation = 250;
constexpr Twips kPopBesideStart = 255;
constexpr Twips kPopBesideEnd = 575;
constexpr Twips kPopAfterControlType = 285;
constexpr Twips kPopThreshold = 440;

constexpr Color kButtonFace = static_cast<Color>(0x8000000F);  // system colour 15

constexpr std::string_view kDesignCaption = "&Range of Items";
constexpr std::string_view kCaptionPrefix = "&Range of ";
// Three wordings of the footer: the catalogue and Caption use the first, FootNote in run
// mode the second, FootNote in the designer the third.
constexpr std::string_view kFooterPrefix = " Leave it Blank for all ";
constexpr std::string_view kRunFooterPrefix = "Leave it blank for all ";
constexpr std::string_view kDesignFooter = " Leave it Blank for all Items";

constexpr int16_t kKeyP = 80;
constexpr std::string_view kDigitKeys = "123456 7890";

// The form design of the children.
constexpr WidgetDesign kFrame{.kind = WidgetKind::Frame,
                              .name = "fraRangeSelector",
                              .left = 0,
                              .top = 0,
                              .width = 3435,
                              .height = 1215,
                              .caption = kDesignCaption,
                              .backColor = kFrameBackColor,
                              .foreColor = kTitleColor,
                              .font = kBoldFont,
                              .inFrame = false};
constexpr WidgetDesign kBox{.kind = WidgetKind::TextBox,
                            .name = "RYXT",
                            .left = 495,
                            .width = 2535,
                            .height = 285,
                            .backColor = kEntryBackColor,
                            .foreColor = kBlack,
                            .font = kFixedFont};
constexpr WidgetDesign kStartBox = [] {
    WidgetDesign d = kBox;
    d.index = 0;
    d.top = 270;
    d.tabIndex = 2;
    return d;
}();
constexpr WidgetDesign kEndBox = [] {
    WidgetDesign d = kBox;
    d.index = 1;
    d.top = 585;
    d.tabIndex = 3;
    return d;
}();
constexpr WidgetDesign kPop{.kind = WidgetKind::CommandButton,
                            .name = "cmdpop",
                            .left = 3060,
                            .top = 255,
                            .width = 285,
                            .height = 285,
                            .backColor = kButtonFace,
                            .tabIndex = 1,
                            .toolTip = "PopUp List Button (Alt +P)",
                            .picture = "popup"};
constexpr WidgetDesign kStart{.kind = WidgetKind::Label,
                              .name = "lblStart",
                              .left = 105,
                              .top = 300,
                              .width = 480,
                              .height = 270,
                              .caption = "Start",
                              .backColor = kEntryBackColor};
constexpr WidgetDesign kEnd{.kind = WidgetKind::Label,
                            .name = "lblEnd",
                            .left = 105,
                            .top = 615,
                            .width = 435,
                            .height = 225,
                            .caption = "End",
                            .backColor = kEntryBackColor};
constexpr WidgetDesign kFooter{.kind = WidgetKind::Label,
                               .name = "lblFooter",
                               .left = 525,
                               .top = 930,
                               .width = 2460,
                               .height = 195,
                               .caption = "Leave it Blank for all Items",
                               .backColor = kFrameBackColor};

std::string lowerBasicLatin(std::string_view text) {
    std::string folded(text);
    for (char& c : folded)
        if (c >= 'A' && c <= 'Z') c = static_cast<char>(c - 'A' + 'a');
    return folded;
}

// The 32 printable basic-Latin characters that are neither letter, digit nor blank.
bool isPunctuation(uint16_t c) {
    return (c >= 33 && c <= 47) || (c >= 58 && c <= 64) || (c >= 91 && c <= 96) ||
           (c >= 123 && c <= 126);
}

bool isPrintable(uint16_t c) {
    return c >= 32 && c != 127;
}

}  // namespace

RYXRangeSelector::RYXRangeSelector(Container& site)
    : Control(site),
      fraRangeSelector_(site.addFrame(kFrame)),
      RYXT_{&site.addTextBox(kStartBox), &site.addTextBox(kEndBox)},
      cmdpop_(site.addCommandButton(kPop)),
      lblStart_(site.addLabel(kStart)),
      lblEnd_(site.addLabel(kEnd)),
      lblFooter_(site.addLabel(kFooter)) {
    for (int16_t i = 0; i < 2; ++i)
        RYXT_[i]->setHandler([this, i](Notify what, EventArgs& a) { onBox(i, what, a); });
    cmdpop_.setHandler([this](Notify what, EventArgs&) {
        if (what == Notify::Click) popClicked();
    });
    cmdpop_.setTop(kPopAtCreation);
}

// ---- colours and state -------------------------------------------------------------------

void RYXRangeSelector::setBackColor(Color c) {
    fraRangeSelector_.setBackColor(c);
    notifyChanged("BackColor");
}

Color RYXRangeSelector::BackColor() const {
    return fraRangeSelector_.backColor();
}

Color RYXRangeSelector::ForeColor() const {
    return RYXT_[0]->backColor();
}

void RYXRangeSelector::setForeColor(Color c) {
    RYXT_[0]->setBackColor(c);
    RYXT_[1]->setBackColor(c);
    notifyChanged("ForeColor");
}

void RYXRangeSelector::setTitleColor(Color c) {
    fraRangeSelector_.setForeColor(c);
    notifyChanged("TitleColor");
}

Color RYXRangeSelector::TitleColor() const {
    return fraRangeSelector_.foreColor();
}

void RYXRangeSelector::applyEnabled(bool v) {
    fraRangeSelector_.setEnabled(v);
    lblStart_.setEnabled(v);
    lblEnd_.setEnabled(v);
    lblFooter_.setEnabled(v);
    cmdpop_.setEnabled(v);
    RYXT_[0]->setEnabled(v);
    RYXT_[1]->setEnabled(v);
}

bool RYXRangeSelector::ButtonVisible() const {
    return cmdpop_.visible();
}

void RYXRangeSelector::setButtonVisible(bool v) {
    cmdpop_.setVisible(v);
    notifyChanged("ButtonVisible");
}

// ---- catalogue ---------------------------------------------------------------------------

void RYXRangeSelector::setControlType(std::string_view T) {
    controlType_ = T;
    const ControlTypeRow& row = controlTypeRow(T);
    if (row.textType) textType_ = *row.textType;
    const std::string word(row.itemWord);
    if (!word.empty()) {
        lblFooter_.setVisible(true);
        lblFooter_.setCaption(std::string(kFooterPrefix) + word);
        fraRangeSelector_.setCaption(std::string(kCaptionPrefix) + word);
    } else {
        lblFooter_.setVisible(false);
        lblFooter_.setCaption("");
        fraRangeSelector_.setCaption("");
    }
    cmdpop_.setVisible(true);
    // "date" leaves an empty frame; the lower-case text alone, other spellings are unknown keys.
    const bool dateLayout = T == "date";
    if (dateLayout) cmdpop_.setVisible(false);
    for (TextBox* field : RYXT_) {
        field->setText("");
        field->setVisible(!dateLayout);
        field->setMaxLength(row.maxLength);
    }
    cmdpop_.setTop(kPopAfterControlType);
    Refresh();
}

// ---- captions ----------------------------------------------------------------------------

void RYXRangeSelector::setCaption(std::string_view V) {
    const bool design = !site().userMode();
    if (!V.empty()) {
        lblFooter_.setVisible(true);
        if (footNote_.empty()) lblFooter_.setCaption(std::string(kFooterPrefix) + std::string(V));
        fraRangeSelector_.setCaption(std::string(kCaptionPrefix) + std::string(V));
    } else {
        fraRangeSelector_.setCaption(design ? kDesignCaption : "");
    }
    if (design) notifyChanged("Caption");
    caption_ = V;
}

void RYXRangeSelector::setFootNote(std::string_view V) {
    if (site().userMode()) {
        if (!V.empty())
            lblFooter_.setCaption(V);
        else
            lblFooter_.setCaption(std::string(kRunFooterPrefix) +
                                  (caption_.empty() ? std::string("Items") : caption_));
        footNote_ = V;
        return;
    }
    lblFooter_.setCaption(V.empty() ? kDesignFooter : V);
    footNote_ = V;
    notifyChanged("Footnote");
}

// ---- texts -------------------------------------------------------------------------------

std::string RYXRangeSelector::StartText() const {
    return RYXT_[0]->text();
}

void RYXRangeSelector::setStartText(std::string_view V) {
    // The user goes on with the end of the range; a box that cannot take the focus (hidden by
    // the "date" layout, disabled) leaves the focus where it is.
    try {
        RYXT_[0]->setText(V);
        RYXT_[1]->setFocus();
    } catch (const Error&) {
    }
}

std::string RYXRangeSelector::EndText() const {
    return RYXT_[1]->text();
}

// The end may not lie below the start. Policy numbers and plans compare as numbers, so that
// 1000 follows 900; other items compare character code by character code. An empty end
// leaves the range open at that side and is always taken.
void RYXRangeSelector::setEndText(std::string_view V) {
    const std::string S = RYXT_[0]->text();
    bool accepted = V.empty() || S.empty();
    if (!accepted) {
        const std::string kind = lowerBasicLatin(controlType_);
        if (kind == "policyno" || kind == "plan")
            accepted = leadingNumber(V) >= leadingNumber(S);
        else
            accepted = std::string_view(S) <= V;  // char_traits<char> compares bytes unsigned
    }
    if (accepted) RYXT_[1]->setText(V);
}

TextBox& RYXRangeSelector::boxAt(const Variant& Index, std::string_view member) const {
    if (Index.isEmpty() || Index.isNumeric()) {
        const double i = std::nearbyint(Index.toDouble());
        if (i == 0) return *RYXT_[0];
        if (i == 1) return *RYXT_[1];
    }
    throw IndexError(std::string(member) + ": Index " + Index.describe() +
                     " names no box (0 is the start, 1 the end)");
}

Variant RYXRangeSelector::Sellength(const Variant& Index) const {
    return Variant(boxAt(Index, "Sellength").selLength());
}

void RYXRangeSelector::setSellength(const Variant& Index, const Variant& v) {
    boxAt(Index, "Sellength").setSelLength(v.toInt32());
}

Variant RYXRangeSelector::SelStart(const Variant& Index) const {
    return Variant(boxAt(Index, "SelStart").selStart());
}

void RYXRangeSelector::setSelStart(const Variant& Index, const Variant& v) {
    boxAt(Index, "SelStart").setSelStart(v.toInt32());
}

Variant RYXRangeSelector::MaxLength() const {
    return Variant(RYXT_[0]->maxLength());
}

void RYXRangeSelector::setMaxLength(const Variant& v) {
    if (!v.isNumeric()) return;
    const int32_t length = v.toInt32();
    RYXT_[0]->setMaxLength(length);
    RYXT_[1]->setMaxLength(length);
    notifyChanged("MaxLength");
}

void RYXRangeSelector::setTextType(RYXRgSelTxtType v) {
    textType_ = v;
    notifyChanged("TextType");
}

// ---- widget handlers ---------------------------------------------------------------------

void RYXRangeSelector::popClicked() {
    if (!acceptsInput()) return;
    const int16_t served = cmdpop_.top() < kPopThreshold ? 0 : 1;
    EventArgs args;
    args.Index = Variant(served);
    raise(EventId::ButtonClick, args);
}

void RYXRangeSelector::filterKey(int16_t& KeyAscii) const {
    const auto c = static_cast<uint16_t>(KeyAscii);
    switch (textType_) {
        case RYXANUAlphaNumeric:
            KeyAscii = isPunctuation(c) ? int16_t{0} : site().keyboard().upperCase(KeyAscii);
            break;
        case RYXANDigits:
            // Backspace is no digit either: in these boxes only Delete removes a character.
            if (c > 0x7F || kDigitKeys.find(static_cast<char>(c)) == std::string_view::npos)
                KeyAscii = 0;
            break;
        default:
            break;  // RYXANUserKeys and any other value keep every key
    }
}

// The host sees the key as the control leaves it: after the overwrite selection, the Enter
// and the filter, so a host handler may still put back a key the filter dropped.
void RYXRangeSelector::boxKeyPress(int16_t index, EventArgs& args) {
    TextBox& field = *RYXT_[index];
    // With the Insert toggle on, a typed character replaces the one after the caret. Backspace
    // and the other control keys keep their own meaning.
    if (isPrintable(static_cast<uint16_t>(args.KeyAscii)) &&
        site().keyboard().keyState(vk::Insert) != 0 && field.selLength() == 0)
        field.setSelLength(1);
    if (!enterMovesFocus(args.KeyAscii)) filterKey(args.KeyAscii);
    relay(Notify::KeyPress, args, Variant(index));
}

void RYXRangeSelector::boxKeyDown(int16_t index, EventArgs& args) {
    relay(Notify::KeyDown, args, Variant(index));
    if ((args.Shift & shift::Alt) && args.KeyCode == kKeyP) popClicked();
    arrowMovesFocus(args.KeyCode);
}

void RYXRangeSelector::onBox(int16_t index, Notify what, EventArgs& args) {
    switch (what) {
        case Notify::Click:
        case Notify::DblClick:
            if (acceptsInput()) relay(what, args, Variant(index));
            break;
        case Notify::KeyDown:
            boxKeyDown(index, args);
            break;
        case Notify::KeyPress:
            boxKeyPress(index, args);
            break;
        case Notify::GotFocus:
            cmdpop_.setTop(index == 0 ? kPopBesideStart : kPopBesideEnd);
            break;
        case Notify::LostFocus:
            break;
        default:
            relay(what, args, Variant(index));  // key up and mouse events
            break;
    }
}

// ---- surface -----------------------------------------------------------------------------

void RYXRangeSelector::GotFocus() {
    if (!acceptsInput()) return;
    try {
        RYXT_[0]->setFocus();
    } catch (const WidgetError&) {
        // The start box is hidden or disabled: the focus stays where it is.
    }
}

void RYXRangeSelector::SurfaceEvent(Notify what, EventArgs& args) {
    if (what == Notify::KeyPress && args.KeyAscii == vk::Return) inject("{TAB}");
}

void RYXRangeSelector::AccessKeyPress(int16_t& KeyAscii) {
    if (KeyAscii != vk::Return) return;
    inject("{tab}");
    KeyAscii = 0;
}

void RYXRangeSelector::Resize() {
    site().setSize(kWidth, kHeight);
}

// ---- persistence -------------------------------------------------------------------------

void RYXRangeSelector::InitProperties() {
    setButtonVisible(true);
    setEnabled(true);
    setLocked(false);
    textType_ = RYXANUserKeys;
}

void RYXRangeSelector::ReadProperties(const PropertyBag& bag) {
    PropertyLoader load(bag);
    // The catalogue is not applied: captions, footer, length and filter come from their keys.
    load.key("ControlType", "", [&](const Variant& v) { controlType_ = v.toString(); });
    load.key("ButtonVisible", true, [&](const Variant& v) { setButtonVisible(v.toBool()); });
    load.key("Locked", false, [&](const Variant& v) { setLocked(v.toBool()); });
    load.key("Enabled", true, [&](const Variant& v) { setEnabled(v.toBool()); });
    load.key("TextType", int32_t{RYXANUserKeys},
             [&](const Variant& v) { setTextType(static_cast<RYXRgSelTxtType>(v.toInt32())); });
    load.key("Maxlength", int32_t{0}, [&](const Variant& v) { setMaxLength(v); });
    load.key("ForeColor", kEntryBackColor, [&](const Variant& v) { setForeColor(v.toInt32()); });
    load.key("Titlecolor", kTitleColor,
             [&](const Variant& v) { fraRangeSelector_.setForeColor(v.toInt32()); });
    load.key("Backcolor", kFrameBackColor,
             [&](const Variant& v) { fraRangeSelector_.setBackColor(v.toInt32()); });
    load.key("Caption", "Items", [&](const Variant& v) { setCaption(v.toString()); });
    load.key("FootNote", "Items", [&](const Variant& v) { setFootNote(v.toString()); });
    load.step([&] { site().setSize(kWidth, kHeight); });
}

void RYXRangeSelector::WriteProperties(PropertyBag& bag) const {
    bag.writeProperty("ControlType", controlType_, Variant());
    bag.writeProperty("Enabled", enabled_, true);
    bag.writeProperty("TextType", int32_t{textType_}, int32_t{RYXANUserKeys});
    bag.writeProperty("MaxLength", RYXT_[0]->maxLength(), int32_t{0});
    bag.writeProperty("ButtonVisible", cmdpop_.visible(), true);
    bag.writeProperty("Locked", locked_, false);
    bag.writeProperty("Titlecolor", fraRangeSelector_.foreColor(), kTitleColor);
    bag.writeProperty("Backcolor", fraRangeSelector_.backColor(), kFrameBackColor);
    bag.writeProperty("ForeColor", RYXT_[0]->backColor(), kEntryBackColor);
    bag.writeProperty("Caption", caption_, "Items");
    bag.writeProperty("FootNote", footNote_, "Items");
}

}  // namespace ryx
