#include "nidus/Preferences/PreferenceReport.h"

#include <utility>

#include "HomePlatform/Json/JsonText.h"
#include "HomePlatform/System/DeviceInformation.h"
#include "HomePlatform/System/Preferences.h"

namespace nidus {
namespace {

using Rule = NDLogThreshold::Rule;

std::string jsonTextOf(const JsonValue& value) {
  std::string text;
  appendJson(text, value);
  return text;
}

std::string_view nameOf(Rule rule) {
  if (rule == Rule::level) return "NidusLogLevel";
  return rule == Rule::developerLevel ? "NidusDeveloperLogLevel" : "default";
}

std::string buildOf(const NDLogThreshold& threshold) {
  return threshold.isInternalBuild ? "an internal build" : "a customer build";
}

/// What the log level is, and the rule that decided it.
std::string decisionOf(const NDLogThreshold& threshold) {
  std::string level = "the log level is " + levelText(threshold.level);
  if (threshold.rule == Rule::floor) return level + ", the default of " + buildOf(threshold);
  return level.append(" by ").append(nameOf(threshold.rule));
}

/// Why a log level that is set does not count.
std::string refusalOf(std::string_view key, const NDLogThreshold& threshold) {
  const bool isLevel = key == nameOf(Rule::level);
  if (isLevel) return "it is below " + std::to_string(threshold.leastLevel);
  if (threshold.rule == Rule::level) return "NidusLogLevel comes first";
  return "it is not from " + std::to_string(threshold.floor) + " to " +
         std::to_string(threshold.greatestDeveloperLevel);
}

std::string effectOfLevel(std::string_view key, const NDLogThreshold& threshold, bool isValid) {
  if (!isValid || key == nameOf(threshold.rule)) return decisionOf(threshold);
  return "it does not count, as " + refusalOf(key, threshold) + ": " + decisionOf(threshold);
}

std::string effectOfBuild(const NDLogThreshold& threshold) {
  return "this is " + buildOf(threshold) + ", whose default log level is " +
         levelText(threshold.floor) + "; programs that run ask for it once";
}

std::string effectOfHomes(HomePlatform& platform) {
  return areHomesConfigured(platform) ? "commands and syncs look for the homes"
                                      : "commands and syncs find nothing, whatever homes there are";
}

std::string effectOf(const PreferenceKey& key, HomePlatform& platform,
                     const NDLogThreshold& threshold, bool isValid) {
  if (key.kind == PreferenceKey::Kind::level) return effectOfLevel(key.name, threshold, isValid);
  if (key.name == DeviceInformation::kInternalBuild) return effectOfBuild(threshold);
  return effectOfHomes(platform);
}

}  // namespace

bool areHomesConfigured(HomePlatform& platform) {
  return platform.preferences()
      ->booleanForKey_domain_container(Preferences::kHomesConfigured, Preferences::kDomain,
                                       platform.homeConfigurationPath())
      .value;
}

PreferenceReport reportOn(const PreferenceKey& key, HomePlatform& platform,
                          const NDLogThreshold& threshold) {
  PreferenceReport report{std::string(key.name), std::nullopt, std::string(key.purpose), ""};
  const auto values = platform.preferenceValues();
  const auto found = values.find(report.name);
  if (found != values.end()) report.value = found->second;
  const bool isValid = report.value && isValidPreference(key, *report.value);
  if (report.value && !isValid) {
    report.effect = "it is not valid and counts as not set, give " + expectationOf(key) + "; ";
  }
  report.effect += effectOf(key, platform, threshold, isValid);
  return report;
}

PreferenceReport reportOnUnread(const std::string& name, const JsonValue& value) {
  return {name, value, "Nothing reads it.", "none; remove it with nidus preferences unset"};
}

std::string textOf(const PreferenceReport& report) {
  return report.name + ": " + (report.value ? jsonTextOf(*report.value) : "not set") + "\n  " +
         report.purpose + "\n  Now: " + report.effect + ".\n";
}

JsonValue jsonOf(const PreferenceReport& report) {
  const JsonValue value = report.value ? *report.value : JsonValue();
  return {JsonValue::Object{{"key", {report.name}},
                            {"value", value},
                            {"purpose", {report.purpose}},
                            {"effect", {report.effect}}}};
}

JsonValue jsonOf(const NDLogThreshold& threshold) {
  return {JsonValue::Object{{"level", {std::int64_t{threshold.level}}},
                            {"rule", {std::string(nameOf(threshold.rule))}},
                            {"floor", {std::int64_t{threshold.floor}}},
                            {"internalBuild", {threshold.isInternalBuild}}}};
}

}  // namespace nidus
