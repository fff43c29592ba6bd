#include <benchmark/benchmark.h>
#include <malloc.h>

#include <charconv>
#include <chrono>
#include <cstddef>
#include <cstdio>
#include <cstdlib>
#include <limits>
#include <string_view>

#include "Measurement.h"
#include "ResultTable.h"
#include "Roads.h"

namespace {

constexpr std::string_view kRowTime = "--row_ms=";
constexpr std::string_view kRoad = "--road=";
constexpr std::string_view kServices = "--services=";

bool asksForRoad(int argc, char** argv) {
  return (argc == 2 || (argc == 3 && std::string_view(argv[2]).starts_with(kServices))) &&
         std::string_view(argv[1]).starts_with(kRoad);
}

/// The number that `text` is as a whole; 0, which is the size of no home, for anything else.
std::size_t numberFrom(std::string_view text) {
  std::size_t number = 0;
  const char* const end = text.data() + text.size();
  const auto [stop, error] = std::from_chars(text.data(), end, number);
  return error == std::errc() && stop == end ? number : 0;
}

bool goRoadAskedFor(int argc, char** argv) {
  const std::size_t services =
      argc == 3 ? numberFrom(argv[2] + kServices.size()) : nidus::kServicesOfRoad;
  return nidus::goRoad(argv[1] + kRoad.size(), services);
}

/// Memory that is given back to the system and taken again is the system's work, and whether a run
/// does so hangs on what happens to lie at the end of the heap.
void keepMemory() {
  constexpr int kGreatestThreshold = 32 << 20;
  mallopt(M_MMAP_THRESHOLD, kGreatestThreshold);
  mallopt(M_TRIM_THRESHOLD, std::numeric_limits<int>::max());
}

}  // namespace

// Prints the table of all rows, or of those that --benchmark_filter names; --row_ms=N says for how
// long each row is repeated. --road=NAME [--services=N] goes one road whose instructions are
// counted.
int main(int argc, char** argv) {
  if (asksForRoad(argc, argv)) return goRoadAskedFor(argc, argv) ? 0 : 1;
  keepMemory();
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
