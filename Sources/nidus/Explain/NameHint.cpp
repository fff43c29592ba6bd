#include "nidus/Explain/NameHint.h"

#include <algorithm>
#include <string_view>

#include "HomePlatform/System/OneLine.h"
#include "PlatformModel/Assistant/VAHAConstants.h"
#include "PlatformModel/System/NDTextMatching.h"
#include "nidus/Explain/Records.h"
#include "nidus/Orders/NearMiss.h"

namespace nidus {
namespace {

/// What the plug-in's steps choose from.
struct StepInput {
  const NDDictionaryList& snapshot;
  const NDDictionaryList& before;
  const NDNAPMetadata& metadata;
};

/// What a step asks for: a name, and the names that there are.
struct NameQuestion {
  std::string_view step;
  const char* noun;
  const NDString& (VAHASearchCriteriaFilter::*name)() const;
  DistinctTexts (*known)(const StepInput& input);
};

DistinctTexts homeNames(const StepInput& input) {
  return textsUnder("objectName", recordsOfType(VAHAEntityTypeHOMEValue, input.snapshot));
}

DistinctTexts entityTypes(const StepInput& input) { return textsUnder("objectType", input.before); }

DistinctTexts serviceTypes(const StepInput& input) {
  DistinctTexts names;
  for (const char* key : {"objectServiceType", "objectAssociatedServiceType"}) {
    for (const std::string& type : textsUnder(key, input.before)) {
      const NDString name = input.metadata.mapToAssistantServiceName(type);
      const bool isNew = std::find(names.begin(), names.end(), name.view()) == names.end();
      if (name && isNew) names.push_back(name.str());
    }
  }
  return names;
}

/// Rooms are looked up in all homes.
DistinctTexts roomNames(const StepInput& input) {
  return textsUnder("objectName", recordsOfType(VAHAEntityTypeROOMValue, input.snapshot));
}

DistinctTexts zoneNames(const StepInput& input) {
  return textsUnder("objectZone", recordsOfType(VAHAEntityTypeROOMValue, input.snapshot));
}

DistinctTexts groupNames(const StepInput& input) {
  return textsUnder("objectGroups", input.before);
}

DistinctTexts objectNames(const StepInput& input) { return textsUnder("objectName", input.before); }

DistinctTexts attributes(const StepInput& input) {
  return attributesOf(input.before, input.metadata);
}

using Filter = VAHASearchCriteriaFilter;

constexpr NameQuestion kQuestions[] = {
    {"home", "home", &Filter::homeName, homeNames},
    {"entityType", "object of the entity type", &Filter::entityType, entityTypes},
    {"serviceType", "service of the type", &Filter::serviceType, serviceTypes},
    {"room and zone", "room", &Filter::roomName, roomNames},
    {"room and zone", "zone", &Filter::zoneName, zoneNames},
    {"group", "group", &Filter::groupName, groupNames},
    {"serviceName", "service", &Filter::serviceName, objectNames},
    {"sceneName", "scene", &Filter::sceneName, objectNames},
    {"attribute", "attribute", &Filter::attribute, attributes},
};

}  // namespace

std::string nameHint(const std::string& noun, const NDString& name,
                     const std::vector<std::string>& known) {
  const std::string shown = onOneLine(name.view());
  const bool isThere = std::any_of(known.begin(), known.end(), [&name](const std::string& text) {
    return isEqualIgnoringDiacritics(text, name.view());
  });
  if (isThere) return "There is the " + noun + ' ' + shown + ", but it matches none of these.\n";
  const std::vector<std::string_view> words(known.begin(), known.end());
  const std::string_view meant = nearMiss(name.view(), words);
  std::string hint = "There is no " + noun + ' ' + shown + " here";
  if (!meant.empty()) hint += "; did you mean " + onOneLine(meant) + '?';
  if (known.empty()) return hint + ".\n";
  return hint + (meant.empty() ? ". " : " ") + "There are: " + enumeration(known) + ".\n";
}

std::string nameHints(const VAHASearchCriteriaFilter& filter, const std::string& step,
                      const NDDictionaryList& snapshot, const NDDictionaryList& before,
                      const NDNAPMetadata& metadata) {
  std::string hints;
  for (const NameQuestion& question : kQuestions) {
    const NDString& name = (filter.*question.name)();
    if (question.step != step || !name) continue;
    hints += nameHint(question.noun, name, question.known({snapshot, before, metadata}));
  }
  return hints;
}

std::vector<std::string> attributesOf(const NDDictionaryList& records,
                                      const NDNAPMetadata& metadata) {
  std::vector<std::string> names;
  for (const std::string& type : textsUnder("objectCharacteristics", records)) {
    const NDString name = metadata.mapToAssistantCharacteristicName(type);
    const bool isNew = std::find(names.begin(), names.end(), name.view()) == names.end();
    if (name && isNew) names.push_back(name.str());
  }
  return names;
}

}  // namespace nidus
