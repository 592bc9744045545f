// RYXRangeSelector: a start and an end text for a range of items of one kind (policy numbers,
// clients, branches, ...). The host names the kind through ControlType, which sets the
// captions, the length of both boxes and the key filter; a pop-up button asks the host to
// offer a list of items.
#pragma once

#include <array>
#include <cstdint>
#include <string>
#include <string_view>

#include "ryx/control.h"

namespace ryx {

// The key filter of both range boxes. Any other value is kept as given and filters nothing.
enum RYXRgSelTxtType : int32_t {
    RYXANUAlphaNumeric = 0,  // punctuation dropped, everything else upper-cased
    RYXANDigits = 1,         // only the ten digits and the blank
    RYXANUserKeys = 2,       // every key as typed
};

// The number at the start of a text, read the way the end box is checked against the start
// box for policy numbers and plans: blanks, tabs and line feeds are skipped wherever they
// stand, then an optional sign, digits, a decimal part and an exponent ("E" or "D") are read
// up to the first character that cannot continue them. "&H" and "&O" start a hexadecimal or
// octal number. A text with no number at its start reads as 0.
double leadingNumber(std::string_view text);

class RYXRangeSelector : public Control {
  public:
    explicit RYXRangeSelector(Container& site);
    std::string_view typeName() const override { return "RYXRangeSelector"; }

    void setBackColor(Color c);  // frame background
    Color BackColor() const;
    Color ForeColor() const;  // background of both boxes
    void setForeColor(Color c);
    void setTitleColor(Color c);  // frame caption colour
    Color TitleColor() const;

    // The kind of item, kept exactly as given; setting it applies its row of the catalogue
    // and empties both boxes. "date" (exactly so) leaves an empty frame.
    const std::string& ControlType() const { return controlType_; }
    void setControlType(std::string_view T);

    // The start of the range, as typed. Setting it moves the focus to the end box and never
    // fails.
    std::string StartText() const;
    void setStartText(std::string_view V);
    // The end of the range, as typed. A value below the start is dropped silently; the empty
    // text (the range open at its end) is always taken.
    std::string EndText() const;
    void setEndText(std::string_view V);

    using Control::Enabled;
    using Control::setEnabled;
    bool ButtonVisible() const;
    void setButtonVisible(bool v);
    using Control::Locked;
    using Control::Refresh;
    using Control::setLocked;

    // The footer under the boxes; an empty value shows the standard wording.
    const std::string& FootNote() const { return footNote_; }
    void setFootNote(std::string_view V);
    // The item word of the frame caption ("&Range of " + V).
    const std::string& Caption() const { return caption_; }
    void setCaption(std::string_view V);

    // Selection of box RYXT(Index); an Index other than 0 or 1 is an IndexError.
    Variant Sellength(const Variant& Index) const;
    void setSellength(const Variant& Index, const Variant& v);
    Variant SelStart(const Variant& Index) const;
    void setSelStart(const Variant& Index, const Variant& v);

    // The maximum length of both boxes (0: no limit). A value that is not a number, or a text
    // that reads as one, is ignored.
    Variant MaxLength() const;
    void setMaxLength(const Variant& v);

    RYXRgSelTxtType TextType() const { return textType_; }
    void setTextType(RYXRgSelTxtType v);

    void InitProperties() override;
    void ReadProperties(const PropertyBag& bag) override;
    void WriteProperties(PropertyBag& bag) const override;
    void Resize() override;
    void GotFocus() override;
    void AccessKeyPress(int16_t& KeyAscii) override;
    void SurfaceEvent(Notify what, EventArgs& args) override;

  private:
    void applyEnabled(bool v) override;
    TextBox& boxAt(const Variant& Index, std::string_view member) const;
    void onBox(int16_t index, Notify what, EventArgs& args);
    void boxKeyDown(int16_t index, EventArgs& args);
    void boxKeyPress(int16_t index, EventArgs& args);
    void filterKey(int16_t& KeyAscii) const;
    void popClicked();

    Frame& fraRangeSelector_;
    std::array<TextBox*, 2> RYXT_;  // RYXT(0) the start, RYXT(1) the end
    CommandButton& cmdpop_;
    Label& lblStart_;
    Label& lblEnd_;
    Label& lblFooter_;
    std::string footNote_;
    std::string caption_;
    std::string controlType_;
    RYXRgSelTxtType textType_ = RYXANUAlphaNumeric;
};

}  // namespace ryx
