// Random sequences of what a user does on a report-criteria screen holding all four controls
// (clicks, keys with modifiers, typed text, focus moves) and of what its host does (Locked and
// Enabled, property sets with odd values, agency databases that break or change, event
// handlers that change their arguments or the controls, save and reload), with the screen's
// invariants checked after every step:
// - the criterion texts are well formed in both syntaxes: "+", "-", or the picked items, each
//   one of the listed codes, in brackets and quotes that balance in the formula syntax;
// - the agency list shows "*   Others" and the rows of the table last read, or nothing after a
//   failed read, and its criterion names the codes of the picked rows;
// - the date boxes always hold a mask-shaped text, and StartDate and EndDate are either empty
//   or a valid date in the syntax asked for;
// - both range boxes share one maximum length;
// - a user's action never fails, and a host's call fails only with the library's own errors;
// - a saved form loads into a new screen that saves the same document.
#include <fuzzer/FuzzedDataProvider.h>
#include <sqlite3.h>
#include <unistd.h>

#include <cstdio>
#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <memory>
#include <optional>
#include <sstream>
#include <string>
#include <vector>

#include "ryx/agency_selection.h"
#include "ryx/date_range.h"
#include "ryx/errors.h"
#include "ryx/headless/form.h"
#include "ryx/headless/form_file.h"
#include "ryx/policy_status.h"
#include "ryx/range_selector.h"
#include "ryx/sqlite/sqlite_record_source.h"

namespace {

using namespace ryx;
using namespace ryx::headless;
namespace fs = std::filesystem;

[[noreturn]] void finding(const std::string& what) {
    std::fprintf(stderr, "form actions: %s\n", what.c_str());
    std::abort();
}

#define CHECK(ok, what)           \
    do {                          \
        if (!(ok)) finding(what); \
    } while (0)

// ---- the agency databases ------------------------------------------------------------------

constexpr const char* kQuery =
    "select AgencyCd,Name from AgMast Where AgencyCd<>'*' order by AgencyCd";

// What a fill of the list reads: the code and the row text of each agency, in list order.
struct AgencyTable {
    std::vector<std::string> codes;
    std::vector<std::string> rows;
};

void runSql(const fs::path& file, const char* sql) {
    sqlite3* db = nullptr;
    sqlite3_open(file.c_str(), &db);
    if (sqlite3_exec(db, sql, nullptr, nullptr, nullptr) != SQLITE_OK)
        finding("cannot make " + file.string());
    sqlite3_close(db);
}

std::string readText(const fs::path& file) {
    std::ifstream in(file, std::ios::binary);
    std::ostringstream s;
    s << in.rdbuf();
    return s.str();
}

// Database files of every kind a host may name, made once for the whole run. "live.db" is
// replaced or deleted by the fuzzer between fills.
class Databases {
  public:
    Databases() {
        char pattern[] = "/tmp/ryx-fuzz-agencies-XXXXXX";
        if (!mkdtemp(pattern)) finding("cannot make a temporary folder");
        folder_ = pattern;
        runSql(folder_ / "a.db",
               "CREATE TABLE AgMast (AgencyCd TEXT, Name TEXT);"
               "INSERT INTO AgMast VALUES ('B2','Beta'),('A1','Alpha'),('*','Star'),('C3',NULL),"
               "('Q\"1','Quote'),('[,]','Brackets'),('','No code'),('\xc3\x89"
               "9','Accent'),"
               "('X  Y','Blanks'),(NULL,'Null code'),(12,2.5),('\"','Lone quote');");
        runSql(folder_ / "b.db",
               "CREATE TABLE AgMast (AgencyCd TEXT, Name TEXT);"
               "INSERT INTO AgMast VALUES ('Z9','Zed'),('A1','Another');");
        runSql(folder_ / "empty.db",
               "CREATE TABLE AgMast (AgencyCd TEXT, Name TEXT);"
               "INSERT INTO AgMast VALUES ('*','Star');");
        runSql(folder_ / "branches.db", "CREATE TABLE Branches (Code TEXT);");
        runSql(folder_ / "codes.db", "CREATE TABLE AgMast (AgencyCd TEXT);");
        std::ofstream(folder_ / "notes.db") << "Agencies, to be typed in later.\n"
                                            << std::string(300, 'x');
        fs::create_directory(folder_ / "folder.db");
        for (const char* source : {"a.db", "b.db", "notes.db"})
            sources_.push_back(readText(folder_ / source));
        replaceLive(0);
        for (const char* name : {"a.db", "b.db", "empty.db", "branches.db", "codes.db", "notes.db",
                                 "folder.db", "missing.db", "live.db"})
            names_.push_back((folder_ / name).string());
        names_.push_back("");
    }
    ~Databases() {
        std::error_code ignored;
        fs::remove_all(folder_, ignored);
    }

