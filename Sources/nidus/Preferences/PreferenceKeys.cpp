#include "nidus/Preferences/PreferenceKeys.h"

#include <algorithm>
#include <array>
#include <cstddef>
#include <optional>

#include "HomePlatform/System/DeviceInformation.h"
#include "HomePlatform/System/Preferences.h"
#include "nidus/Orders/NearMiss.h"
#include "nidus/Orders/ValueWords.h"

namespace nidus {
namespace {

constexpr std::array<std::string_view, 8> kLevelNames = {
    "emergency", "alert", "critical", "error", "warning", "notice", "info", "debug"};

/// The level of that name, or none.
std::optional<std::int64_t> levelNamed(std::string_view name) {
  const auto* found = std::find(kLevelNames.begin(), kLevelNames.end(), name);
  if (found == kLevelNames.end()) return std::nullopt;
  return found - kLevelNames.begin();
}

/// The value that a word stands for; null for another word.
JsonValue valueOfWord(const PreferenceKey& key, const std::string& word) {
  if (key.kind == PreferenceKey::Kind::level) {
    const auto level = levelNamed(word);
    return level ? JsonValue{*level} : JsonValue();
  }
  const auto flag = booleanOf(word, "");
  return flag ? JsonValue{*flag} : JsonValue();
}

/// What `text` is as JSON; null when it is none.
JsonValue jsonValueOf(const std::string& text) {
  try {
    return parseJson(text, kPreferencesLimits);
  } catch (const JsonError&) {
    return {};
  }
}

}  // namespace

const std::vector<PreferenceKey>& preferenceKeys() {
  using Kind = PreferenceKey::Kind;
  static const std::vector<PreferenceKey> kKeys = {
      {Preferences::kHomesConfigured, Kind::flag,
       "Whether the plug-in looks for homes at all; each import and each edit of homes sets it."},
      {"NidusLogLevel", Kind::level,
       "Which messages are logged, up to which level; counts from 3 on."},
      {"NidusDeveloperLogLevel", Kind::level,
       "Raises the log level above its default, where NidusLogLevel does not count."},
      {DeviceInformation::kInternalBuild, Kind::flag,
       "Whether this device runs an internal build, which logs more by default."},
  };
  return kKeys;
}

const PreferenceKey* findPreferenceKey(std::string_view name) {
  const auto& keys = preferenceKeys();
  const auto found = std::find_if(keys.begin(), keys.end(),
                                  [name](const PreferenceKey& key) { return key.name == name; });
  return found == keys.end() ? nullptr : &*found;
}

Failure unknownPreference(const std::string& name) {
  std::vector<std::string_view> names;
  std::string list;
  for (const PreferenceKey& key : preferenceKeys()) {
    names.push_back(key.name);
    list.append(list.empty() ? "" : ", ").append(key.name);
  }
  const std::string_view meant = nearMiss(name, names);
  const std::string hint =
      meant.empty() ? "they are " : "did you mean " + std::string(meant) + "? They are ";
  return {Failure::Kind::badInput, name + ": there is no such preference; " + hint + list};
}

bool isValidPreference(const PreferenceKey& key, const JsonValue& value) {
  return key.kind == PreferenceKey::Kind::flag
             ? std::holds_alternative<bool>(value.content)
             : std::holds_alternative<std::int64_t>(value.content);
}

Result<JsonValue> readPreference(const PreferenceKey& key, const std::string& text) {
  for (const JsonValue& value : {jsonValueOf(text), valueOfWord(key, text)}) {
    if (isValidPreference(key, value)) return value;
  }
  return Failure{Failure::Kind::badInput, std::string(key.name) + ": \"" + text +
                                              "\" would not be valid; give " + expectationOf(key)};
}

std::string expectationOf(const PreferenceKey& key) {
  if (key.kind == PreferenceKey::Kind::flag) return "true or false";
  return "a level: an integer, or error, warning, notice, info or debug for 3 to 7";
}

std::string levelText(std::int64_t level) {
  std::string number = std::to_string(level);
  if (level < 0) return number;
  const std::size_t last = kLevelNames.size() - 1;
  const auto known = static_cast<std::size_t>(level);
  if (known <= last) return number + " (" + std::string(kLevelNames.at(known)) + ')';
  return number + " (as " + std::to_string(last) + ", " + std::string(kLevelNames.at(last)) + ')';
}

}  // namespace nidus
