#include "nidus/Explain/FilterText.h"

#include <algorithm>
#include <array>
#include <vector>

#include "HomePlatform/System/OneLine.h"
#include "PlatformModel/Assistant/VAHAConstants.h"
#include "nidus/Answers/ReplyForm.h"
#include "nidus/Explain/NameHint.h"
#include "nidus/Explain/Records.h"
#include "nidus/MissingHomes.h"
#include "nidus/Terminal/TextTable.h"

namespace nidus {
namespace {

using Filter = VAHASearchCriteriaFilter;

/// A step of the filter, by the plug-in's name for it.
struct StepWords {
  std::string_view step;
  std::string_view title;
  std::array<const NDString& (Filter::*)() const, 2> fields;  ///< The second may be null.
  std::string_view implied;  ///< What is asked for when no field is there.
};

constexpr std::array kSteps = {
    StepWords{"snapshot", "all objects", {nullptr, nullptr}, ""},
    StepWords{"home", "home", {&Filter::homeName, nullptr}, "the primary home, as none is named"},
    StepWords{"entityType",
              "entity type",
              {&Filter::entityType, nullptr},
              "SERVICE, as the filter has an attribute"},
    StepWords{"serviceType", "service type", {&Filter::serviceType, nullptr}, ""},
    StepWords{"room and zone", "room and zone", {&Filter::roomName, &Filter::zoneName}, ""},
    StepWords{"group", "group", {&Filter::groupName, nullptr}, ""},
    StepWords{"serviceName", "name of service", {&Filter::serviceName, nullptr}, ""},
    StepWords{"sceneName", "name of scene", {&Filter::sceneName, nullptr}, ""},
    StepWords{"attribute", "attribute", {&Filter::attribute, nullptr}, ""},
};

const StepWords* wordsOf(const std::string& step) {
  const auto* found = std::find_if(kSteps.begin(), kSteps.end(),
                                   [&step](const StepWords& words) { return words.step == step; });
  return found == kSteps.end() ? nullptr : found;
}

std::string askedBy(const StepWords& words, const Filter& filter) {
  std::string asked;
  for (const auto field : words.fields) {
    if (!field || !(filter.*field)()) continue;
    asked += (asked.empty() ? "" : ", ") + onOneLine((filter.*field)().view());
  }
  return asked.empty() ? std::string(words.implied) : asked;
}

std::string stepTable(const Filter& filter, const Rehearsal& rehearsal,
                      const TerminalStyle& style) {
  TextTable table({"STEP", "ASKED FOR", "KEPT", "DROPPED"});
  std::size_t before = 0;
  for (const FilterStep& step : rehearsal.steps) {
    const StepWords* words = wordsOf(step.name);
    const std::size_t kept = step.kept.size();
    // What matches twice is kept twice.
    const std::size_t dropped = before > kept ? before - kept : 0;
    table.addRow({words ? std::string(words->title) : step.name,
                  words ? askedBy(*words, filter) : "", std::to_string(kept),
                  dropped == 0 ? "" : std::to_string(dropped)});
    before = kept;
  }
  return table.text(style);
}

/// Why nothing is left after the last of several steps.
std::string emptyText(const Filter& filter, const Rehearsal& rehearsal,
                      const NDNAPMetadata& metadata) {
  const FilterStep& last = rehearsal.steps.back();
  const NDDictionaryList& before = rehearsal.steps[rehearsal.steps.size() - 2].kept;
  const StepWords* words = wordsOf(last.name);
  const std::string title = words ? std::string(words->title) : last.name;
  return "Nothing is left; the step \"" + title + "\" had: " + namesOf(before) + ".\n" +
         nameHints(filter, last.name, rehearsal.steps.front().kept, before, metadata);
}

/// What is said of a type of services that the vocabulary does not have; empty of others.
std::string unknownTypeText(const Filter& filter, HomePlatform& platform) {
  const NDString& type = filter.serviceType();
  if (!type || platform.metadata()->mapFromAssistantServiceName(type)) return {};
  std::vector<std::string> known;
  for (const ServiceEntry& entry : platform.vocabulary().services) {
    known.push_back(entry.assistantName.str());
  }
  return "Nothing is left, as the vocabulary does not have the type.\n" +
         nameHint("service type", type, known);
}

/// What may keep a record more than once.
std::string_view reasonToRepeat(const std::string& step) {
  if (step == "room and zone")
    return "several rooms have this name; they are looked up in all homes";
  if (step == "serviceType") return "both their own type and that of what is plugged in match";
  return {};
}

/// Why some records are kept more than once; empty when none is.
std::string repetitionText(const Rehearsal& rehearsal) {
  std::string text;
  bool wasRepeated = false;
  for (const FilterStep& step : rehearsal.steps) {
    const bool isRepeated = textsUnder("objectIdentifier", step.kept).size() < step.kept.size();
    const std::string_view reason = reasonToRepeat(step.name);
    if (isRepeated && !wasRepeated && !reason.empty()) {
      text.append("Some are kept more than once, as ").append(reason).append(".\n");
    }
    wasRepeated = isRepeated;
  }
  return text;
}

std::string searchText(const Filter& filter, const Rehearsal& rehearsal, HomePlatform& platform,
                       const TerminalStyle& style) {
  const std::string table = stepTable(filter, rehearsal, style);
  const NDDictionaryList& kept = rehearsal.steps.back().kept;
  if (kept.empty()) return table + emptyText(filter, rehearsal, *platform.metadata());
  const std::string unknownType = unknownTypeText(filter, platform);
  if (!unknownType.empty()) return table + unknownType;
  return table + "It keeps: " + namesOf(kept) + ".\n" + repetitionText(rehearsal);
}

bool isRefused(const Rehearsal& rehearsal) {
  return std::any_of(rehearsal.replies.begin(), rehearsal.replies.end(),
                     [](const NDDictionary& reply) {
                       return replyForm(reply).outcome == VAHACommandOutcomeCOMMAND_FAILUREValue;
                     });
}

/// Why no step ran.
std::string noStepText(const Filter* filter, const Rehearsal& rehearsal, HomePlatform& platform) {
  const std::string missing = missingHomesText(!rehearsal.after.empty(), platform);
  if (!missing.empty()) return missing + ".\n";
  if (!filter) return "Nothing is found: only a filter that searches finds objects.\n";
  if (isRefused(rehearsal)) {
    return "It did not run: there are several homes, the filter names none, and none is the "
           "primary one. Name a home.\n";
  }
  return "There are no objects in the homes.\n";
}

}  // namespace

std::string filterText(const VAHACommand& command, const Rehearsal& rehearsal,
                       HomePlatform& platform, const TerminalStyle& style) {
  const auto* filter = dynamic_cast<const Filter*>(command.filter().get());
  if (!filter || rehearsal.steps.empty()) return noStepText(filter, rehearsal, platform);
  return searchText(*filter, rehearsal, platform, style);
}

}  // namespace nidus
