#include <benchmark/benchmark.h>

#include <chrono>
#include <cstdio>
#include <cstdlib>
#include <string_view>

#include "Measurement.h"
#include "ResultTable.h"
#include "Roads.h"

// Prints the table of all rows, or of those that --benchmark_filter names; --row_ms=N says for how
// long each row is repeated. --road=NAME goes one road whose instructions are counted.
int main(int argc, char** argv) {
  constexpr std::string_view kRowTime = "--row_ms=";
  constexpr std::string_view kRoad = "--road=";
  if (argc == 2 && std::string_view(argv[1]).starts_with(kRoad)) {
    return nidus::goRoad(argv[1] + kRoad.size()) ? 0 : 1;
  }
  benchmark::Initialize(&argc, argv);
  for (int i = 1; i < argc; ++i) {
    const std::string_view argument = argv[i];
    if (!argument.starts_with(kRowTime)) {
      std::fprintf(stderr, "NidusBenchmarks: unknown argument %s; see --help\n", argv[i]);
      return 2;
    }
    nidus::setTimePerRow(std::chrono::milliseconds(std::atoi(argv[i] + kRowTime.size())));
  }
  nidus::ResultTable table;
  return benchmark::RunSpecifiedBenchmarks(&table) > 0 ? 0 : 1;
}
