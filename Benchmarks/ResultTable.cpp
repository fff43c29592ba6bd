#include "ResultTable.h"

#include <array>
#include <cstdio>
#include <string>
#include <utility>

#include "Growth.h"
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

double ratioIn(const benchmark::BenchmarkReporter::Run& run) {
  return run.counters.at("ours") / run.counters.at("floor");
}

}  // namespace

bool ResultTable::ReportContext(const Context& /*context*/) {
  std::printf("%-*s %7s %13s %13s %8s %6s  %s\n", kNameWidth, "benchmark", "size", "ours", "floor",
              "ratio", "goal", "met");
  return true;
}

void ResultTable::ReportRuns(const std::vector<Run>& runs) {
  for (const Run& run : runs) {
    if (!rowsOfKind_.empty() && run.family_index != rowsOfKind_.front().family_index) printGrowth();
    if (run.error_occurred) {
      std::printf("%-*s %s\n", kNameWidth, run.benchmark_name().c_str(), run.error_message.c_str());
    } else if (run.report_big_o || run.report_rms) {
      if (areBesideFloor()) printFit(run);
    } else if (run.run_type == Run::RT_Iteration) {
      printRow(run);
      rowsOfKind_.push_back(run);
    }
  }
  std::fflush(stdout);
}

void ResultTable::Finalize() {
  printGrowth();
  std::printf("%d of %d goals met, %d rows\n", met_, goals_, rows_);
}

void ResultTable::printRow(const Run& run) {
  const double ours = run.counters.at("ours");
  const double floor = run.counters.at("floor");
  const double goal = run.counters.at("goal");
  const auto unit = static_cast<Unit>(static_cast<int>(run.counters.at("unit")));
  const double ratio = ratioIn(run);
  ++rows_;
  std::printf("%-*s %7lld %13s %13s %8.2f ", kNameWidth, run.report_label.c_str(),
              static_cast<long long>(run.complexity_n), quantity(ours, unit).c_str(),
              quantity(floor, unit).c_str(), ratio);
  if (goal == 0) {
    std::printf("%6s\n", "-");
    return;
  }
  const bool isMet = run.counters.at("isLeast") != 0 ? ratio >= goal : ratio <= goal;
  std::printf("%6.1f  %s\n", goal, count(isMet));
}

void ResultTable::printFit(const Run& run) {
  if (run.report_big_o) {
    std::printf("%-*s fitted to the floor: %.2f times", kNameWidth, "", run.real_accumulated_time);
  } else {
    std::printf(", %.0f %% off\n", 100 * run.GetAdjustedRealTime());
  }
}

bool ResultTable::areBesideFloor() const {
  return !rowsOfKind_.empty() && rowsOfKind_.front().counters.contains("floorPower");
}

void ResultTable::printGrowth() {
  const bool isTold = areBesideFloor();
  const std::vector<Run> rows = std::exchange(rowsOfKind_, {});
  if (!isTold) return;
  std::vector<ValueAtSize> ratios;
  ratios.reserve(rows.size());
  for (const Run& row : rows) {
    ratios.push_back({static_cast<double>(row.complexity_n), ratioIn(row)});
  }
  const auto ratioExponent = exponentOf(ratios);
  if (!ratioExponent) return;
  const auto floor = static_cast<int>(rows.front().counters.at("floorPower"));
  const double exponent = floor + *ratioExponent;
  const int power = powerNextTo(exponent);
  std::printf("%-*s growth beside floor: %-6s (exponent %5.2f) %5s  %s\n", kNameWidth, "",
              textOfPower(power).c_str(), exponent, textOfPower(floor).c_str(),
              count(power <= floor));
}

const char* ResultTable::count(bool isMet) {
  ++goals_;
  met_ += isMet ? 1 : 0;
  return isMet ? "yes" : "NO";
}

}  // namespace nidus
