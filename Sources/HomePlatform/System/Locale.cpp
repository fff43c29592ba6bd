#include "HomePlatform/System/Locale.h"

#include <algorithm>
#include <cstdlib>

namespace nidus {
namespace {

constexpr std::string_view kNonMetricTerritories[] = {"US", "LR", "MM"};
constexpr const char* kVariables[] = {"LC_ALL", "LC_MEASUREMENT", "LANG"};

/// `language_TERRITORY.codeset@modifier`, all but the language optional.
std::string_view territoryOf(std::string_view name) {
  const std::string_view place = name.substr(0, name.find_first_of(".@"));
  const std::size_t separator = place.find('_');
  return separator == std::string_view::npos ? std::string_view() : place.substr(separator + 1);
}

}  // namespace

bool isMetricLocaleName(std::string_view name) {
  return std::find(std::begin(kNonMetricTerritories), std::end(kNonMetricTerritories),
                   territoryOf(name)) == std::end(kNonMetricTerritories);
}

bool isMetricEnvironment() {
  for (const char* variable : kVariables) {
    const char* name = std::getenv(variable);
    if (name && *name != '\0') return isMetricLocaleName(name);
  }
  return true;
}

}  // namespace nidus
