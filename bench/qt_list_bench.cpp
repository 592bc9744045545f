// The Qt agency list filled from the table, against the plain Qt way: the rows read through
// the SQLite C API into a QStringListModel shown in a QListView with uniform item sizes. Both
// are shown on the offscreen platform and count until the view has taken the rows.
#include <sqlite3.h>

#include <QApplication>
#include <QListView>
#include <QStringListModel>

#include "benchmarks.h"
#include "ryx/qt/widgets.h"
#include "ryx/sqlite/sqlite_record_source.h"

namespace ryx::bench {
namespace {

void settle() {
    QCoreApplication::processEvents();
    QCoreApplication::processEvents();
}

void fillAgencyWidget(benchmark::State& state, const AgencyTable& table) {
    qt::ControlHost::setRecordSourceFactory(sqlite::makeRecordSource);
    qt::AgencySelectionWidget widget;
    widget.show();
    settle();
    auto* view = qobject_cast<QListView*>(widget.childWidget("LstAgMast"));
    for (auto _ : state) {
        widget.control().setDatabaseName(table.file.string());
        settle();
    }
    if (view->model()->rowCount() != static_cast<int>(table.rows) + 1)
        state.SkipWithError("the view does not hold every agency");
}

void fillStringListModel(benchmark::State& state, const AgencyTable& table) {
    QListView view;
    view.setUniformItemSizes(true);
    view.resize(157, 60);  // the agency list's size at 96 dpi
    QStringListModel model;
    view.setModel(&model);
    view.show();
    settle();
    for (auto _ : state) {
        QStringList rows{QStringLiteral("*   Others")};
        sqlite3* db = nullptr;
        sqlite3_open_v2(table.file.c_str(), &db, SQLITE_OPEN_READONLY, nullptr);
        sqlite3_stmt* query = nullptr;
        sqlite3_prepare_v2(db, kAgencyQuery, -1, &query, nullptr);
        while (sqlite3_step(query) == SQLITE_ROW) {
            const auto* code = reinterpret_cast<const char*>(sqlite3_column_text(query, 0));
            const auto* name = reinterpret_cast<const char*>(sqlite3_column_text(query, 1));
            rows.append(QString::fromUtf8(code, sqlite3_column_bytes(query, 0)) +
                        QStringLiteral("  ") +
                        QString::fromUtf8(name, sqlite3_column_bytes(query, 1)));
        }
        sqlite3_finalize(query);
        sqlite3_close(db);
        model.setStringList(rows);
        settle();
    }
    if (model.rowCount() != static_cast<int>(table.rows) + 1)
        state.SkipWithError("the query missed rows");
}

}  // namespace

void registerQtBenchmarks(const AgencyTables& tables, std::vector<Pair>& pairs) {
    const AgencyTable& big = tables.get(tables.all().back().rows, false);
    const std::string name = "QtFill/" + std::to_string(big.rows);
    benchmark::RegisterBenchmark((name + "/subject").c_str(), [&big](benchmark::State& s) {
        fillAgencyWidget(s, big);
    })->Unit(benchmark::kMillisecond);
    benchmark::RegisterBenchmark((name + "/baseline").c_str(), [&big](benchmark::State& s) {
        fillStringListModel(s, big);
    })->Unit(benchmark::kMillisecond);
    pairs.push_back({name, "Qt list fill " + rowsText(big.rows), 1.5});
}

}  // namespace ryx::bench
