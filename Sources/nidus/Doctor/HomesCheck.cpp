#include <algorithm>

#include "HomePlatform/System/DataFolder.h"
#include "HomePlatform/System/Preferences.h"
#include "nidus/Doctor/Checks.h"

namespace nidus {
namespace {

void checkConfigured(const Examination& examination, Findings& findings) {
  // A file that cannot be read is told where the preferences are.
  if (examination.preferencesFailure) return;
  const JsonValue::Member configured{Preferences::kHomesConfigured, JsonValue{true}};
  const JsonValue::Object& all = examination.preferences;
  if (std::find(all.begin(), all.end(), configured) != all.end()) return;
  findings.push_back({Severity::attention, (examination.folder / Preferences::kFileName).string(),
                      "kHomesConfigured is not true, so the assistant sees no homes",
                      "nidus preferences set kHomesConfigured true"});
}

void checkPrimary(const std::vector<HomeData>& homes, Findings& findings) {
  if (homes.size() < 2) return;
  const auto isPrimary = [](const HomeData& home) { return home.primary; };
  const auto count = std::count_if(homes.begin(), homes.end(), isPrimary);
  if (count == 1) return;
  const std::string remedy = "mark one as primary with nidus home edit";
  if (count == 0) {
    findings.push_back({Severity::attention, "homes",
                        "none is the primary one: an order that names no home fails", remedy});
    return;
  }
  const auto first = std::find_if(homes.begin(), homes.end(), isPrimary);
  findings.push_back({Severity::note, "homes",
                      "several are primary: an order that names none of them is for the first, " +
                          first->name.str(),
                      remedy});
}

}  // namespace

void checkHomes(const Examination& examination, Findings& findings) {
  if (!examination.homes || examination.homes->empty()) {
    findings.push_back({Severity::attention, (examination.folder / kDatabaseFile).string(),
                        "there are no homes yet",
                        "nidus home add home NAME, or nidus home import FILE; nidus demo shows "
                        "what there is to see"});
    return;
  }
  checkConfigured(examination, findings);
  checkPrimary(*examination.homes, findings);
}

}  // namespace nidus
