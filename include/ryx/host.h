// The platform interfaces: everything the controls ask of their host container, of the
// widgets they are built from, of the keyboard, of the clock and of the agency table.
//
// The controls talk to nothing else. A platform (the headless model, Qt) implements these
// interfaces; the controls stay free of any toolkit.
#pragma once

#include <cstdint>
#include <functional>
#include <memory>
#include <optional>
#include <span>
#include <string>
#include <string_view>

#include "ryx/variant.h"

namespace ryx {

// 0x00BBGGRR for a plain colour; 0x800000nn names a system colour and passes through.
using Color = int32_t;
// Sizes and positions in twips (1440 to the inch; 15 to a pixel at 96 dpi).
using Twips = float;

// The common palette of the four controls.
inline constexpr Color kTitleColor = 0x000000C0;      // dark red frame caption
inline constexpr Color kFrameBackColor = 0x00C0FFFF;  // pale yellow frame and check boxes
inline constexpr Color kEntryBackColor = 0x00E6FEFF;  // very pale yellow entry area
inline constexpr Color kBlack = 0x00000000;
// System colour 22: the light face of three-dimensional elements (used for grey text).
inline constexpr Color kSystemLight3D = static_cast<Color>(0x80000016);

// Virtual key codes the controls and platforms use.
namespace vk {
inline constexpr int16_t Back = 8;
inline constexpr int16_t Tab = 9;
inline constexpr int16_t Return = 13;
inline constexpr int16_t Shift = 16;
inline constexpr int16_t Control = 17;
inline constexpr int16_t Menu = 18;  // Alt
inline constexpr int16_t Escape = 27;
inline constexpr int16_t Space = 32;
inline constexpr int16_t End = 35;
inline constexpr int16_t Home = 36;
inline constexpr int16_t Left = 37;
inline constexpr int16_t Up = 38;
inline constexpr int16_t Right = 39;
inline constexpr int16_t Down = 40;
inline constexpr int16_t Insert = 45;
inline constexpr int16_t Delete = 46;
inline constexpr int16_t Divide = 111;  // the divide key of the numeric keypad
}  // namespace vk

// Bits of the Shift argument of key and mouse events.
namespace shift {
inline constexpr int16_t Shift = 1;
inline constexpr int16_t Ctrl = 2;
inline constexpr int16_t Alt = 4;
}  // namespace shift

// The ten events of every control, with their fixed numbers.
enum class EventId : int {
    Click = 1,
    DblClick = 2,
    Change = 3,
    KeyDown = 4,
    KeyPress = 5,
    KeyUp = 6,
    MouseDown = 7,
    MouseMove = 8,
    MouseUp = 9,
    FillList = 10,     // RYXPolicyStatus, RYXAgencySelection
    ButtonClick = 10,  // RYXRangeSelector, RYXDateRange
};

// The arguments of an event, all by reference: a host handler may change them and the
// control goes on with the changed values. Index is Empty for an event without an index.
struct EventArgs {
    Variant Index;
    int16_t KeyCode = 0;
    int16_t Shift = 0;
    int16_t KeyAscii = 0;
    int16_t Button = 0;
    float X = 0;
    float Y = 0;
};

// What a widget (or the control surface) tells the control it belongs to.
enum class Notify {
    Click,
    DblClick,
    GotFocus,
    LostFocus,
    KeyDown,
    KeyPress,
    KeyUp,
    MouseDown,
    MouseMove,
    MouseUp,
};
using NotifyHandler = std::function<void(Notify, EventArgs&)>;

struct Font {
    std::string_view name = "MS Sans Serif";
    float size = 8.25f;
    bool bold = false;
};
inline constexpr Font kBoldFont{"MS Sans Serif", 8.25f, true};
inline constexpr Font kFixedFont{"Fixedsys", 9.0f, false};

enum class WidgetKind {
    Frame,
    Label,
    CheckBox,
    ListBox,
    TextBox,
    CommandButton,
    Image,
    MaskedEdit
};

// One row of a control's form design: a child widget as the control creates it.
struct WidgetDesign {
    WidgetKind kind{};
    std::string_view name{};
    int16_t index = -1;  // -1: a single widget; 0 or 1: one of a pair sharing the name
    Twips left{}, top{}, width{}, height{};
    std::string_view caption{};
    Color backColor = kFrameBackColor;
    Color foreColor = kBlack;
    Font font{};
    int tabIndex = -1;        // -1: takes no focus
    bool inFrame = true;      // inside the control's frame, or straight on the surface
    std::string_view mask{};  // masked edit only
    std::string_view toolTip{};
    std::string_view picture{};  // a named picture of the design: "calendar", "popup"
    std::span<const std::string_view> items{};  // list box rows of the design
};

// Every widget: the control wires its notifications to its own handlers.
class Widget {
  public:
    virtual ~Widget() = default;
    virtual void setHandler(NotifyHandler handler) = 0;
};

class Frame : public Widget {
  public:
    virtual std::string caption() const = 0;
    virtual void setCaption(std::string_view text) = 0;  // "&" marks the access-key letter
    virtual Color backColor() const = 0;
    virtual void setBackColor(Color c) = 0;
    virtual Color foreColor() const = 0;  // the caption colour
    virtual void setForeColor(Color c) = 0;
    // A disabled frame passes no input to the widgets inside it; they keep their own look.
    virtual void setEnabled(bool v) = 0;
    virtual Twips width() const = 0;
    virtual void setWidth(Twips w) = 0;
    virtual void setHeight(Twips h) = 0;
};

class Label : public Widget {
  public:
    virtual std::string caption() const = 0;
    virtual void setCaption(std::string_view text) = 0;
    virtual void setEnabled(bool v) = 0;
    virtual void setVisible(bool v) = 0;
};

// A user click toggles the value before Click; a change of the value by code raises Click.
class CheckBox : public Widget {
  public:
    virtual int16_t value() const = 0;  // 0 unchecked, 1 checked
    virtual void setValue(int16_t v) = 0;
    virtual void setBackColor(Color c) = 0;
    virtual void setEnabled(bool v) = 0;
};

// Simple multiple selection: a click or the space bar toggles one row. Selecting or
// deselecting a row, or setting the current row, by the user or by code, raises Click.
class ListBox : public Widget {
  public:
    virtual void clear() = 0;
    virtual void addItem(std::string_view text) = 0;
    virtual int32_t listCount() const = 0;
    virtual std::string list(int32_t row) const = 0;
    virtual bool selected(int32_t row) const = 0;
    virtual void setSelected(int32_t row, bool v) = 0;
    // Sets the flag of every row from `first` to `last` inclusive; one Click at most.
    virtual void setSelectedRange(int32_t first, int32_t last, bool v) = 0;
    virtual void setListIndex(int32_t row) = 0;  // the current row
    // The selected flags of every row at once, one byte a row (1 selected, 0 not), for reading
    // a long list in one pass; valid until the rows or their flags change.
    virtual std::span<const uint8_t> selectedFlags() const = 0;

