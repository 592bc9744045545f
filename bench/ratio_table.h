// Each benchmark beside its baseline: the medians of the run, paired by name, as a table of
// ratios with the target of each.
#pragma once

#include <benchmark/benchmark.h>

#include <map>
#include <string>
#include <vector>

namespace ryx::bench {

// Prints as the console reporter does and keeps the median CPU time of every benchmark.
class MedianCollector : public benchmark::ConsoleReporter {
  public:
    MedianCollector();
    void ReportRuns(const std::vector<Run>& runs) override;
    // Seconds per iteration; 0 when the benchmark did not run.
    double median(const std::string& name) const;

  private:
    std::map<std::string, double> medians_;
};

struct RatioRow {
    std::string what;     // "Fill 1,000,000 rows"
    double subject = 0;   // the library's figure
    double baseline = 0;  // the baseline's figure in the same run
    double target = 0;    // the ratio not to exceed; 0 for a figure shown for comparison
    std::string unit;     // "ms" or "MB"
};

// The table, one row a comparison, with the ratio and whether it meets its target.
void printRatioTable(const std::vector<RatioRow>& rows);

}  // namespace ryx::bench