    const std::vector<std::string>& names() const { return names_; }

    // Replaces live.db whole (table a, table b, a text file) or deletes it.
    void replaceLive(size_t which) {
        const fs::path live = folder_ / "live.db";
        if (which >= sources_.size()) {
            fs::remove(live);
            return;
        }
        const fs::path next = folder_ / "live.db.next";
        std::ofstream(next, std::ios::binary) << sources_[which];
        fs::rename(next, live);
    }

    // What a fill of the list from `name` reads now, read here on SQLite's own terms; nothing
    // when the file cannot be read as an agency table.
    static std::optional<AgencyTable> contents(const std::string& name) {
        if (name.empty()) return std::nullopt;
        sqlite3* db = nullptr;
        const int opened = sqlite3_open_v2(name.c_str(), &db, SQLITE_OPEN_READONLY, nullptr);
        std::optional<AgencyTable> table;
        sqlite3_stmt* st = nullptr;
        if (opened == SQLITE_OK && sqlite3_prepare_v2(db, kQuery, -1, &st, nullptr) == SQLITE_OK) {
            table.emplace();
            int step;
            auto text = [&](int c) {
                const auto* t = reinterpret_cast<const char*>(sqlite3_column_text(st, c));
                return t ? std::string(t, static_cast<size_t>(sqlite3_column_bytes(st, c)))
                         : std::string();
            };
            while ((step = sqlite3_step(st)) == SQLITE_ROW) {
                table->codes.push_back(text(0));
                table->rows.push_back(text(0) + "  " + text(1));
            }
            if (step != SQLITE_DONE) table.reset();
        }
        sqlite3_finalize(st);
        sqlite3_close(db);
        return table;
    }

