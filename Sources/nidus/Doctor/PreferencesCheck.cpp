#include <string>

#include "HomePlatform/System/Preferences.h"
#include "nidus/Doctor/Checks.h"
#include "nidus/Doctor/Remedy.h"
#include "nidus/Preferences/PreferenceKeys.h"

namespace nidus {
namespace {

void checkMember(const JsonValue::Member& member, const std::string& file, Findings& findings) {
  const std::string place = file + ": " + member.first;
  const std::string key = shellWord(member.first);
  const PreferenceKey* known = findPreferenceKey(member.first);
  if (!known) {
    findings.push_back({Severity::note, place, "nothing uses it",
                        "remove it with nidus preferences unset " + key});
  } else if (!isValidPreference(*known, member.second)) {
    const bool isFlag = known->kind == PreferenceKey::Kind::flag;
    findings.push_back({Severity::attention, place,
                        std::string("it is no ") + (isFlag ? "true or false" : "whole number") +
                            ", so it counts as missing",
                        "nidus preferences set " + key + (isFlag ? " true" : " 5")});
  }
}

}  // namespace

void checkPreferences(const Examination& examination, Findings& findings) {
  if (examination.preferencesFailure) {
    findings.push_back(findingOf(*examination.preferencesFailure));
  }
  const std::string file = (examination.folder / Preferences::kFileName).string();
  for (const JsonValue::Member& member : examination.preferences) {
    checkMember(member, file, findings);
  }
}

}  // namespace nidus
