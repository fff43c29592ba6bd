#include "HomePlatform/System/Preferences.h"
#include "HomePlatform/System/ShellWord.h"
#include "nidus/Doctor/Checks.h"
#include "nidus/Doctor/Remedy.h"
#include "nidus/Preferences/PreferenceKeys.h"

namespace nidus {
namespace {

void checkMember(const JsonValue::Member& member, const std::string& file, Findings& findings) {
  const std::string place = file + ": " + member.first;
  const std::string name = shellWord(member.first);
  const PreferenceKey* key = findPreferenceKey(member.first);
  if (!key) {
    findings.push_back(
        {Severity::note, place, "nothing reads it", "nidus preferences unset " + name});
  } else if (!isValidPreference(*key, member.second)) {
    findings.push_back({Severity::attention, place,
                        "it counts as missing, as it is not " + expectationOf(*key),
                        "nidus preferences set " + name + " VALUE"});
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