  private:
    fs::path folder_;
    std::vector<std::string> sources_;
    std::vector<std::string> names_;
};

Databases& databases() {
    static Databases d;
    return d;
}

// ---- odd values ----------------------------------------------------------------------------

std::string dateLike(FuzzedDataProvider& in) {
    static constexpr std::string_view kChars = "0123456789/_ -";
    std::string s;
    const size_t n = in.ConsumeIntegralInRange<size_t>(0, 12);
    for (size_t i = 0; i < n; ++i)
        s += kChars[in.ConsumeIntegralInRange<size_t>(0, kChars.size() - 1)];
    return s;
}

Variant oddVariant(FuzzedDataProvider& in) {
    static const char* kTexts[] = {"",           "+",          "-",          "*",         "12",
                                   " 3 ",        "2.5",        "-1",         "1e10",      "&H7FFF",
                                   "&HFFFFFFFF", "&O17",       "1D3",        "True",      "ILRFSMD",
                                   "IF",         "31/12/2000", "05/13/2000", "11/11/1111"};
    switch (in.ConsumeIntegralInRange(0, 8)) {
        case 0:
            return Variant();
        case 1:
            return Variant(in.ConsumeBool());
        case 2:
            return Variant(in.ConsumeIntegral<int16_t>());
        case 3:
            return Variant(in.ConsumeIntegral<int32_t>());
        case 4:
            return Variant(in.ConsumeFloatingPoint<double>());
        case 5:
            return Variant(in.PickValueInArray(kTexts));
        case 6:
            return Variant(dateLike(in));
        case 7:
            return Variant(static_cast<double>(in.ConsumeIntegralInRange(-3, 3)) / 2);
        default:
            return Variant(in.ConsumeRandomLengthString(12));
    }
}

int32_t oddNumber(FuzzedDataProvider& in) {
    return in.ConsumeBool() ? in.ConsumeIntegralInRange(-2, 14) : in.ConsumeIntegral<int32_t>();
}

Color oddColor(FuzzedDataProvider& in) {
    static const Color kColors[] = {0,
                                    kTitleColor,
                                    kFrameBackColor,
                                    kEntryBackColor,
                                    kSystemLight3D,
                                    -1,
                                    static_cast<Color>(0x8000000F)};
    return in.ConsumeBool() ? in.PickValueInArray(kColors) : in.ConsumeIntegral<int32_t>();
}

// ---- the criterion texts -------------------------------------------------------------------

// The items of a formula-syntax list, ["a","b"] with "" standing for a quote inside an item;
// nothing when the brackets and quotes do not balance.
std::optional<std::vector<std::string>> formulaItems(std::string_view text) {
    if (text.size() < 4 || text.front() != '[' || text.back() != ']') return std::nullopt;
    std::vector<std::string> items;
    size_t i = 1;
    while (true) {
        if (text[i] != '"') return std::nullopt;
        std::string item;
        for (++i;; ++i) {
            if (i >= text.size() - 1) return std::nullopt;
            if (text[i] != '"') {
                item += text[i];
            } else if (text[i + 1] == '"') {
                item += '"';
                ++i;
            } else {
                break;
            }
        }
        items.push_back(std::move(item));
        ++i;  // past the closing quote
        if (i == text.size() - 1) return items;
        if (text[i] != ',') return std::nullopt;
        ++i;
    }
}

void checkCriterion(const std::string& text, bool crystal, const std::vector<std::string>& picked,
                    std::string_view plainSeparator, const char* control) {
    std::string shown;
    for (const std::string& item : picked)
        shown += "|" + item;
    const std::string where =
        std::string(control) + " criterion \"" + text + "\" for the picks " + shown;
    if (picked.empty()) {
        CHECK(text == "+", where + ": nothing picked is not \"+\"");
        return;
    }
    if (crystal) {
        const auto items = formulaItems(text);
        CHECK(items.has_value(), where + ": brackets or quotes do not balance");
        CHECK(*items == picked, where + ": not the picked items");
        return;
    }
    std::string plain;
    for (const std::string& item : picked)
        plain += (plain.empty() ? "" : std::string(plainSeparator)) + item;
    // The plain syntax has no way to write an empty code: picks of empty codes alone read as
    // nothing picked.
    CHECK(text == (plain.empty() ? "+" : plain), where + ": not the picked items, plain");
}

bool isDigits(std::string_view s) {
    for (char c : s)
        if (c < '0' || c > '9') return false;
    return !s.empty();
}

// Empty, or a real day as ‘Date( 2001,05,15)’ (formula syntax) or ‘15/05/2001’.
void checkDate(const Variant& v, bool crystal, const char* which) {
    if (v.isEmpty()) return;
    CHECK(v.isString(), std::string(which) + " is neither empty nor a text");
    const std::string text = v.toString();
    std::string dmy = text;
    if (crystal) {
        CHECK(text.size() == 17 && text.starts_with("Date( ") && text[10] == ',' &&
                  text[13] == ',' && text[16] == ')',
              std::string(which) + " \"" + text + "\" is not a formula date");
        dmy = text.substr(14, 2) + "/" + text.substr(11, 2) + "/" + text.substr(6, 4);
    }
    CHECK(dmy.size() == 10 && dmy[2] == '/' && dmy[5] == '/' && isDigits(dmy.substr(0, 2)) &&
              isDigits(dmy.substr(3, 2)) && isDigits(dmy.substr(6)) && isDate(dmy),
          std::string(which) + " \"" + text + "\" is not a valid date");
}

// ---- the screen ----------------------------------------------------------------------------

constexpr const char* kStatusCodes[] = {"I", "L", "P", "F", "S", "M", "D", "R"};

// How the host answers the controls' events.
enum class HostAnswer {
    Nothing,
    DropKey,
    ChangeKey,
    DropKeyCode,
    PickOnClick,
    AnswerButton,
    ReadAll
};

class Screen {
  public:
    // A new screen as the designer places it, or one loaded from a saved document.
    explicit Screen(const std::string* saved, CivilDate today, bool runMode) {
        form.setRecordSourceFactory(ryx::sqlite::makeRecordSource);
        form.setToday(today);
        form.setUserMode(runMode);
        before = &form.addTextBox("txtBefore");
        if (saved) {
            for (const char* type :
                 {"RYXDateRange", "RYXRangeSelector", "RYXAgencySelection", "RYXPolicyStatus"})
                form.create(type, type);
            const LoadReport report = loadFormJson(form, *saved, "saved screen");
            CHECK(report.skipped.empty(), "a saved control was passed over on loading");
        } else {
            form.add<RYXDateRange>("RYXDateRange");
            form.add<RYXRangeSelector>("RYXRangeSelector");
            form.add<RYXAgencySelection>("RYXAgencySelection", 2820, 1740);
            form.add<RYXPolicyStatus>("RYXPolicyStatus");
        }
        after = &form.addButton("cmdAfter");
        dates = &control<RYXDateRange>("RYXDateRange");
        range = &control<RYXRangeSelector>("RYXRangeSelector");
        agencies = &control<RYXAgencySelection>("RYXAgencySelection");
        statuses = &control<RYXPolicyStatus>("RYXPolicyStatus");
        nodes = {before, after};
        for (const auto& s : form.sites()) {
            nodes.push_back(&s->surface());
            for (const auto& n : s->children())
                nodes.push_back(n.get());
            s->onEvent = [this, site = s.get()](EventId id, EventArgs& a) { answer(*site, id, a); };
        }
    }