    // Appends `count` rows whose texts the list asks of `text` (with 0 for the first of them)
    // whenever it needs one, instead of holding a copy of each. `text` must stay callable and
    // give the same texts until the list is cleared. The default asks once per row and adds a
    // copy of each text.
    using RowText = std::function<void(int32_t row, std::string& text)>;
    virtual void addRows(int32_t count, RowText text) {
        std::string row;
        for (int32_t i = 0; i < count; ++i) {
            row.clear();
            text(i, row);
            addItem(row);
        }
    }
    virtual Color backColor() const = 0;
    virtual void setBackColor(Color c) = 0;
    virtual Color foreColor() const = 0;  // the text colour
    virtual void setWidth(Twips w) = 0;
    virtual void setHeight(Twips h) = 0;
    virtual void setEnabled(bool v) = 0;
    virtual void refresh() = 0;
    virtual void setFocus() = 0;  // WidgetError when the list cannot take the focus
};

// A key character set to 0 by the KeyPress handler inserts nothing.
class TextBox : public Widget {
  public:
    virtual std::string text() const = 0;
    virtual void setText(std::string_view text) = 0;
    virtual int32_t selStart() const = 0;
    virtual void setSelStart(int32_t v) = 0;
    virtual int32_t selLength() const = 0;
    virtual void setSelLength(int32_t v) = 0;
    virtual int32_t maxLength() const = 0;  // 0: no limit
    virtual void setMaxLength(int32_t v) = 0;
    virtual Color backColor() const = 0;
    virtual void setBackColor(Color c) = 0;
    virtual void setEnabled(bool v) = 0;
    virtual void setVisible(bool v) = 0;
    virtual void setFocus() = 0;  // WidgetError while hidden or disabled
};

// Drawn in graphical style, so its background colour shows.
class CommandButton : public Widget {
  public:
    virtual bool visible() const = 0;
    virtual void setVisible(bool v) = 0;
    virtual void setEnabled(bool v) = 0;
    virtual Color backColor() const = 0;
    virtual void setBackColor(Color c) = 0;
    virtual Twips left() const = 0;
    virtual void setLeft(Twips v) = 0;
    virtual Twips top() const = 0;
    virtual void setTop(Twips v) = 0;
    virtual Twips width() const = 0;
};

class Image : public Widget {
  public:
    virtual bool visible() const = 0;
    virtual void setVisible(bool v) = 0;
};

// A single-line field with a mask of literals and editable positions ("##/##/####"), the
// prompt character "_" in every empty editable position. The empty mask makes it a plain
// text field, so that its text can be emptied.
class MaskedEdit : public Widget {
  public:
    virtual void setMask(std::string_view mask) = 0;
    virtual std::string text() const = 0;
    virtual void setText(std::string_view text) = 0;
    virtual int32_t selStart() const = 0;
    virtual void setSelStart(int32_t v) = 0;
    virtual int32_t selLength() const = 0;
    virtual void setSelLength(int32_t v) = 0;
    virtual Color backColor() const = 0;
    virtual void setBackColor(Color c) = 0;
    virtual void setForeColor(Color c) = 0;
};

// Keystrokes, key state and the character mapping of the platform.
class Keyboard {
  public:
    virtual ~Keyboard() = default;
    // Queues keystrokes, as if typed, that reach the focused widget after the running handler
    // has returned and after the key being handled. Notation: "{TAB}" or "{tab}", "+{TAB}",
    // "{HOME}", "{DEL}", and plain characters for themselves.
    virtual void injectKeys(std::string_view keys) = 0;
    // High bit: the key is down; low bit: its toggle is on.
    virtual int16_t keyState(int16_t virtualKey) const = 0;
    // The upper-case form of one key character; a character without one is returned as is.
    virtual int16_t upperCase(int16_t keyChar) const = 0;
};

struct CivilDate {
    int year = 0;
    int month = 0;
    int day = 0;
};

class Clock {
  public:
    virtual ~Clock() = default;
    virtual CivilDate today() const = 0;
};

// The current record of an agency query, and the moves through it.
class RecordSet {
  public:
    virtual ~RecordSet() = default;
    virtual bool eof() const = 0;  // past the last record (at once when empty)
    virtual bool bof() const = 0;  // before the first record (an empty set is at both ends)
    virtual void moveFirst() = 0;
    virtual void moveNext() = 0;
    // The current record's value; std::nullopt for a null value.
    virtual std::optional<std::string> field(std::string_view name) const = 0;
    virtual std::optional<std::string> field(int position) const = 0;

