#include "ratio_table.h"

#include <unistd.h>

#include <cstdio>
#include <string>

namespace ryx::bench {

// Coloured on a terminal only, so that a saved run reads plainly.
MedianCollector::MedianCollector()
    : ConsoleReporter(isatty(STDOUT_FILENO) ? OO_Defaults : OO_Tabular) {}

void MedianCollector::ReportRuns(const std::vector<Run>& runs) {
    ConsoleReporter::ReportRuns(runs);
    for (const Run& run : runs) {
        if (run.error_occurred) continue;
        const bool median = run.run_type == Run::RT_Aggregate && run.aggregate_name == "median";
        const bool single = run.run_type == Run::RT_Iteration && run.repetitions <= 1;
        if (!median && !single) continue;
        const double seconds =
            run.GetAdjustedCPUTime() / benchmark::GetTimeUnitMultiplier(run.time_unit);
        medians_[run.run_name.function_name] = seconds;
    }
}

double MedianCollector::median(const std::string& name) const {
    const auto found = medians_.find(name);
    return found == medians_.end() ? 0 : found->second;
}

namespace {

// A figure in a unit that shows it well: times below a millisecond in microseconds.
std::string figure(double value, const std::string& unit) {
    char text[32];
    if (unit == "ms" && value < 1)
        std::snprintf(text, sizeof text, "%9.2f us", value * 1e3);
    else
        std::snprintf(text, sizeof text, "%9.2f %s", value, unit.c_str());
    return text;
}

}  // namespace

void printRatioTable(const std::vector<RatioRow>& rows) {
    std::printf("\n%-44s %12s %12s %8s %7s\n", "Benchmark (medians)", "subject", "baseline",
                "ratio", "target");
    std::printf("%s\n", std::string(92, '-').c_str());
    for (const RatioRow& r : rows) {
        if (r.subject <= 0 || r.baseline <= 0) {
            std::printf("%-44s %12s %12s %8s %6.1fx  %s\n", r.what.c_str(), "-", "-", "-", r.target,
                        "not run");
            continue;
        }
        const double ratio = r.subject / r.baseline;
        std::printf("%-44s %12s %12s %7.2fx", r.what.c_str(), figure(r.subject, r.unit).c_str(),
                    figure(r.baseline, r.unit).c_str(), ratio);
        if (r.target > 0)
            std::printf(" %6.1fx  %s\n", r.target, ratio <= r.target ? "met" : "MISSED");
        else
            std::printf(" %7s\n", "-");
    }
}

}  // namespace ryx::bench