    template <class C>
    C& control(std::string_view name) {
        return dynamic_cast<C&>(form.site(name).control());
    }

    Form form;
    HTextBox* before = nullptr;
    HCommandButton* after = nullptr;
    RYXDateRange* dates = nullptr;
    RYXRangeSelector* range = nullptr;
    RYXAgencySelection* agencies = nullptr;
    RYXPolicyStatus* statuses = nullptr;
    std::vector<Node*> nodes;

    // The table the agency list shows: nothing before the first read and after a failed one.
    std::optional<AgencyTable> agencyTable;
    HostAnswer host = HostAnswer::Nothing;
    int16_t hostKey = 0;
    int answering = 0;

  private:
    void answer(Site& site, EventId id, EventArgs& a) {
        ++answering;
        switch (host) {
            case HostAnswer::Nothing:
                break;
            case HostAnswer::DropKey:
                if (id == EventId::KeyPress) a.KeyAscii = 0;
                break;
            case HostAnswer::ChangeKey:
                if (id == EventId::KeyPress) a.KeyAscii = hostKey;
                break;
            case HostAnswer::DropKeyCode:
                if (id == EventId::KeyDown) a.KeyCode = hostKey;
                break;
            case HostAnswer::PickOnClick:
                if (id == EventId::Click && &site.control() == agencies)
                    agencies->setDefaultSetting(hostKey % 2 ? "+" : "*");
                if (id == EventId::Click && &site.control() == statuses)
                    statuses->setDefaultSetting(hostKey % 2 ? "+" : "IF");
                break;
            case HostAnswer::AnswerButton:
                if (id == EventId::ButtonClick && &site.control() == range) {
                    range->setStartText("100");
                    range->setEndText("2000");
                }
                if (id == EventId::ButtonClick && &site.control() == dates) {
                    dates->setStartDate(Variant("01/04/2001"));
                    dates->ImageClick = false;
                }
                break;
            case HostAnswer::ReadAll:
                if (answering < 3) {
                    try {
                        (void)dates->StartDate();
                        (void)agencies->ReturnedText();
                        (void)statuses->ReturnedText();
                    } catch (const DataSourceError&) {
                        // a pick read before any agency table was read
                    }
                }
                break;
        }
        --answering;
    }
};

// ---- the invariants ------------------------------------------------------------------------

void checkDateBox(HMaskedEdit& box) {
    const std::string text = box.text();
    CHECK(box.mask() == "##/##/####", "a date box lost its mask");
    bool shaped = text.size() == 10 && text[2] == '/' && text[5] == '/';
    for (size_t i : {0, 1, 3, 4, 6, 7, 8, 9})
        shaped = shaped && ((text[i] >= '0' && text[i] <= '9') || text[i] == '_');
    CHECK(shaped, "date box text \"" + text + "\" is not mask-shaped");
}

void checkAgencies(Screen& s, bool crystal) {
    Site& site = s.form.site("RYXAgencySelection");
    auto& list = site.child<HListBox>("LstAgMast");
    const int16_t all = site.child<HCheckBox>("chkAgmast", 0).value();
    const int16_t yours = site.child<HCheckBox>("chkAgmast", 1).value();
    CHECK(!(all == 1 && yours == 1), "both agency boxes checked");

    const int32_t rows = list.listCount();
    if (!s.agencyTable) {
        CHECK(rows == 0, "agency rows without a table read");
    } else {
        CHECK(rows == static_cast<int32_t>(s.agencyTable->rows.size()) + 1,
              "agency rows are not the table's");
        CHECK(list.list(0) == "*   Others", "agency row 0 is not the others");
        for (int32_t r = 1; r < rows; ++r)
            CHECK(list.list(r) == s.agencyTable->rows[static_cast<size_t>(r - 1)],
                  "agency row \"" + list.list(r) + "\" is not the table's");
    }

    s.agencies->setCrystalStyle(crystal);
    std::string text;
    try {
        text = s.agencies->ReturnedText();
    } catch (const DataSourceError&) {
        CHECK(!s.agencyTable && all == 0 && yours == 0, "agency pick unreadable with a table read");
        return;
    }
    if (all == 1 || yours == 1) {
        CHECK(text == (all == 1 ? "+" : "-"), "agency box criterion \"" + text + "\"");
        return;
    }
    std::vector<std::string> picked;
    if (rows > 0 && list.selected(0)) picked.push_back("*");
    for (int32_t r = 1; r < rows; ++r)
        if (list.selected(r)) picked.push_back(s.agencyTable->codes[static_cast<size_t>(r - 1)]);
    checkCriterion(text, crystal, picked, "", "agency");
}

void checkStatuses(Screen& s, bool crystal) {
    Site& site = s.form.site("RYXPolicyStatus");
    auto& list = site.child<HListBox>("LstPolicyStatus");
    CHECK(list.listCount() == 8, "policy statuses lost a row");
    s.statuses->setCrystalStyle(crystal);
    const std::string text = s.statuses->ReturnedText();
    if (site.child<HCheckBox>("ChkAll").value() == 1) {
        CHECK(text == "+", "all policies not \"+\"");
        return;
    }
    std::vector<std::string> picked;
    for (int32_t r = 0; r < 8; ++r)
        if (list.selected(r)) picked.push_back(kStatusCodes[r]);
    checkCriterion(text, crystal, picked, ",", "policy status");
}

void checkDates(Screen& s) {
    for (bool crystal : {!s.dates->CrystalStyle(), s.dates->CrystalStyle()}) {
        s.dates->setCrystalStyle(crystal);
        checkDate(s.dates->StartDate(), crystal, "StartDate");
        checkDate(s.dates->EndDate(), crystal, "EndDate");
    }
}

void checkScreen(Screen& s, bool readDates) {
    Site& dates = s.form.site("RYXDateRange");
    checkDateBox(dates.child<HMaskedEdit>("MskDate", 0));
    checkDateBox(dates.child<HMaskedEdit>("MskDate", 1));
    if (readDates) {  // reading fills blank dates and tidies typed ones
        checkDates(s);
        checkDateBox(dates.child<HMaskedEdit>("MskDate", 0));
        checkDateBox(dates.child<HMaskedEdit>("MskDate", 1));
    }

    Site& range = s.form.site("RYXRangeSelector");
    const int32_t length = range.child<HTextBox>("RYXT", 0).maxLength();
    CHECK(length >= 0 && length == range.child<HTextBox>("RYXT", 1).maxLength(),
          "the range boxes differ in maximum length");
    CHECK(s.range->MaxLength() == Variant(length), "MaxLength is not the boxes' length");

    // Each criterion in the other syntax first, then in its own, which is left as it was.
    for (bool crystal : {!s.agencies->CrystalStyle(), s.agencies->CrystalStyle()})
        checkAgencies(s, crystal);
    for (bool crystal : {!s.statuses->CrystalStyle(), s.statuses->CrystalStyle()})
        checkStatuses(s, crystal);
    s.form.clearEvents();
    for (const auto& site : s.form.sites())
        site->clearRecords();
}

// ---- the steps -----------------------------------------------------------------------------

// A call of the host: it may fail with the library's own errors, never otherwise.
template <class Call>
void host(Call&& call) {
    try {
        call();
    } catch (const Error&) {
    }
}

Control& anyControl(Screen& s, FuzzedDataProvider& in) {
    Control* controls[] = {s.dates, s.range, s.agencies, s.statuses};
    return *in.PickValueInArray(controls);
}

void setDateRange(Screen& s, FuzzedDataProvider& in) {
    RYXDateRange& d = *s.dates;
    switch (in.ConsumeIntegralInRange(0, 12)) {
        case 0:
            return host(
                [&] { d.setStartDate(in.ConsumeBool() ? Variant(dateLike(in)) : oddVariant(in)); });
        case 1:
            return host(
                [&] { d.setEndDate(in.ConsumeBool() ? Variant(dateLike(in)) : oddVariant(in)); });
        case 2:
            return host([&] { d.setDateStyle(oddNumber(in)); });
        case 3:
            return host([&] { d.setAllowBlank(oddNumber(in)); });
        case 4:
            return host([&] { d.setMonth(oddNumber(in)); });
        case 5:
            return host([&] {
                d.setYear(in.ConsumeBool() ? in.ConsumeIntegralInRange(1590, 2210) : oddNumber(in));
            });
        case 6:
            return host([&] { d.setCrystalStyle(in.ConsumeBool()); });
        case 7:
            d.ImageClick = in.ConsumeBool();
            return;
        case 8:
            return host([&] { d.setCalendarPosition(oddNumber(in)); });
        case 9:
            return host([&] { d.setCaption(in.ConsumeRandomLengthString(20)); });
        case 10:
            return host([&] { d.setFootNote(in.ConsumeRandomLengthString(20)); });
        case 11:
            return host([&] { d.setShowCalendar(in.ConsumeBool()); });
        default:
            return host([&] { (void)d.d_DefaultDate(in.ConsumeIntegral<uint8_t>()); });
    }
}

void setRangeSelector(Screen& s, FuzzedDataProvider& in) {
    static const char* kTypes[] = {"policyno", "PolicyNo", "name",      "familycode",
                                   "pincode",  "plan",     "phsdept",   "receiptnonsc",
                                   "date",     "Date",     " policyno", ""};
    RYXRangeSelector& r = *s.range;
    switch (in.ConsumeIntegralInRange(0, 10)) {
        case 0:
            return host([&] {
                r.setControlType(in.ConsumeBool() ? std::string(in.PickValueInArray(kTypes))
                                                  : in.ConsumeRandomLengthString(12));
            });
        case 1:
            return host([&] { r.setStartText(in.ConsumeRandomLengthString(12)); });
        case 2:
            return host([&] { r.setEndText(in.ConsumeRandomLengthString(12)); });
        case 3:
            return host([&] { r.setMaxLength(oddVariant(in)); });
        case 4:
            return host([&] { r.setTextType(static_cast<RYXRgSelTxtType>(oddNumber(in))); });
        case 5:
            return host([&] { r.setSelStart(oddVariant(in), oddVariant(in)); });
        case 6:
            return host([&] { r.setSellength(oddVariant(in), oddVariant(in)); });
        case 7:
            return host([&] { r.setCaption(in.ConsumeRandomLengthString(12)); });
        case 8:
            return host([&] { r.setFootNote(in.ConsumeRandomLengthString(12)); });
        case 9:
            return host([&] { r.setButtonVisible(in.ConsumeBool()); });
        default:
            return host([&] {
                (void)r.SelStart(oddVariant(in));
                (void)r.Sellength(oddVariant(in));
            });
    }
}

void setDatabaseName(Screen& s, const std::string& name) {
    if (!s.form.userMode()) {  // the designer keeps the name and reads nothing
        s.agencies->setDatabaseName(name);
        CHECK(s.agencies->DatabaseName() == name, "DatabaseName not kept in the designer");
        return;
    }
    auto expected = Databases::contents(name);
    try {
        s.agencies->setDatabaseName(name);
        CHECK(expected.has_value(), "agency list filled from an unreadable file " + name);
        s.agencyTable = std::move(expected);
    } catch (const DataSourceError& e) {
        CHECK(!expected, "agency list not filled from a readable file " + name + ": " + e.what());
        CHECK(std::string(e.what()).find(name) != std::string::npos,
              std::string("the database error does not name the file: ") + e.what());
        s.agencyTable.reset();
    }
}

void setAgencies(Screen& s, FuzzedDataProvider& in) {
    RYXAgencySelection& a = *s.agencies;
    switch (in.ConsumeIntegralInRange(0, 5)) {
        case 0: {
            const auto& names = databases().names();
            return setDatabaseName(s,
                                   names[in.ConsumeIntegralInRange<size_t>(0, names.size() - 1)]);
        }
        case 1:
            return host([&] { a.setDefaultSetting(oddVariant(in)); });
        case 2:
            return host([&] { a.setCrystalStyle(in.ConsumeBool()); });
        case 3:
            return host([&] { a.setForeColor(oddColor(in)); });
        case 4:
            return host([&] { a.setButtonBackColor(oddColor(in)); });
        default:
            databases().replaceLive(in.ConsumeIntegralInRange<size_t>(0, 3));
            return;
    }
}

void setStatuses(Screen& s, FuzzedDataProvider& in) {
    RYXPolicyStatus& p = *s.statuses;
    switch (in.ConsumeIntegralInRange(0, 3)) {
        case 0:
            return host([&] { p.setDefaultSetting(oddVariant(in)); });
        case 1:
            return host([&] { p.setCrystalStyle(in.ConsumeBool()); });
        case 2:
            return host([&] { p.setForeColor(oddColor(in)); });
        default:
            return host([&] { (void)p.DefaultSetting(); });
    }
}

std::string keyNotation(FuzzedDataProvider& in) {
    static const char* kKeys[] = {"{TAB}",  "+{TAB}",  "{HOME}",  "{END}",  "{DEL}",   "{BS}",
                                  "{LEFT}", "{RIGHT}", "{UP}",    "{DOWN}", "{ENTER}", "~",
                                  "%p",     "%a",      "%{DOWN}", "^x",     "/",       "1",
                                  "5",      "9",       "0",       " ",      "a",       "Z",
                                  "-",      "{INS}",   "{ESC}",   "{"};
    std::string keys;
    const int n = in.ConsumeIntegralInRange(1, 6);
    for (int i = 0; i < n; ++i)
        keys += in.ConsumeBool() ? std::string(in.PickValueInArray(kKeys))
                                 : in.ConsumeRandomLengthString(3);
    return keys;
}

int16_t anyKeyCode(FuzzedDataProvider& in) {
    static const int16_t kCodes[] = {
        vk::Back, vk::Tab, vk::Return, vk::Escape, vk::Space,  vk::End,    vk::Home,
        vk::Left, vk::Up,  vk::Right,  vk::Down,   vk::Insert, vk::Delete, vk::Divide,
        'A',      'P',     'Z',        '0',        '5',        '9',        191};
    return in.ConsumeBool() ? in.PickValueInArray(kCodes) : in.ConsumeIntegral<int16_t>();
}

Node& anyNode(Screen& s, FuzzedDataProvider& in) {
    return *s.nodes[in.ConsumeIntegralInRange<size_t>(0, s.nodes.size() - 1)];
}

Site& anySite(Screen& s, FuzzedDataProvider& in) {
    return *s.form.sites()[in.ConsumeIntegralInRange<size_t>(0, s.form.sites().size() - 1)];
}

// Saves the screen, closes it and opens the saved form on a new screen; the new screen saves
// the same document.
void saveAndReload(std::unique_ptr<Screen>& s, CivilDate today) {
    const std::string saved = formToJson(s->form);
    auto reopened = std::make_unique<Screen>(&saved, today, s->form.userMode());
    CHECK(formToJson(reopened->form) == saved,
          "a saved form does not load as it was saved:\n" + saved + "\n---\n" +
              formToJson(reopened->form));
    s = std::move(reopened);
    // The host names the agency database again once the screen is open.
    if (s->form.userMode()) setDatabaseName(*s, databases().names().front());
}

void step(std::unique_ptr<Screen>& screen, FuzzedDataProvider& in, CivilDate today) {
    Screen& s = *screen;
    Form& f = s.form;
    switch (in.ConsumeIntegralInRange(0, 23)) {
        case 0:
            return f.click(anyNode(s, in));
        case 1:
            return f.doubleClick(anyNode(s, in));
        case 2: {
            Node& n = anyNode(s, in);
            const auto button = in.ConsumeIntegral<int16_t>();
            const auto shift = in.ConsumeIntegral<int16_t>();
            const float x = in.ConsumeFloatingPoint<float>(), y = in.ConsumeFloatingPoint<float>();
            const int which = in.ConsumeIntegralInRange(0, 2);
            if (which == 0) return f.mouseDown(n, button, shift, x, y);
            if (which == 1) return f.mouseMove(n, button, shift, x, y);
            return f.mouseUp(n, button, shift, x, y);
        }
        case 3: {
            Site& site =
                in.ConsumeBool() ? f.site("RYXAgencySelection") : f.site("RYXPolicyStatus");
            auto& list = site.child<HListBox>(
                &site == &f.site("RYXPolicyStatus") ? "LstPolicyStatus" : "LstAgMast");
            if (list.listCount() > 0)
                f.clickRow(list, in.ConsumeIntegralInRange<int32_t>(0, list.listCount() - 1));
            return;
        }
        case 4:
            return f.press(anyKeyCode(in), in.ConsumeIntegralInRange<int16_t>(0, 7));
        case 5:
            return f.type(in.ConsumeRandomLengthString(8));
        case 6:
            return f.type(dateLike(in));
        case 7:
            return f.keys(keyNotation(in));
        case 8:
            return in.ConsumeBool() ? f.tab() : f.shiftTab();
        case 9:
            return f.focusControl(anySite(s, in));
        case 10:
            return host([&] { f.setFocus(anyNode(s, in)); });
        case 11:
            return f.accessKey(anySite(s, in),
                               in.ConsumeBool() ? int16_t{13} : in.ConsumeIntegral<int16_t>());
        case 12:
            return f.setInsertToggle(in.ConsumeBool());
        case 13:
            return host([&] { anyControl(s, in).setLocked(in.ConsumeBool()); });
        case 14:
            return host([&] { anyControl(s, in).setEnabled(in.ConsumeBool()); });
        case 15:
            return setDateRange(s, in);
        case 16:
            return setRangeSelector(s, in);
        case 17:
            return setAgencies(s, in);
        case 18:
            return setStatuses(s, in);
        case 19:
            s.host = static_cast<HostAnswer>(in.ConsumeIntegralInRange(0, 6));
            s.hostKey = in.ConsumeIntegral<int16_t>();
            return;
        case 20:
            return checkDates(s);
        case 21:
            return saveAndReload(screen, today);
        case 22:
            return f.setUserMode(!f.userMode());
        default: {
            Site& site = anySite(s, in);
            return host([&] {
                site.resizeByHost(in.ConsumeFloatingPoint<float>(),
                                  in.ConsumeFloatingPoint<float>());
            });
        }
    }
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size) {
    FuzzedDataProvider in(data, size);
    const CivilDate today{in.ConsumeIntegralInRange(1000, 9999), in.ConsumeIntegralInRange(1, 12),
                          in.ConsumeIntegralInRange(1, 28)};
    const bool readDatesEveryStep = in.ConsumeBool();
    databases().replaceLive(0);
    auto screen = std::make_unique<Screen>(nullptr, today, true);
    setDatabaseName(*screen, databases().names().front());
    for (int steps = 0; steps < 200 && in.remaining_bytes() > 0; ++steps) {
        step(screen, in, today);
        checkScreen(*screen, readDatesEveryStep);
    }
    return 0;
}
