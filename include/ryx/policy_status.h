// RYXPolicyStatus: which kinds of policy a report includes, as any set of eight policy
// statuses or all of them at once ("All Policies").
#pragma once

#include <string>

#include "ryx/control.h"

namespace ryx {

class RYXPolicyStatus : public Control {
  public:
    explicit RYXPolicyStatus(Container& site);
    std::string_view typeName() const override { return "RYXPolicyStatus"; }

    // The criterion: "+" for every status, else the codes of the selected rows, as
    // ["I","F"] (CrystalStyle True) or I,F (False).
    std::string ReturnedText();

    Color BackColor() const;  // frame and check box background
    void setBackColor(Color c);
    Color TitleColor() const;  // frame caption colour
    void setTitleColor(Color c);
    Color ForeColor() const;  // list background
    void setForeColor(Color c);
    bool CrystalStyle() const { return crystal_; }
    void setCrystalStyle(bool v);

    // "+" for all statuses, else one letter per selected status of rows 0 to 6 (ILRFSMD).
    Variant DefaultSetting() const;
    // "+" or any seven characters check "All Policies"; otherwise each of the letters
    // I, L, R, F, S, M, D selects its row (case-sensitive), and row 0 becomes current.
    // A text over 255 characters is an OverflowError, before anything is selected.
    void setDefaultSetting(const Variant& v);

    void InitProperties() override;
    void ReadProperties(const PropertyBag& bag) override;
    void WriteProperties(PropertyBag& bag) const override;
    void Resize() override;
    void AccessKeyPress(int16_t& KeyAscii) override;
    void SurfaceEvent(Notify what, EventArgs& args) override;

  private:
    void applyEnabled(bool v) override;
    void onList(Notify what, EventArgs& args);
    void onCheck(Notify what, EventArgs& args);
    void listClicked();
    void checkClicked();

    Frame& fraPolicyStatus_;
    ListBox& LstPolicyStatus_;
    CheckBox& ChkAll_;
    std::string returnedText_;
    bool listBusy_ = false;
    bool checkBusy_ = false;
    bool crystal_ = true;
};

}  // namespace ryx
