// Without the Qt widgets there is no Qt list to measure.
#include "benchmarks.h"

namespace ryx::bench {

void registerQtBenchmarks(const AgencyTables&, std::vector<Pair>&) {}

}  // namespace ryx::bench
