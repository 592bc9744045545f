// RYXDateRange: the period a report covers, as a start and an end date in two masked boxes,
// kept in one month, one calendar year or one financial year (April to March) as DateStyle
// asks, with default dates from Month, Year and today's date where a date is left blank.
#pragma once

#include <cstdint>
#include <optional>
#include <string>

#include "ryx/control.h"
#include "ryx/date_text.h"

namespace ryx {

// How the two dates are tied together.
enum class RYXDtRgStyle : uint8_t {
    RYXDtRgNone = 0,
    RYXDtRgSameMonth = 1,
    RYXDtRgSameYear = 2,
    RYXDtRgFinancialYear = 3,
};

// Which dates the user may leave blank.
enum class RYXDtRgBlankDate : uint8_t {
    RYXDtRgNone = 0,
    RYXDtRgFirstDate = 1,
    RYXDtRgSecondDate = 2,
    RYXDtRgBoth = 3,
};

// Where the calendar images belong; stored and saved, the images stay right of the boxes.
enum class RYXDtRgCalPos : uint8_t {
    RYXDtRgTopLeft = 0,
    RYXDtRgTopRight = 1,
    RYXDtRgBottomLeft = 2,
    RYXDtRgBottomRight = 3,
};

class RYXDateRange : public Control {
  public:
    explicit RYXDateRange(Container& site);
    std::string_view typeName() const override { return "RYXDateRange"; }

    // True once the user has clicked a calendar image; the host clears it when it has
    // answered the click. While it is true, leaving a box or the control checks nothing and
    // reading a date fills no default.
    bool ImageClick = false;

    // The dates as ‘Date( 2001,05,15)’ (CrystalStyle True) or ‘15/05/2001’, an empty Variant
    // for a blank date. Reading first tidies what the user typed and fills blank dates that
    // AllowBlank does not allow.
    Variant StartDate();
    Variant EndDate();
    // Any value that is not a valid date (the empty text, the blank marker) clears the box.
    void setStartDate(const Variant& v);
    void setEndDate(const Variant& v);

    // The default start (Index 0) or end (Index 1) date of the period DateStyle describes.
    std::string d_DefaultDate(uint8_t Index) const;

    // The date text routines, also usable without a control (date_text.h).
    std::string d_RemovePromptChar(std::string& mMskDate) const {
        return ryx::d_RemovePromptChar(mMskDate);
    }
    std::string d_ValidateDay(std::string_view mMskDate) const {
        return ryx::d_ValidateDay(mMskDate);
    }
    std::string d_ValidateMonth(std::string_view mMskDate) const {
        return ryx::d_ValidateMonth(mMskDate);
    }
    Variant d_DateCheck(std::string& mDate) const { return ryx::d_DateCheck(mDate); }

    Color BackColor() const;  // frame background
    void setBackColor(Color c);
    Color ForeColor() const;  // background of the date boxes and of the surface
    void setForeColor(Color c);
    Color TitleColor() const;  // frame caption colour
    void setTitleColor(Color c);
    Color InnerColor() const { return 0; }  // accepted and ignored
    void setInnerColor(Color) {}
    const ryx::Font& Font() const { return site().font(); }

    bool ShowCalendar() const;
    void setShowCalendar(bool v);
    std::string Caption() const;
    void setCaption(std::string_view text);
    std::string FootNote() const;
    void setFootNote(std::string_view text);
    bool CrystalStyle() const { return crystal_; }
    void setCrystalStyle(bool v);

    // Stored as bytes: a value outside 0 to 255 is an OverflowError and keeps the old one.
    int32_t DateStyle() const { return dateStyle_; }
    void setDateStyle(int32_t v);
    void setDateStyle(RYXDtRgStyle v) { setDateStyle(static_cast<int32_t>(v)); }
    int32_t AllowBlank() const { return allowBlank_; }
    void setAllowBlank(int32_t v);
    void setAllowBlank(RYXDtRgBlankDate v) { setAllowBlank(static_cast<int32_t>(v)); }
    int32_t CalendarPosition() const { return calendarPosition_; }
    void setCalendarPosition(int32_t v);
    void setCalendarPosition(RYXDtRgCalPos v) { setCalendarPosition(static_cast<int32_t>(v)); }

    // The default month (0: the current one) and year (0: the current one); a value out of
    // range (Month above 12, Year outside 1600 to 2200) is ignored.
    uint8_t Month() const { return month_; }
    void setMonth(int v);
    int16_t Year() const { return year_; }
    void setYear(int v);

    void InitProperties() override;
    void ReadProperties(const PropertyBag& bag) override;
    void WriteProperties(PropertyBag& bag) const override;
    void Resize() override;
    void ExitFocus() override;
    void AccessKeyPress(int16_t& KeyAscii) override;
    void SurfaceEvent(Notify what, EventArgs& args) override;

  private:
    void applyEnabled(bool v) override;
    void onDateBox(uint8_t index, Notify what, EventArgs& args);
    void dateKeyPress(uint8_t index, int16_t& KeyAscii);
    void slashKey(MaskedEdit& box, const std::string& text, int16_t& KeyAscii);
    void imageClicked(int16_t index);
    void dateBoxLeft(uint8_t index);
    bool rulesOn() const { return !ImageClick && acceptsInput(); }

    // The date rules.
    void d_RangeCheck(uint8_t mode);
    std::optional<std::string> newEnd(const std::optional<CivilDate>& S,
                                      const std::optional<CivilDate>& E) const;
    std::string sameYearEnd(const CivilDate& S, const CivilDate& E) const;
    std::string financialYearEnd(const CivilDate& S, const CivilDate& E) const;
    void fillBlankDates(uint8_t index);
    bool endInStartPeriod(const CivilDate& S, const CivilDate& E) const;
    Variant returnedDate(uint8_t index);
    void setDate(uint8_t index, const Variant& v, std::string_view name);
    void writeDate(uint8_t index, const std::string& text);
    void overwriteHelp(MaskedEdit& box, const std::string& text);
    void clearDate(uint8_t index);
    void tidyDate(uint8_t index);
    std::optional<CivilDate> boxDate(uint8_t index) const;
    CivilDate defaultStart(const CivilDate& today) const;
    bool startMayBeBlank() const;
    bool endMayBeBlank() const;
    void d_SetFooter();

    Frame& fraDateRange_;
    MaskedEdit& MskDate0_;
    MaskedEdit& MskDate1_;
    Image& ImgCalendar0_;
    Image& ImgCalendar1_;
    Label& lblStart_;
    Label& lblEnd_;
    Label& lblFooter_;

    MaskedEdit& MskDate(uint8_t index) const { return index == 0 ? MskDate0_ : MskDate1_; }

    bool crystal_ = true;
    uint8_t dateStyle_ = 0;
    uint8_t allowBlank_ = 0;
    uint8_t calendarPosition_ = 2;
    uint8_t month_ = 0;
    int16_t year_ = 0;
};

}  // namespace ryx