    // Reading without moving or copying, as every record set of the agency source is a snapshot
    // held in memory: the number of records, and field `position` of the records from `first`
    // on into `values`, as many as it holds and there are; returns how many.
    // The views stay valid until the source is refreshed again; std::nullopt for a null value.
    // DataSourceError for a position out of range, or when there is no record `first`.
    virtual size_t recordCount() const = 0;
    virtual size_t readField(int position, size_t first,
                             std::span<std::optional<std::string_view>> values) const = 0;
    // One field of one record, read as above.
    std::optional<std::string_view> fieldAt(size_t record, int position) const {
        std::optional<std::string_view> value;
        readField(position, record, {&value, 1});
        return value;
    }
};

// A record-set source over a database file, as the agency control's design sets it up.
class RecordSource {
  public:
    virtual ~RecordSource() = default;
    virtual void setDatabaseName(std::string_view name) = 0;
    virtual std::string databaseName() const = 0;
    virtual std::string recordSource() const = 0;
    // Opens the named database, runs the record source and leaves the record set on its first
    // record; DataSourceError on failure.
    virtual void refresh() = 0;
    // The record set of the last refresh; DataSourceError when none is open.
    virtual RecordSet& recordset() = 0;
};

// The design of a record-set source: what the control passes to the data-source component.
struct DataSourceDesign {
    std::string_view name;
    std::string_view connect;
    std::string_view recordSource;
};

class PropertyBag;
class HostedControl;

// What a control asks of the host form that holds it: one container per control instance.
// It is also the toolkit that builds the control's children from its design; the container
// owns them for the life of the control.
class Container {
  public:
    virtual ~Container() = default;

