// The headless agency control where its work grows with the agency table: filling the list,
// building the criterion text, and selecting every row.
#include <sqlite3.h>

#include <algorithm>
#include <map>
#include <memory>

#include "benchmarks.h"
#include "ryx/agency_selection.h"
#include "ryx/headless/form.h"
#include "ryx/sqlite/sqlite_record_source.h"

namespace ryx::bench {
namespace {

// An agency control on a headless form in run mode, reading SQLite files.
struct AgencyForm {
    AgencyForm() {
        form.setRecordSourceFactory(sqlite::makeRecordSource);
        control = &form.add<RYXAgencySelection>("ag", 2820, 1740);
        auto& site = form.site("ag");
        list = &site.child<headless::HListBox>("LstAgMast");
        all = &site.child<headless::HCheckBox>("chkAgmast", 0);
    }
    headless::Form form;
    RYXAgencySelection* control;
    headless::HListBox* list;
    headless::HCheckBox* all;
};

// A control filled from the table with every agency row picked: "All Agencies", then a click
// on "*   Others" takes it off and leaves pick mode. Kept between repetitions.
AgencyForm& pickedForm(const AgencyTable& table) {
    static std::map<size_t, std::unique_ptr<AgencyForm>> forms;
    auto& form = forms[table.rows];
    if (!form) {
        form = std::make_unique<AgencyForm>();
        form->control->setDatabaseName(table.file.string());
        form->form.click(*form->all);
        form->form.clickRow(*form->list, 0);
    }
    return *form;
}

const std::vector<std::string>& codesOf(const AgencyTable& table) {
    static std::map<size_t, std::vector<std::string>> codes;
    auto& c = codes[table.rows];
    if (c.empty()) c = readCodes(table.file);
    return c;
}

// ---- fill ----------------------------------------------------------------------------------

void fillAgency(benchmark::State& state, const AgencyTable& table) {
    AgencyForm f;
    for (auto _ : state)
        f.control->setDatabaseName(table.file.string());
    if (f.list->listCount() != static_cast<int32_t>(table.rows) + 1)
        state.SkipWithError("the list does not hold every agency");
}

// Prepare, step, and copy both columns into a vector of strings.
void fillStrings(benchmark::State& state, const AgencyTable& table) {
    std::vector<std::string> values;
    for (auto _ : state) {
        values.clear();
        sqlite3* db = nullptr;
        sqlite3_open_v2(table.file.c_str(), &db, SQLITE_OPEN_READONLY, nullptr);
        sqlite3_stmt* query = nullptr;
        sqlite3_prepare_v2(db, kAgencyQuery, -1, &query, nullptr);
        while (sqlite3_step(query) == SQLITE_ROW) {
            for (int column = 0; column < 2; ++column) {
                const auto* text =
                    reinterpret_cast<const char*>(sqlite3_column_text(query, column));
                values.emplace_back(text, static_cast<size_t>(sqlite3_column_bytes(query, column)));
            }
        }
        sqlite3_finalize(query);
        sqlite3_close(db);
        benchmark::DoNotOptimize(values.data());
    }
    if (values.size() != 2 * table.rows) state.SkipWithError("the query missed rows");
}

// ---- criterion text ------------------------------------------------------------------------

void textAgency(benchmark::State& state, const AgencyTable& table, bool crystal) {
    AgencyForm& f = pickedForm(table);
    f.control->setCrystalStyle(crystal);
    size_t length = 0;
    for (auto _ : state) {
        std::string text = f.control->ReturnedText();
        length = text.size();
        benchmark::DoNotOptimize(text.data());
    }
    state.counters["bytes"] = static_cast<double>(length);
}

// The same codes joined into one reserved string: quoted and comma-separated in brackets for
// the formula form, end to end for the plain form. Not inlined, so that callgrind can count it
// beside ReturnedText.
[[gnu::noinline]] std::string joinCodes(const std::vector<std::string>& codes, size_t total,
                                        bool crystal) {
    std::string text;
    text.reserve(total);
    if (crystal) {
        text += '[';
        for (const std::string& c : codes) {
            if (text.size() > 1) text += ',';
            text += '"';
            text += c;
            text += '"';
        }
        text += ']';
    } else {
        for (const std::string& c : codes)
            text += c;
    }
    return text;
}

void textJoin(benchmark::State& state, const AgencyTable& table, bool crystal) {
    const std::vector<std::string>& codes = codesOf(table);
    size_t total = 2;
    for (const std::string& c : codes)
        total += c.size() + 3;
    size_t length = 0;
    for (auto _ : state) {
        std::string text = joinCodes(codes, total, crystal);
        length = text.size();
        benchmark::DoNotOptimize(text.data());
    }
    state.counters["bytes"] = static_cast<double>(length);
}

// ---- selection -----------------------------------------------------------------------------

// "All Agencies" selects every row; a click on one row takes it off and leaves pick mode.
void selectAgency(benchmark::State& state, const AgencyTable& table) {
    AgencyForm& f = pickedForm(table);
    for (auto _ : state) {
        f.form.click(*f.all);
        f.form.clickRow(*f.list, 1);
    }
    if (f.all->value() != 0 || f.list->selected(1) || !f.list->selected(2))
        state.SkipWithError("the clicks did not select as expected");
    f.form.clickRow(*f.list, 0);  // back to every agency row picked, "*   Others" not
    f.form.clickRow(*f.list, 1);
    f.form.clearEvents();
}

void selectFlags(benchmark::State& state, const AgencyTable& table) {
    std::vector<uint8_t> flags(table.rows + 1);
    for (auto _ : state) {
        std::fill(flags.begin(), flags.end(), uint8_t{1});
        flags[1] = 0;
        benchmark::DoNotOptimize(flags.data());
        benchmark::ClobberMemory();
    }
}

template <class Subject, class Baseline>
void registerPair(std::vector<Pair>& pairs, const std::string& name, const std::string& what,
                  double target, Subject subject, Baseline baseline) {
    benchmark::RegisterBenchmark((name + "/subject").c_str(), subject)
        ->Unit(benchmark::kMillisecond);
    benchmark::RegisterBenchmark((name + "/baseline").c_str(), baseline)
        ->Unit(benchmark::kMillisecond);
    pairs.push_back({name, what, target});
}

}  // namespace

std::string rowsText(size_t rows) {
    std::string digits = std::to_string(rows), text;
    for (size_t i = 0; i < digits.size(); ++i) {
        if (i > 0 && (digits.size() - i) % 3 == 0) text += ',';
        text += digits[i];
    }
    return text;
}

void registerAgencyBenchmarks(const AgencyTables& tables, std::vector<Pair>& pairs) {
    for (const AgencyTable& t : tables.all()) {
        const std::string layout = t.covering ? "covering" : "plain";
        registerPair(
            pairs, "Fill/" + std::to_string(t.rows) + "/" + layout,
            "Fill " + rowsText(t.rows) + (t.covering ? ", covering index" : ""), 1.2,
            [&t](benchmark::State& s) { fillAgency(s, t); },
            [&t](benchmark::State& s) { fillStrings(s, t); });
    }
    for (const AgencyTable& t : tables.all()) {
        if (t.covering) continue;
        for (bool crystal : {true, false}) {
            registerPair(
                pairs,
                std::string("Text/") + std::to_string(t.rows) + (crystal ? "/formula" : "/plain"),
                "Criterion text " + rowsText(t.rows) + (crystal ? ", formula" : ", plain"), 1.5,
                [&t, crystal](benchmark::State& s) { textAgency(s, t, crystal); },
                [&t, crystal](benchmark::State& s) { textJoin(s, t, crystal); });
        }
    }
    const AgencyTable& big = tables.get(tables.all().back().rows, false);
    registerPair(
        pairs, "Select/" + std::to_string(big.rows), "Selection " + rowsText(big.rows), 3.0,
        [&big](benchmark::State& s) { selectAgency(s, big); },
        [&big](benchmark::State& s) { selectFlags(s, big); });
}

}  // namespace ryx::bench
