#include "ryx/agency_selection.h"

#include <algorithm>
#include <limits>
#include <optional>
#include <span>
#include <string_view>

namespace ryx {
namespace {

// Row 0 of the list stands for every agency that is not in the table, code "*".
constexpr std::string_view kOthersRow = "*   Others";
// The agency table as the control reads it; "*" is reserved for the row above.
constexpr DataSourceDesign kAgencySource{
    .name = "DatAgMast",
    .connect = ";pwd=KLMOTulip",
    .recordSource = "select AgencyCd,Name from AgMast Where AgencyCd<>'*' order by AgencyCd"};

constexpr Twips kMinWidth = 2820;
constexpr Color kButtonColor = 0x0080C0FF;
constexpr int16_t kAllAgencies = 0;
constexpr int16_t kYourAgencies = 1;

// The form design of the children.
constexpr WidgetDesign kFrame{.kind = WidgetKind::Frame,
                              .name = "fraAgencySelection",
                              .left = 0,
                              .top = 0,
                              .width = 2730,
                              .height = 1740,
                              .caption = "&Agency Selection",
                              .backColor = kFrameBackColor,
                              .foreColor = kTitleColor,
                              .font = kBoldFont,
                              .tabIndex = 4,
                              .inFrame = false};
constexpr WidgetDesign kList{.kind = WidgetKind::ListBox,
                             .name = "LstAgMast",
                             .left = 180,
                             .top = 270,
                             .width = 2355,
                             .height = 735,
                             .backColor = 0x00E4FEFD,
                             .foreColor = kBlack,
                             .tabIndex = 0};
constexpr WidgetDesign kYourAgenciesBox{.kind = WidgetKind::CheckBox,
                                        .name = "chkAgmast",
                                        .index = kYourAgencies,
                                        .left = 180,
                                        .top = 1110,
                                        .width = 1335,
                                        .height = 195,
                                        .caption = "Your Agencies",
                                        .backColor = kFrameBackColor,
                                        .tabIndex = 1};
constexpr WidgetDesign kAllAgenciesBox{.kind = WidgetKind::CheckBox,
                                       .name = "chkAgmast",
                                       .index = kAllAgencies,
                                       .left = 180,
                                       .top = 1380,
                                       .width = 1185,
                                       .height = 240,
                                       .caption = "All Agencies",
                                       .backColor = kFrameBackColor,
                                       .tabIndex = 2};
constexpr WidgetDesign kButton{.kind = WidgetKind::CommandButton,
                               .name = "cmdDeselect",
                               .left = 1560,
                               .top = 1365,
                               .width = 1035,
                               .height = 255,
                               .caption = "Deselect All",
                               .backColor = kButtonColor,
                               .tabIndex = 3};

// A code between the double quotes of a formula string literal. A quote inside the code is
// written twice, as the report engine reads it, so a code can never close its literal early
// and turn the rest of itself into formula text.
void appendQuoted(std::string& text, std::string_view code) {
    text += '"';
    for (auto quote = std::find(code.begin(), code.end(), '"'); quote != code.end();
         quote = std::find(code.begin(), code.end(), '"')) {
        const auto length = static_cast<size_t>(quote - code.begin()) + 1;
        text.append(code.substr(0, length));
        text += '"';
        code.remove_prefix(length);
    }
    text.append(code);
    text += '"';
}

// Room for `rows` codes at the mean length of the first ones read, each with `extra` bytes
// around it, so that a text of a million codes is written once rather than copied again each
// time it outgrows its room.
void reserveForCodes(std::string& text, std::span<const std::optional<std::string_view>> first,
                     size_t rows, size_t extra) {
    size_t bytes = 0;
    for (const std::optional<std::string_view>& code : first)
        bytes += code ? code->size() : 0;
    const size_t mean = (bytes + first.size() - 1) / first.size();
    text.reserve(text.size() + 1 + rows * (mean + extra));
}

}  // namespace

RYXAgencySelection::RYXAgencySelection(Container& site)
    : Control(site),
      fraAgencySelection_(site.addFrame(kFrame)),
      LstAgMast_(site.addListBox(kList)),
      chkAgmast_{&site.addCheckBox(kAllAgenciesBox), &site.addCheckBox(kYourAgenciesBox)},
      cmdDeselect_(site.addCommandButton(kButton)),
      DatAgMast_(site.addRecordSource(kAgencySource)) {
    LstAgMast_.setHandler([this](Notify what, EventArgs& a) { onList(what, a); });
    for (int16_t index : {kAllAgencies, kYourAgencies})
        chkAgmast_[index]->setHandler(
            [this, index](Notify what, EventArgs& a) { onCheck(index, what, a); });
    cmdDeselect_.setHandler([this](Notify what, EventArgs&) {
        if (what == Notify::Click) deselectAll();
    });

    // The list is taller than drawn in the design, and the button stands at the frame's right.
    LstAgMast_.setHeight(900);
    cmdDeselect_.setLeft(fraAgencySelection_.width() - cmdDeselect_.width() - 240);
}

// ---- the agency list -----------------------------------------------------------------------

std::string RYXAgencySelection::DatabaseName() const {
    return DatAgMast_.databaseName();
}

// In the designer only the name is kept. At run time the list is refilled from scratch; if the
// database cannot be read the error reaches the caller and the list stays empty.
void RYXAgencySelection::setDatabaseName(std::string_view name) {
    DatAgMast_.setDatabaseName(name);
    if (!site().userMode() || DatAgMast_.recordSource().empty()) return;
    fillList();
}

// Row i (from 1) shows the i-th record of the record set: ReturnedText relies on it to read
// each picked row's code from the records rather than from the row text. The list asks for an
// agency row's text when it needs it: the records hold the texts once, and they stay as they
// are until the next fill, which clears the list before it refreshes them.
void RYXAgencySelection::fillList() {
    LstAgMast_.clear();
    DatAgMast_.refresh();
    LstAgMast_.addItem(kOthersRow);
    const RecordSet& records = DatAgMast_.recordset();
    if (records.recordCount() >= static_cast<size_t>(std::numeric_limits<int32_t>::max()))
        throw OverflowError("the agency table has more agencies than a list can hold");
    // The query gives the code, then the name.
    LstAgMast_.addRows(static_cast<int32_t>(records.recordCount()),
                       [&records](int32_t record, std::string& row) {
                           row.assign(records.fieldAt(static_cast<size_t>(record), 0).value_or(""));
                           row += "  ";
                           row += records.fieldAt(static_cast<size_t>(record), 1).value_or("");
                       });
}

// ---- criterion -----------------------------------------------------------------------------

std::string RYXAgencySelection::ReturnedText() {
    const int16_t all = chkAgmast_[kAllAgencies]->value();
    const int16_t yours = chkAgmast_[kYourAgencies]->value();
    if (all == 1) return "+";
    if (yours == 1) return "-";
    if (all != 0 || yours != 0) return "+";

    RecordSet& records = DatAgMast_.recordset();
    if (!records.bof()) records.moveFirst();
    const bool formula = crystal_;
    const std::span<const uint8_t> picked = LstAgMast_.selectedFlags();
    std::string text = formula ? "[" : "";
    const size_t start = text.size();
    if (!picked.empty() && picked[0]) text += formula ? R"("*")" : "*";
    // Row i (from 1) shows record i - 1: the codes come from the records, never from the rows,
    // a batch of records at a time.
    std::array<std::optional<std::string_view>, 256> codes;
    std::string_view joined;  // plain form: codes lying one after another, copied as one
    for (size_t row = 1; row < picked.size();) {
        const size_t batch = std::min(codes.size(), picked.size() - row);
        const size_t read = records.readField(0, row - 1, std::span(codes).first(batch));
        if (row == 1)
            reserveForCodes(text, std::span(codes).first(read), picked.size(), formula ? 3 : 0);
        const uint8_t* const flags = picked.data() + row;
        for (size_t i = 0; i < read; ++i) {
            if (!flags[i]) continue;
            const std::string_view code = codes[i] ? *codes[i] : std::string_view();
            if (formula) {
                if (text.size() > start) text += ',';
                appendQuoted(text, code);
            } else if (joined.data() && joined.data() + joined.size() == code.data()) {
                joined = {joined.data(), joined.size() + code.size()};
            } else {
                text += joined;  // joined with nothing between, as host reports split it
                joined = code;
            }
        }
        row += read;
    }
    text += joined;
    if (text.size() == start) return "+";
    if (formula) text += ']';
    if (text.capacity() > 2 * text.size()) text.shrink_to_fit();  // few rows were picked
    return text;
}

Variant RYXAgencySelection::DefaultSetting() const {
    if (chkAgmast_[kAllAgencies]->value() == 1) return Variant("+");
    if (chkAgmast_[kYourAgencies]->value() == 1) return Variant("-");
    if (LstAgMast_.listCount() > 0 && LstAgMast_.selected(0)) return Variant("*");
    return Variant();
}

// The boxes and the list handler do the work, as if the user had made the choice. "*" before
// the list is filled has no row to pick and does nothing.
void RYXAgencySelection::setDefaultSetting(const Variant& v) {
    if (v.holdsText("+"))
        chkAgmast_[kAllAgencies]->setValue(1);
    else if (v.holdsText("-"))
        chkAgmast_[kYourAgencies]->setValue(1);
    else if (v.holdsText("*") && LstAgMast_.listCount() > 0)
        LstAgMast_.setSelected(0, true);
}

// ---- widget handlers -----------------------------------------------------------------------

// Either box, clicked or set by code, ends checked with the other one clear, and selects every
// row: all of them for "All Agencies", all but "*   Others" for "Your Agencies".
void RYXAgencySelection::checkClicked(int16_t index) {
    if (selectionBusy_ || listBusy_) return;
    {
        GuardScope busy(selectionBusy_);
        chkAgmast_[kAllAgencies]->setValue(index == kAllAgencies ? 1 : 0);
        chkAgmast_[kYourAgencies]->setValue(index == kYourAgencies ? 1 : 0);
        const int32_t rows = LstAgMast_.listCount();
        if (rows > 0) LstAgMast_.setSelectedRange(0, rows - 1, true);
        Refresh();
        LstAgMast_.refresh();
        if (index == kYourAgencies) {
            if (rows > 0) LstAgMast_.setSelected(0, false);
            if (rows > 1) LstAgMast_.setListIndex(1);
        } else if (rows > 0) {
            LstAgMast_.setListIndex(0);
        }
    }
    if (acceptsInput()) raise(EventId::Click);
}

// A change of the rows by the user makes the choice a pick: both boxes clear. The guard stays
// set while the host answers Click, so a box the host sets there changes only the box.
void RYXAgencySelection::listClicked() {
    if (!acceptsInput() || selectionBusy_ || listBusy_) return;
    GuardScope busy(listBusy_);
    for (CheckBox* box : chkAgmast_)
        if (box->value() == 1) box->setValue(0);
    raise(EventId::Click);
}

void RYXAgencySelection::deselectAll() {
    if (selectionBusy_ || listBusy_) return;
    {
        GuardScope busy(selectionBusy_);
        const int32_t rows = LstAgMast_.listCount();
        if (rows > 0) LstAgMast_.setSelectedRange(0, rows - 1, false);
        Refresh();
        LstAgMast_.refresh();
        if (rows > 0) LstAgMast_.setListIndex(0);
        chkAgmast_[kAllAgencies]->setValue(0);
        chkAgmast_[kYourAgencies]->setValue(0);
    }
    focusList();
}

// Alt with the divide key of the numeric keypad deselects everything.
void RYXAgencySelection::deselectShortcut(EventArgs& args) {
    if (!(args.Shift & shift::Alt) || args.KeyCode != vk::Divide || !acceptsInput()) return;
    args.KeyCode = 0;
    deselectAll();
    LstAgMast_.refresh();
}

// A list that cannot take the focus (disabled or hidden by the host) keeps the focus where it
// is; that is no failure of the user's action.
void RYXAgencySelection::focusList() {
    try {
        LstAgMast_.setFocus();
    } catch (const WidgetError&) {
    }
}

void RYXAgencySelection::onCheck(int16_t index, Notify what, EventArgs& args) {
    switch (what) {
        case Notify::Click:
            checkClicked(index);
            break;
        case Notify::KeyDown:
        case Notify::KeyPress:
        case Notify::KeyUp:
            relay(what, args, Variant(index));
            break;
        default:
            break;  // mouse events stay inside
    }
}

void RYXAgencySelection::onList(Notify what, EventArgs& args) {
    switch (what) {
        case Notify::Click:
            listClicked();
            break;
        case Notify::DblClick:
            relay(what, args);
            break;
        case Notify::KeyDown:
            deselectShortcut(args);
            break;
        default:
            break;  // the list's other keys and its mouse events stay inside
    }
}

void RYXAgencySelection::SurfaceEvent(Notify what, EventArgs& args) {
    if (what == Notify::KeyDown) deselectShortcut(args);
}

// Enter passes the focus on; Alt+A puts it in the list. The character never goes further.
void RYXAgencySelection::AccessKeyPress(int16_t& KeyAscii) {
    const int16_t key = KeyAscii;
    KeyAscii = 0;
    if (key == vk::Return)
        inject("{TAB}");
    else if ((key == 'A' || key == 'a') && acceptsInput())
        focusList();
}

// ---- appearance ----------------------------------------------------------------------------

Color RYXAgencySelection::BackColor() const {
    return fraAgencySelection_.backColor();
}

void RYXAgencySelection::setBackColor(Color c) {
    fraAgencySelection_.setBackColor(c);
    for (CheckBox* box : chkAgmast_)
        box->setBackColor(c);
    notifyChanged("BackColor");
}

Color RYXAgencySelection::TitleColor() const {
    return fraAgencySelection_.foreColor();
}

void RYXAgencySelection::setTitleColor(Color c) {
    fraAgencySelection_.setForeColor(c);
    notifyChanged("TitleColor");
}

Color RYXAgencySelection::ForeColor() const {
    return LstAgMast_.backColor();
}

// A system colour (negative) gives the button the light 3-D system colour, so that it follows
// the desktop scheme with the list; a plain colour gives it its own orange.
void RYXAgencySelection::setForeColor(Color c) {
    LstAgMast_.setBackColor(c);
    site().setSurfaceBackColor(c);
    cmdDeselect_.setBackColor(c >= 0 ? kButtonColor : kSystemLight3D);
    notifyChanged("ForeColor");
}

Color RYXAgencySelection::ButtonBackColor() const {
    return cmdDeselect_.backColor();
}

void RYXAgencySelection::setButtonBackColor(Color c) {
    cmdDeselect_.setBackColor(c);
}

void RYXAgencySelection::setCrystalStyle(bool v) {
    crystal_ = v;
    notifyChanged("CrystalStyle");
}

void RYXAgencySelection::applyEnabled(bool v) {
    fraAgencySelection_.setEnabled(v);
    chkAgmast_[kAllAgencies]->setEnabled(v);
    chkAgmast_[kYourAgencies]->setEnabled(v);
    LstAgMast_.setEnabled(v);
    cmdDeselect_.setEnabled(v);
}

// The frame follows the control's width, never narrower than 2820; heights never change, so
// a taller control shows its surface below the frame.
void RYXAgencySelection::Resize() {
    Twips width = site().width();
    if (width < kMinWidth) {
        site().setSize(kMinWidth, site().height());
        width = kMinWidth;
    }
    fraAgencySelection_.setWidth(width);
    LstAgMast_.setWidth(fraAgencySelection_.width() - 360);
    cmdDeselect_.setLeft(fraAgencySelection_.width() - cmdDeselect_.width() - 230);
}

// ---- persistence ---------------------------------------------------------------------------

void RYXAgencySelection::InitProperties() {
    LstAgMast_.setWidth(site().width() - 150);
    setCrystalStyle(true);
    setEnabled(true);
    setLocked(false);
}

void RYXAgencySelection::ReadProperties(const PropertyBag& bag) {
    PropertyLoader load(bag);
    load.key("Enabled", true, [&](const Variant& v) { setEnabled(v.toBool()); });
    load.key("Locked", false, [&](const Variant& v) { setLocked(v.toBool()); });
    load.key("CrystalStyle", true, [&](const Variant& v) { crystal_ = v.toBool(); });
    load.key("Titlecolor", Variant(int16_t{kTitleColor}),
             [&](const Variant& v) { fraAgencySelection_.setForeColor(v.toInt32()); });
    load.key("ForeColor", kEntryBackColor, [&](const Variant& v) { setForeColor(v.toInt32()); });
    load.key("BackColor", kFrameBackColor, [&](const Variant& v) { setBackColor(v.toInt32()); });
    // Without a saved button colour the button keeps the colour ForeColor just gave it.
    load.key("ButtonBackColor", cmdDeselect_.backColor(),
             [&](const Variant& v) { setButtonBackColor(v.toInt32()); });
}

// The colours are written with no default, so they are always stored.
void RYXAgencySelection::WriteProperties(PropertyBag& bag) const {
    bag.writeProperty("CrystalStyle", crystal_, true);
    bag.writeProperty("Enabled", enabled_, true);
    bag.writeProperty("Locked", locked_, false);
    bag.writeProperty("Backcolor", fraAgencySelection_.backColor(), Variant());
    bag.writeProperty("Forecolor", LstAgMast_.backColor(), Variant());
    bag.writeProperty("Titlecolor", fraAgencySelection_.foreColor(), Variant());
    bag.writeProperty("ButtonBackColor", cmdDeselect_.backColor(), Variant());
}

}  // namespace ryx