    virtual void propertyChanged(std::string_view name) = 0;
    virtual bool userMode() const = 0;  // true at run time, false in the designer
    virtual Twips width() const = 0;
    virtual Twips height() const = 0;
    // Setting the size that the control already has raises no further Resize.
    virtual void setSize(Twips width, Twips height) = 0;
    // False stops all input to the surface and everything in it, without greying anything.
    virtual void setSurfaceEnabled(bool v) = 0;
    virtual void setSurfaceBackColor(Color c) = 0;
    virtual const Font& font() const = 0;
    virtual void repaint() = 0;
    virtual void raiseEvent(EventId id, EventArgs& args) = 0;
    virtual Keyboard& keyboard() = 0;
    virtual const Clock& clock() const = 0;

    virtual Frame& addFrame(const WidgetDesign& d) = 0;
    virtual Label& addLabel(const WidgetDesign& d) = 0;
    virtual CheckBox& addCheckBox(const WidgetDesign& d) = 0;
    virtual ListBox& addListBox(const WidgetDesign& d) = 0;
    virtual TextBox& addTextBox(const WidgetDesign& d) = 0;
    virtual CommandButton& addCommandButton(const WidgetDesign& d) = 0;
    virtual Image& addImage(const WidgetDesign& d) = 0;
    virtual MaskedEdit& addMaskedEdit(const WidgetDesign& d) = 0;
    virtual RecordSource& addRecordSource(const DataSourceDesign& d) = 0;
};

// What the host delivers to a control. Construction is Initialize.
class HostedControl {
  public:
    virtual ~HostedControl() = default;
    virtual std::string_view typeName() const = 0;  // "RYXPolicyStatus", ...
    // Keys that the host routes to AccessKeyPress with Alt ("aA"); empty for none.
    virtual std::string_view accessKeys() const { return {}; }

    virtual void InitProperties() = 0;
    virtual void ReadProperties(const PropertyBag& bag) = 0;
    virtual void WriteProperties(PropertyBag& bag) const = 0;
    virtual void Resize() {}
    virtual void GotFocus() {}
    virtual void LostFocus() {}
    // Focus has left the control and all its children.
    virtual void ExitFocus() {}
    virtual void AccessKeyPress(int16_t& KeyAscii) { (void)KeyAscii; }
    // Key and mouse events of the control surface itself (outside any child).
    virtual void SurfaceEvent(Notify what, EventArgs& args) {
        (void)what;
        (void)args;
    }
};

}  // namespace ryx
