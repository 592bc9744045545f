#include "ryx/date_range.h"

#include <array>

namespace ryx {
namespace {

// The control has one size; the frame, 15 twips wider and higher, is clipped by it.
constexpr Twips kWidth = 2430;
constexpr Twips kHeight = 1305;

constexpr std::string_view kDefaultFootNote = "Enter Valid Dates";
constexpr std::string_view kDefaultCaption = "Date Range";

// What the footer tells the user under each date style.
constexpr std::array<std::string_view, 4> kFooters{
    "Enter Valid Dates",
    "Enter dates in same month",
    "Enter dates in same year",
    "Enter dates in a Financial Year",
};

constexpr uint8_t kSameMonth = 1;
constexpr uint8_t kSameYear = 2;
constexpr uint8_t kFinancialYear = 3;

// Caret positions in a date box: the day field before 3, the month field from 3 to 5.
constexpr int32_t kMonthStart = 3;
constexpr int32_t kYearStart = 6;

// The form design of the children.
constexpr WidgetDesign kFrame{.kind = WidgetKind::Frame,
                              .name = "fraDateRange",
                              .left = 0,
                              .top = 0,
                              .width = 2445,
                              .height = 1290,
                              .caption = "&Date Range",
                              .backColor = kFrameBackColor,
                              .foreColor = kTitleColor,
                              .font = kBoldFont,
                              .tabIndex = 0,
                              .inFrame = false};
constexpr WidgetDesign kStartBox{.kind = WidgetKind::MaskedEdit,
                                 .name = "MskDate",
                                 .index = 0,
                                 .left = 585,
                                 .top = 255,
                                 .width = 1335,
                                 .height = 330,
                                 .backColor = kEntryBackColor,
                                 .foreColor = kBlack,
                                 .font = kFixedFont,
                                 .tabIndex = 1,
                                 .mask = kDateMask};
constexpr WidgetDesign kEndBox{.kind = WidgetKind::MaskedEdit,
                               .name = "MskDate",
                               .index = 1,
                               .left = 570,
                               .top = 630,
                               .width = 1350,
                               .height = 330,
                               .backColor = kEntryBackColor,
                               .foreColor = kBlack,
                               .font = kFixedFont,
                               .tabIndex = 5,
                               .mask = kDateMask};
constexpr WidgetDesign kStartImage{.kind = WidgetKind::Image,
                                   .name = "ImgCalendar",
                                   .index = 0,
                                   .left = 1950,
                                   .top = 255,
                                   .width = 315,
                                   .height = 315,
                                   .picture = "calendar"};
constexpr WidgetDesign kEndImage{.kind = WidgetKind::Image,
                                 .name = "ImgCalendar",
                                 .index = 1,
                                 .left = 1950,
                                 .top = 630,
                                 .width = 315,
                                 .height = 315,
                                 .picture = "calendar"};
constexpr WidgetDesign kStartLabel{.kind = WidgetKind::Label,
                                   .name = "lblStart",
                                   .left = 135,
                                   .top = 315,
                                   .width = 450,
                                   .height = 210,
                                   .caption = "Start",
                                   .foreColor = kBlack,
                                   .tabIndex = 4};
constexpr WidgetDesign kEndLabel{.kind = WidgetKind::Label,
                                 .name = "lblEnd",
                                 .left = 135,
                                 .top = 675,
                                 .width = 345,
                                 .height = 225,
                                 .caption = "End",
                                 .foreColor = kBlack,
                                 .tabIndex = 3};
constexpr WidgetDesign kFooterLabel{.kind = WidgetKind::Label,
                                    .name = "lblFooter",
                                    .left = 75,
                                    .top = 1005,
                                    .width = 2250,
                                    .height = 195,
                                    .caption = "Leave it Blank for Whole Month",
                                    .backColor = kFrameBackColor,
                                    .foreColor = kBlack,
                                    .tabIndex = 2};

uint8_t byteSetting(int32_t v, std::string_view name) {
    if (v < 0 || v > 255)
        throw OverflowError(std::string(name) + " " + std::to_string(v) +
                            " does not fit in a byte (0 to 255)");
    return static_cast<uint8_t>(v);
}

bool isDigit(char c) {
    return c >= '0' && c <= '9';
}

// Characters that the user types, as opposed to control keys (Ctrl+X, Ctrl+C, Escape).
bool isPrintable(int16_t keyChar) {
    return keyChar >= 32 && keyChar != 127;
}

std::string lastDayOfMonth(const CivilDate& d) {
    return formatDate({d.year, d.month, d_DaysInMonth(d.month, d.year)});
}

// The end's day and month with another year; not a date when that year lacks the day.
std::string withYear(const CivilDate& end, int year) {
    return formatDate({year, end.month, end.day});
}

}  // namespace

RYXDateRange::RYXDateRange(Container& site)
    : Control(site),
      fraDateRange_(site.addFrame(kFrame)),
      MskDate0_(site.addMaskedEdit(kStartBox)),
      MskDate1_(site.addMaskedEdit(kEndBox)),
      ImgCalendar0_(site.addImage(kStartImage)),
      ImgCalendar1_(site.addImage(kEndImage)),
      lblStart_(site.addLabel(kStartLabel)),
      lblEnd_(site.addLabel(kEndLabel)),
      lblFooter_(site.addLabel(kFooterLabel)) {
    MskDate0_.setHandler([this](Notify what, EventArgs& a) { onDateBox(0, what, a); });
    MskDate1_.setHandler([this](Notify what, EventArgs& a) { onDateBox(1, what, a); });
    ImgCalendar0_.setHandler([this](Notify what, EventArgs&) {
        if (what == Notify::Click) imageClicked(0);
    });
    ImgCalendar1_.setHandler([this](Notify what, EventArgs&) {
        if (what == Notify::Click) imageClicked(1);
    });
}

// ---- the dates the host reads and sets ---------------------------------------------------

Variant RYXDateRange::StartDate() {
    return returnedDate(0);
}

Variant RYXDateRange::EndDate() {
    return returnedDate(1);
}

void RYXDateRange::setStartDate(const Variant& v) {
    setDate(0, v, "StartDate");
}

void RYXDateRange::setEndDate(const Variant& v) {
    setDate(1, v, "EndDate");
}

// A date typed and never left (the host reads from a menu, which takes no focus) is tidied
// first, so that it counts as typed rather than as blank.
Variant RYXDateRange::returnedDate(uint8_t index) {
    tidyDate(0);
    tidyDate(1);
    if (!ImageClick) fillBlankDates(index);
    const auto date = boxDate(index);
    if (!date) return Variant();
    const std::string text = formatDate(*date);
    if (!crystal_) return Variant(text);
    return Variant("Date( " + text.substr(6) + "," + text.substr(3, 2) + "," + text.substr(0, 2) +
                   ")");
}

void RYXDateRange::setDate(uint8_t index, const Variant& v, std::string_view name) {
    std::string text = v.toString();
    if (!isDate(text) || text == kBlankDate)
        clearDate(index);
    else
        MskDate(index).setText(ryx::d_DateCheck(text).toString());
    notifyChanged(name);
}

// Emptying a masked box takes the empty mask: with its mask on, it keeps its literals.
void RYXDateRange::clearDate(uint8_t index) {
    MaskedEdit& box = MskDate(index);
    box.setMask("");
    box.setText("");
    box.setMask(kDateMask);
}

// A default that is not a date (a DateStyle above 3 has no period) leaves the box empty
// rather than half filled.
void RYXDateRange::writeDate(uint8_t index, const std::string& text) {
    if (isDate(text))
        MskDate(index).setText(text);
    else
        clearDate(index);
}

// A valid date in the box is rewritten as "dd/mm/yyyy" (‘1 /5 /2000’ becomes ‘01/05/2000’).
void RYXDateRange::tidyDate(uint8_t index) {
    MaskedEdit& box = MskDate(index);
    std::string text = box.text();
    const std::string tidy = ryx::d_DateCheck(text).toString();
    if (isDate(tidy) && tidy != box.text()) box.setText(tidy);
}

std::optional<CivilDate> RYXDateRange::boxDate(uint8_t index) const {
    std::string text = MskDate(index).text();
    return dateOf(ryx::d_RemovePromptChar(text));
}

// AllowBlank names the dates that may stay blank: 1 the first, 2 the second, 3 both.
bool RYXDateRange::startMayBeBlank() const {
    return (allowBlank_ & 1) != 0;
}

bool RYXDateRange::endMayBeBlank() const {
    return (allowBlank_ & 2) != 0;
}

// ---- default dates -----------------------------------------------------------------------

// The first day of the month Month names (0: this month; in the same-year style January, in
// the financial-year style April), in Year or this year. In the financial-year style with no
// Year, it is the year before unless that month and today lie on the same side of April.
CivilDate RYXDateRange::defaultStart(const CivilDate& today) const {
    int month = month_ != 0 ? month_ : today.month;
    int year = year_ != 0 ? year_ : today.year;
    if (dateStyle_ == kSameYear && month_ == 0) month = 1;
    if (dateStyle_ == kFinancialYear) {
        if (month_ == 0) month = 4;
        if (year_ == 0 && (month <= 3) != (today.month <= 3)) year = today.year - 1;
    }
    return {year, month, 1};
}

std::string RYXDateRange::d_DefaultDate(uint8_t Index) const {
    const CivilDate today = site().clock().today();
    if (dateStyle_ > kFinancialYear || Index > 1)  // no period: a text that is not a date
        return "01//" + std::to_string(year_ != 0 ? year_ : today.year);
    if (Index == 0) return formatDate(defaultStart(today));
    // The end of the period that holds the start date, or the default start date.
    const CivilDate start = boxDate(0).value_or(defaultStart(today));
    switch (dateStyle_) {
        case kSameYear:
            return formatDate({start.year, 12, 31});
        case kFinancialYear:
            return formatDate({start.month > 3 ? start.year + 1 : start.year, 3, 31});
        default:
            return lastDayOfMonth(start);
    }
}

bool RYXDateRange::endInStartPeriod(const CivilDate& S, const CivilDate& E) const {
    switch (dateStyle_) {
        case kSameMonth:
            return S.month == E.month && S.year == E.year;
        case kSameYear:
            return S.year == E.year;
        case kFinancialYear:
            return financialYear(S) == financialYear(E);
        default:
            return true;
    }
}

// Before a date is read: a blank start that may not be blank gets the default start; when the
// end is read, an end that may not be blank and is blank, or lies outside the start's period,
// gets the end of that period. An end before the start is left to the focus-loss rules.
void RYXDateRange::fillBlankDates(uint8_t index) {
    const auto S = boxDate(0);
    auto E = boxDate(1);
    if (!S && index == 0 && !startMayBeBlank()) writeDate(0, d_DefaultDate(0));
    if (index != 1 || !S || endMayBeBlank()) return;
    if (E && !earlier(*E, *S) && !endInStartPeriod(*S, *E)) E.reset();
    if (!E) writeDate(1, d_DefaultDate(1));
}

// ---- range rules -------------------------------------------------------------------------

// Mode 0 checks the start, 1 the end, 2 both.
void RYXDateRange::d_RangeCheck(uint8_t mode) {
    if (mode != 1 && !boxDate(0)) {
        if (startMayBeBlank())
            setStartDate(Variant(kBlankDate));
        else
            writeDate(0, d_DefaultDate(0));
    }
    if (mode == 0) return;
    if (const auto end = newEnd(boxDate(0), boxDate(1))) setEndDate(Variant(*end));
}

// The end date the rules give, "" to clear the end box, or nothing to leave it as it is.
std::optional<std::string> RYXDateRange::newEnd(const std::optional<CivilDate>& S,
                                                const std::optional<CivilDate>& E) const {
    if (!E) return endMayBeBlank() ? "" : d_DefaultDate(1);
    if (!S) return formatDate(*E);
    if (dateStyle_ == 0) {
        if (!earlier(*E, *S)) return std::nullopt;
        return endMayBeBlank() ? lastDayOfMonth(*S) : "";
    }
    if (sameDay(*E, *S)) return formatDate(*E);
    if (earlier(*E, *S)) return "";
    switch (dateStyle_) {
        case kSameMonth:
            return formatDate({S->year, S->month, E->day});
        case kSameYear:
            return sameYearEnd(*S, *E);
        case kFinancialYear:
            return financialYearEnd(*S, *E);
        default:
            return "";
    }
}

// An end after the start, moved into the start's year.
std::string RYXDateRange::sameYearEnd(const CivilDate& S, const CivilDate& E) const {
    if (S.month > E.month) return "";
    if (S.month < E.month || S.day <= E.day) return withYear(E, S.year);
    return endMayBeBlank() ? "" : d_DefaultDate(1);
}

// An end after the start, moved into the start's financial year (April to March).
std::string RYXDateRange::financialYearEnd(const CivilDate& S, const CivilDate& E) const {
    if (E.month == S.month) {
        if (E.day < S.day) return d_DefaultDate(1);
        if (E.day == S.day) return formatDate(S);
        return withYear(E, S.year);
    }
    const bool startInJanToMar = S.month <= 3;
    const bool endInJanToMar = E.month <= 3;
    if (startInJanToMar == endInJanToMar) return withYear(E, S.year);
    return withYear(E, startInJanToMar ? S.year - 1 : S.year + 1);
}

// ---- focus loss --------------------------------------------------------------------------

void RYXDateRange::dateBoxLeft(uint8_t index) {
    if (!rulesOn()) return;
    tidyDate(index);
    d_RangeCheck(index);
}

void RYXDateRange::ExitFocus() {
    if (rulesOn()) d_RangeCheck(2);
}

// ---- keys --------------------------------------------------------------------------------

void RYXDateRange::onDateBox(uint8_t index, Notify what, EventArgs& args) {
    switch (what) {
        case Notify::KeyDown:
            relay(what, args, Variant(int16_t{index}));
            arrowMovesFocus(args.KeyCode);
            break;
        case Notify::KeyPress:
            relay(what, args, Variant(int16_t{index}));
            dateKeyPress(index, args.KeyAscii);
            break;
        case Notify::LostFocus:
            dateBoxLeft(index);
            break;
        default:
            break;  // clicks, key up, mouse and focus gain stay inside
    }
}

// Typing help, on the key as the host's KeyPress handler left it. Enter stays in the box.
void RYXDateRange::dateKeyPress(uint8_t index, int16_t& KeyAscii) {
    if (KeyAscii == vk::Return) {
        KeyAscii = 0;
        return;
    }
    if (KeyAscii == 0 || KeyAscii == vk::Back) return;
    MaskedEdit& box = MskDate(index);
    std::string text = box.text();
    ryx::d_RemovePromptChar(text);
    if (KeyAscii == '/')
        slashKey(box, text, KeyAscii);
    else if (isPrintable(KeyAscii))  // a control key acts on the whole selection
        overwriteHelp(box, text);
}

// "/" in the day or month field completes it with its leading zero ("5/" gives 05) and moves
// on; a day above 31 or a month above 12 is cleared and the "/" dropped. The retyped field
// arrives after the "/" itself, which the box refuses at the month's first digit.
void RYXDateRange::slashKey(MaskedEdit& box, const std::string& text, int16_t& KeyAscii) {
    const int32_t caret = box.selStart();
    if (caret < kMonthStart) {
        const std::string day = ryx::d_ValidateDay(text);
        inject("{HOME}{DEL}{DEL}");
        if (day.empty()) {
            KeyAscii = 0;
            return;
        }
        inject(day);
        box.setSelStart(kMonthStart);
    } else if (caret < kYearStart) {
        const std::string month = ryx::d_ValidateMonth(text);
        box.setSelStart(kMonthStart);
        inject("{DEL}{DEL}");
        if (month.empty())
            KeyAscii = 0;
        else
            inject(month);
    }
}

// A key typed after a digit (or at the start, or just before a digit that follows a "/")
// replaces the character after the caret instead of pushing the field on.
void RYXDateRange::overwriteHelp(MaskedEdit& box, const std::string& text) {
    const int32_t caret = box.selStart();
    auto digitAt = [&](int32_t i) {
        return i >= 0 && i < static_cast<int32_t>(text.size()) &&
               isDigit(text[static_cast<size_t>(i)]);
    };
    const bool afterSlash = caret > 0 && caret <= static_cast<int32_t>(text.size()) &&
                            text[static_cast<size_t>(caret - 1)] == '/';
    if (caret == 0 || digitAt(caret - 1) || (afterSlash && digitAt(caret))) box.setSelLength(1);
}

void RYXDateRange::imageClicked(int16_t index) {
    if (!acceptsInput()) return;
    ImageClick = true;
    EventArgs args;
    args.Index = Variant(index);
    raise(EventId::ButtonClick, args);
}

void RYXDateRange::SurfaceEvent(Notify what, EventArgs& args) {
    if (what == Notify::KeyPress && args.KeyAscii == vk::Return) inject("{tab}");
}

void RYXDateRange::AccessKeyPress(int16_t& KeyAscii) {
    enterMovesFocus(KeyAscii);
}

// ---- appearance --------------------------------------------------------------------------

Color RYXDateRange::BackColor() const {
    return fraDateRange_.backColor();
}

void RYXDateRange::setBackColor(Color c) {
    fraDateRange_.setBackColor(c);
    notifyChanged("BackColor");
}

Color RYXDateRange::ForeColor() const {
    return MskDate0_.backColor();
}

void RYXDateRange::setForeColor(Color c) {
    site().setSurfaceBackColor(c);
    MskDate0_.setBackColor(c);
    MskDate1_.setBackColor(c);
    notifyChanged("ForeColor");
}

Color RYXDateRange::TitleColor() const {
    return fraDateRange_.foreColor();
}

void RYXDateRange::setTitleColor(Color c) {
    fraDateRange_.setForeColor(c);
    notifyChanged("Titlecolor");
}

bool RYXDateRange::ShowCalendar() const {
    return ImgCalendar0_.visible();
}

void RYXDateRange::setShowCalendar(bool v) {
    ImgCalendar0_.setVisible(v);
    ImgCalendar1_.setVisible(v);
    notifyChanged("ShowCalendar");
}

std::string RYXDateRange::Caption() const {
    return fraDateRange_.caption();
}

void RYXDateRange::setCaption(std::string_view text) {
    fraDateRange_.setCaption(text);
    notifyChanged("Caption");
}

std::string RYXDateRange::FootNote() const {
    return lblFooter_.caption();
}

void RYXDateRange::setFootNote(std::string_view text) {
    lblFooter_.setCaption(text);
    notifyChanged("FootNote");
}

void RYXDateRange::setCrystalStyle(bool v) {
    crystal_ = v;
    notifyChanged("CrystalStyle");
}

void RYXDateRange::setDateStyle(int32_t v) {
    dateStyle_ = byteSetting(v, "DateStyle");
    notifyChanged("DateStyle");
    d_SetFooter();
}

void RYXDateRange::setAllowBlank(int32_t v) {
    allowBlank_ = byteSetting(v, "AllowBlank");
}

void RYXDateRange::setCalendarPosition(int32_t v) {
    calendarPosition_ = byteSetting(v, "CalendarPosition");
    notifyChanged("CalendarPosition");
}

void RYXDateRange::setMonth(int v) {
    if (v < 0 || v > 12) return;
    month_ = static_cast<uint8_t>(v);
    notifyChanged("Month");
}

void RYXDateRange::setYear(int v) {
    if (v < 1600 || v > 2200) return;
    year_ = static_cast<int16_t>(v);
    notifyChanged("Year");
}

// A style above 3 keeps the footer's message as it is.
void RYXDateRange::d_SetFooter() {
    if (dateStyle_ < kFooters.size()) lblFooter_.setCaption(kFooters[dateStyle_]);
}

// Disabled: the frame passes no input to the date boxes, whose text turns grey.
void RYXDateRange::applyEnabled(bool v) {
    fraDateRange_.setEnabled(v);
    lblFooter_.setEnabled(v);
    lblEnd_.setEnabled(v);
    lblStart_.setEnabled(v);
    MskDate0_.setForeColor(v ? kBlack : kSystemLight3D);
    MskDate1_.setForeColor(v ? kBlack : kSystemLight3D);
}

void RYXDateRange::Resize() {
    site().setSize(kWidth, kHeight);
}

// ---- persistence -------------------------------------------------------------------------

void RYXDateRange::InitProperties() {
    crystal_ = true;
    setAllowBlank(0);
    setDateStyle(0);
    year_ = 0;
    month_ = 0;
    setEnabled(true);
    setLocked(false);
    calendarPosition_ = 2;
}

void RYXDateRange::ReadProperties(const PropertyBag& bag) {
    PropertyLoader load(bag);
    // A damaged form cannot give impossible default dates: values out of range are ignored.
    load.key("Month", int16_t{0}, [&](const Variant& v) {
        const uint8_t month = v.toByte();
        if (month <= 12) month_ = month;
    });
    load.key("Year", int16_t{0}, [&](const Variant& v) {
        const int16_t year = v.toInt16();
        if (year == 0 || (year >= 1600 && year <= 2200)) year_ = year;
    });
    load.key("AllowBlank", int16_t{0}, [&](const Variant& v) { setAllowBlank(v.toInt32()); });
    load.key("DateStyle", int16_t{0}, [&](const Variant& v) { setDateStyle(v.toInt32()); });
    load.key("CrystalStyle", true, [&](const Variant& v) { setCrystalStyle(v.toBool()); });
    load.key("Enabled", true, [&](const Variant& v) { setEnabled(v.toBool()); });
    load.key("Locked", false, [&](const Variant& v) { setLocked(v.toBool()); });
    load.step([&] { d_SetFooter(); });
    load.key("Forecolor", kEntryBackColor, [&](const Variant& v) { setForeColor(v.toInt32()); });
    load.key("BackColor", kFrameBackColor,
             [&](const Variant& v) { fraDateRange_.setBackColor(v.toInt32()); });
    load.key("TitleColor", kTitleColor,
             [&](const Variant& v) { fraDateRange_.setForeColor(v.toInt32()); });
    load.key("ShowCalendar", true, [&](const Variant& v) { setShowCalendar(v.toBool()); });
    load.key("CalendarPosition", int16_t{2},
             [&](const Variant& v) { calendarPosition_ = v.toByte(); });
    // The saved footnote comes after the style's message, so the saved text wins.
    load.key("FootNote", kDefaultFootNote,
             [&](const Variant& v) { lblFooter_.setCaption(v.toString()); });
    load.key("Caption", kDefaultCaption,
             [&](const Variant& v) { fraDateRange_.setCaption(v.toString()); });
    load.step([&] { site().setSize(kWidth, kHeight); });
}

void RYXDateRange::WriteProperties(PropertyBag& bag) const {
    bag.writeProperty("Month", int16_t{month_}, int16_t{0});
    bag.writeProperty("Year", year_, int16_t{0});
    bag.writeProperty("AllowBlank", int16_t{allowBlank_}, int16_t{0});
    bag.writeProperty("DateStyle", int16_t{dateStyle_}, int16_t{0});
    bag.writeProperty("Enabled", enabled_, true);
    bag.writeProperty("Locked", locked_, false);
    bag.writeProperty("ShowCalendar", ImgCalendar0_.visible(), true);
    bag.writeProperty("CrystalStyle", crystal_, true);
    bag.writeProperty("Forecolor", MskDate0_.backColor(), kEntryBackColor);
    bag.writeProperty("Backcolor", fraDateRange_.backColor(), kFrameBackColor);
    bag.writeProperty("Titlecolor", fraDateRange_.foreColor(), kTitleColor);
    bag.writeProperty("CalendarPosition", int16_t{calendarPosition_}, int16_t{2});
    bag.writeProperty("FootNote", lblFooter_.caption(), kDefaultFootNote);
    bag.writeProperty("Caption", fraDateRange_.caption(), kDefaultCaption);
}

}  // namespace ryx
