#include <array>
#include <string_view>

#include "HomePlatform/System/DeviceInformation.h"
#include "HomePlatform/System/Preferences.h"
#include "nidus/Doctor/Checks.h"
#include "nidus/Doctor/Remedy.h"

namespace nidus {
namespace {

enum class Type { boolean, integer };

struct KnownKey {
  std::string_view key;
  Type type;
};

constexpr std::array kKnownKeys = {KnownKey{Preferences::kHomesConfigured, Type::boolean},
                                   KnownKey{"NidusLogLevel", Type::integer},
                                   KnownKey{"NidusDeveloperLogLevel", Type::integer},
                                   KnownKey{DeviceInformation::kInternalBuild, Type::boolean}};

const KnownKey* knownKey(std::string_view name) {
  for (const KnownKey& known : kKnownKeys) {
    if (known.key == name) return &known;
  }
  return nullptr;
}

bool isOf(Type type, const JsonValue& value) {
  return type == Type::boolean ? std::holds_alternative<bool>(value.content)
                               : std::holds_alternative<std::int64_t>(value.content);
}

void checkMember(const JsonValue::Member& member, const std::string& file, Findings& findings) {
  const std::string place = file + ": " + member.first;
  const std::string key = shellWord(member.first);
  const KnownKey* known = knownKey(member.first);
  if (!known) {
    findings.push_back({Severity::note, place, "nothing uses it",
                        "remove it with nidus preferences unset " + key});
  } else if (!isOf(known->type, member.second)) {
    const bool isBoolean = known->type == Type::boolean;
    findings.push_back({Severity::attention, place,
                        std::string("it is no ") + (isBoolean ? "true or false" : "whole number") +
                            ", so it counts as missing",
                        "nidus preferences set " + key + (isBoolean ? " true" : " 5")});
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
