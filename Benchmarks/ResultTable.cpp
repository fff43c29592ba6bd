#include "ResultTable.h"

#include <array>
#include <cstdio>
#include <string>

#include "Measurement.h"

namespace nidus {
namespace {

constexpr int kNameWidth = 52;

std::string quantity(double value, Unit unit) {
  std::array<char, 32> text{};
  if (unit == Unit::bytes) {
    std::snprintf(text.data(), text.size(), "%.0f B", value);
  } else if (unit == Unit::commands) {
    std::snprintf(text.data(), text.size(), "%.1f", value);
  } else if (value < 10'000) {
    std::snprintf(text.data(), text.size(), "%.1f ns", value);
  } else if (value < 10'000'000) {
    std::snprintf(text.data(), text.size(), "%.1f us", value / 1e3);
  } else {
    std::snprintf(text.data(), text.size(), "%.1f ms", value / 1e6);
  }
  return text.data();
}

std::string formOf(benchmark::BigO growth) {
  switch (growth) {
    case benchmark::o1:
      return "O(1)";
    case benchmark::oLogN:
      return "O(log N)";
    case benchmark::oN:
      return "O(N)";
    case benchmark::oNLogN:
      return "O(N log N)";
    case benchmark::oNSquared:
      return "O(N^2)";
    case benchmark::oNCubed:
      return "O(N^3)";
    default:
      return "?";
  }
}

}  // namespace

bool ResultTable::ReportContext(const Context& /*context*/) {
  std::printf("%-*s %7s %13s %13s %8s %6s  %s\n", kNameWidth, "benchmark", "size", "ours", "floor",
              "ratio", "goal", "met");
  return true;
}

void ResultTable::ReportRuns(const std::vector<Run>& runs) {
  for (const Run& run : runs) {
    if (run.error_occurred) {
      std::printf("%-*s %s\n", kNameWidth, run.benchmark_name().c_str(), run.error_message.c_str());
    } else if (run.report_big_o) {
      printGrowth(run);
    } else if (run.report_rms) {
      std::printf(", %.0f %% off\n", 100 * run.GetAdjustedRealTime());
    } else {
      printRow(run);
    }
  }
  std::fflush(stdout);
}

void ResultTable::Finalize() { std::printf("%d of %d goals met, %d rows\n", met_, goals_, rows_); }

void ResultTable::printRow(const Run& run) {
  const double ours = run.counters.at("ours");
  const double floor = run.counters.at("floor");
  const double goal = run.counters.at("goal");
  const auto unit = static_cast<Unit>(static_cast<int>(run.counters.at("unit")));
  const double ratio = ours / floor;
  ++rows_;
  std::printf("%-*s %7lld %13s %13s %8.2f ", kNameWidth, run.report_label.c_str(),
              static_cast<long long>(run.complexity_n), quantity(ours, unit).c_str(),
              quantity(floor, unit).c_str(), ratio);
  if (goal == 0) {
    std::printf("%6s\n", "-");
    return;
  }
  const bool isMet = run.counters.at("isLeast") != 0 ? ratio >= goal : ratio <= goal;
  ++goals_;
  met_ += isMet ? 1 : 0;
  std::printf("%6.1f  %s\n", goal, isMet ? "yes" : "NO");
}

void ResultTable::printGrowth(const Run& run) {
  std::printf("%-*s growth: %s times %s", kNameWidth, "", formOf(run.complexity).c_str(),
              quantity(run.GetAdjustedRealTime(), Unit::nanoseconds).c_str());
}

}  // namespace nidus
