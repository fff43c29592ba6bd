#include "Load/StressRecord.h"

namespace nidus {
namespace {

constexpr std::size_t kDueChance = 100;

}  // namespace

void StressRecord::complain(const std::string& fault, const std::string& where) {
  const NDLock lock(mutex_);
  Complaint& complaint = complaints_[fault];
  if (complaint.count++ == 0) complaint.first = where;
}

void StressRecord::expectNoSurvivors(const std::string& where) {
  for (const auto& [kind, count] : lives.survivors()) {
    complain(kind + " are left over", std::to_string(count) + " " + where);
  }
}

std::vector<std::string> StressRecord::complaints() const {
  std::vector<std::string> lines;
  const NDLock lock(mutex_);
  for (const auto& [fault, complaint] : complaints_) {
    lines.push_back(std::to_string(complaint.count) + " times: " + fault + " (" + complaint.first +
                    ")");
  }
  return lines;
}

bool StressRecord::isDue(Plant plant) { return isPlanted(plant) && ++chances_ == kDueChance; }

}  // namespace nidus
