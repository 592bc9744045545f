// RYXAgencySelection: which agencies a report covers: every agency including the others
// ("All Agencies"), every agency of the agency table ("Your Agencies"), or a pick of rows from
// the list of agencies read from the office database.
#pragma once

#include <array>
#include <string>

#include "ryx/control.h"

namespace ryx {

class RYXAgencySelection : public Control {
  public:
    explicit RYXAgencySelection(Container& site);
    std::string_view typeName() const override { return "RYXAgencySelection"; }
    std::string_view accessKeys() const override { return "aA"; }

    // The database file of the agency table. Setting it at run time fills the list afresh:
    // "*   Others", then one row per agency in code order. It is not saved with the form.
    std::string DatabaseName() const;
    void setDatabaseName(std::string_view name);

    // The criterion: "+" for all agencies (or for nothing picked), "-" for the agencies of the
    // table, else the picked codes, "*" standing for the others: ["*","A1","B2"] with
    // CrystalStyle True, *A1B2 with it False.
    std::string ReturnedText();

    // "+", "-", "*" when "*   Others" is picked, else Empty. Setting "+", "-" or "*" makes
    // that choice again; any other value does nothing.
    Variant DefaultSetting() const;
    void setDefaultSetting(const Variant& v);

    Color BackColor() const;  // frame and check box background
    void setBackColor(Color c);
    Color TitleColor() const;  // frame caption colour
    void setTitleColor(Color c);
    // The list background; also paints the control surface, and the button in its own colour
    // for a plain colour or in the light 3-D system colour for a system colour.
    Color ForeColor() const;
    void setForeColor(Color c);
    Color ButtonBackColor() const;  // the "Deselect All" button
    void setButtonBackColor(Color c);
    bool CrystalStyle() const { return crystal_; }
    void setCrystalStyle(bool v);

    void InitProperties() override;
    void ReadProperties(const PropertyBag& bag) override;
    void WriteProperties(PropertyBag& bag) const override;
    void Resize() override;
    void AccessKeyPress(int16_t& KeyAscii) override;
    void SurfaceEvent(Notify what, EventArgs& args) override;

  private:
    void applyEnabled(bool v) override;
    void fillList();
    void onCheck(int16_t index, Notify what, EventArgs& args);
    void onList(Notify what, EventArgs& args);
    void checkClicked(int16_t index);
    void listClicked();
    void deselectAll();
    void deselectShortcut(EventArgs& args);
    void focusList();

    Frame& fraAgencySelection_;
    ListBox& LstAgMast_;
    std::array<CheckBox*, 2> chkAgmast_;  // 0 "All Agencies", 1 "Your Agencies"
    CommandButton& cmdDeselect_;
    RecordSource& DatAgMast_;
    bool selectionBusy_ = false;
    bool listBusy_ = false;
    bool crystal_ = true;
};

}  // namespace ryx
