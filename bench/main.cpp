// ryx-bench: the agency control's benchmarks, each beside its baseline, with the ratio table
// at the end.
//   ryx-bench [--rows=1000,100000,1000000] [Google Benchmark flags]
// Repetitions run in random order so that a baseline and its subject share the machine's
// moods; the table compares medians of CPU time.
#include <chrono>
#include <cstdio>
#include <cstring>
#include <string>
#include <vector>

#include "benchmarks.h"

#ifdef RYX_BENCH_QT
#include <QApplication>
#endif

namespace {

std::vector<size_t> parseRows(const char* text) {
    std::vector<size_t> rows;
    for (const char* at = text; *at;) {
        char* end = nullptr;
        rows.push_back(std::strtoull(at, &end, 10));
        at = *end == ',' ? end + 1 : end;
        if (end == at && *at) break;
    }
    return rows;
}

}  // namespace

int main(int argc, char** argv) {
    using namespace ryx::bench;
    if (argc == 4 && std::strcmp(argv[1], "--memory-probe") == 0)
        return memoryProbe(argv[2], argv[3]);

    std::vector<size_t> sizes = {1000, 100000, 1000000};
    std::vector<char*> args = {argv[0]};
    std::string defaults[] = {
        "--benchmark_repetitions=5", "--benchmark_enable_random_interleaving=true",
        "--benchmark_report_aggregates_only=true", "--benchmark_min_time=0.2"};
    for (std::string& d : defaults)
        args.push_back(d.data());
    for (int i = 1; i < argc; ++i) {
        if (std::strncmp(argv[i], "--rows=", 7) == 0)
            sizes = parseRows(argv[i] + 7);
        else
            args.push_back(argv[i]);  // later flags override the defaults
    }
    int count = static_cast<int>(args.size());

#ifdef RYX_BENCH_QT
    if (qEnvironmentVariableIsEmpty("QT_QPA_PLATFORM")) qputenv("QT_QPA_PLATFORM", "offscreen");
    QApplication app(count, args.data());
#endif
    benchmark::Initialize(&count, args.data());
    if (benchmark::ReportUnrecognizedArguments(count, args.data())) return 1;

    const auto start = std::chrono::steady_clock::now();
    AgencyTables tables(sizes);
    std::printf(
        "Agency tables of %s rows made in %.1f s\n",
        [&] {
            std::string list;
            for (size_t rows : sizes)
                list += (list.empty() ? "" : ", ") + rowsText(rows);
            return list;
        }()
            .c_str(),
        std::chrono::duration<double>(std::chrono::steady_clock::now() - start).count());

    std::vector<Pair> pairs;
    registerAgencyBenchmarks(tables, pairs);
    registerQtBenchmarks(tables, pairs);
    MedianCollector collector;
    benchmark::RunSpecifiedBenchmarks(&collector);

    std::vector<RatioRow> rows;
    for (const Pair& p : pairs)
        rows.push_back({p.what, collector.median(p.name + "/subject") * 1e3,
                        collector.median(p.name + "/baseline") * 1e3, p.target, "ms"});
    const AgencyTable& big = tables.get(sizes.back(), false);
    for (bool covering : {false, true}) {
        const AgencyTable& t = tables.get(big.rows, covering);
        const double agency = static_cast<double>(measureFillMemory(argv[0], t, "agency"));
        const double strings = static_cast<double>(measureFillMemory(argv[0], t, "strings"));
        const std::string layout = covering ? ", covering index" : "";
        rows.push_back({"Memory " + rowsText(t.rows) + layout + " / raw bytes", agency / 1e6,
                        static_cast<double>(t.rawBytes) / 1e6, 2.0, "MB"});
        rows.push_back({"  vector of strings" + layout, strings / 1e6,
                        static_cast<double>(t.rawBytes) / 1e6, 0, "MB"});
    }
    printRatioTable(rows);
    std::printf("\n%d cores; times are medians of CPU time; %.0f s in all\n",
                benchmark::CPUInfo::Get().num_cpus,
                std::chrono::duration<double>(std::chrono::steady_clock::now() - start).count());
    benchmark::Shutdown();
    return 0;
}
