#include "PlugIn/Invariants.h"

#include <algorithm>
#include <array>
#include <set>
#include <string_view>

#include "PlatformModel/Assistant/VAHAConstants.h"
#include "PlatformModel/System/NDTextMatching.h"
#include "PlugIn/Expectation.h"
#include "PlugIn/Reply.h"
#include "Support/DataText.h"
#include "Support/HomeRoundTrip.h"

namespace nidus {
namespace {

/// The records that the filter has left at its end.
NDDictionaryList recordsOf(const Performance& performance) {
  return performance.steps.empty() ? NDDictionaryList() : performance.steps.back().kept;
}

bool isEqualButDiacritics(const NDString& a, const NDString& b) {
  return a && b && isEqualIgnoringDiacritics(a.view(), b.view());
}

/// What the records that a step of the filter has kept have in common.
struct StepRule {
  std::string_view step;
  bool (*holds)(const NDDictionary& record, const VAHASearchCriteriaFilter& filter);
};

constexpr std::array kStepRules = {
    StepRule{"home",
             [](const NDDictionary& record, const VAHASearchCriteriaFilter& filter) {
               const NDString home = textAt(record, "objectHome");
               const bool isHome = textAt(record, "objectType") == VAHAEntityTypeHOMEValue;
               return !filter.homeName() || isHome || home == filter.homeName();
             }},
    StepRule{"entityType",
             [](const NDDictionary& record, const VAHASearchCriteriaFilter& filter) {
               const NDString type =
                   filter.entityType() ? filter.entityType() : NDString(VAHAEntityTypeSERVICEValue);
               return textAt(record, "objectType") == type;
             }},
    StepRule{"serviceName",
             [](const NDDictionary& record, const VAHASearchCriteriaFilter& filter) {
               return isEqualButDiacritics(textAt(record, "objectName"), filter.serviceName());
             }},
    StepRule{"sceneName",
             [](const NDDictionary& record, const VAHASearchCriteriaFilter& filter) {
               return isEqualButDiacritics(textAt(record, "objectName"), filter.sceneName());
             }},
    StepRule{"room and zone",
             [](const NDDictionary& record, const VAHASearchCriteriaFilter& filter) {
               return !filter.roomName() ||
                      isEqualButDiacritics(textAt(record, "objectRoom"), filter.roomName());
             }},
    StepRule{"group",
             [](const NDDictionary& record, const VAHASearchCriteriaFilter& filter) {
               const NDDictionaryList& groups = listAt(record, "objectGroups");
               return std::find(groups.begin(), groups.end(),
                                NDDictionaryValue(filter.groupName())) != groups.end();
             }},
    StepRule{"attribute",
             [](const NDDictionary& record, const VAHASearchCriteriaFilter& /*filter*/) {
               return textAt(record, "objectType") == VAHAEntityTypeSERVICEValue;
             }},
};

/// Each step keeps nothing but records of the step before, and those alone that it is about.
std::string brokenFilter(const Performance& performance) {
  const auto* filter =
      dynamic_cast<const VAHASearchCriteriaFilter*>(performance.command->filter().get());
  const NDDictionaryList* before = nullptr;
  for (const FilterStep& step : performance.steps) {
    const auto* rule = std::find_if(kStepRules.begin(), kStepRules.end(),
                                    [&step](const auto& each) { return each.step == step.name; });
    for (const NDDictionaryValue& record : step.kept) {
      if (before && std::find(before->begin(), before->end(), record) == before->end()) {
        return "The step \"" + step.name + "\" of the filter makes a record up.";
      }
      if (rule != kStepRules.end() && filter && !rule->holds(formOf(record), *filter)) {
        return "The step \"" + step.name + "\" of the filter keeps a record that it is not about.";
      }
    }
    before = &step.kept;
  }
  return {};
}

/// The identifier under which a service has to be found.
std::string identifierOf(const NDUUID& home, const CharacteristicAddress& address) {
  return "x-corvane-nidus://local/service?id=" + std::to_string(address.service) +
         "&accessory=" + address.accessory.UUIDString().str() + "&home=" + home.UUIDString().str();
}

/// Homes are asked about services that the filter has found, and about nothing else.
std::string brokenTargets(const Performance& performance) {
  std::set<std::string> found;
  for (const NDDictionaryValue& record : recordsOf(performance)) {
    found.insert(textAt(formOf(record), "objectIdentifier").str());
  }
  for (const PlatformCall& call : performance.calls) {
    for (const CharacteristicAddress& address : call.characteristics) {
      if (!found.contains(identifierOf(call.home, address))) {
        return "A home is asked about a service that the filter has not found.";
      }
    }
  }
  return {};
}

/// Says whether a result may be about a record: what the entity says is what the record says.
bool isAbout(const NDDictionary& entity, const NDDictionary& record) {
  const auto agrees = [&](std::string_view field, std::string_view key) {
    const NDString text = textAt(entity, field);
    return !text || text == textAt(record, key);
  };
  return textAt(entity, "name") == textAt(record, "objectName") &&
         textAt(entity, "entityType") == textAt(record, "objectType") &&
         agrees("home", "objectHome") && agrees("room", "objectRoom") &&
         agrees("zone", "objectZone");
}

std::string brokenEntities(const Performance& performance, const NDDictionary& reply) {
  const NDDictionaryList records = recordsOf(performance);
  for (const NDDictionaryValue& result : listAt(reply, "actionResults")) {
    const NDDictionary& entity = formAt(formOf(result), "entity");
    const bool isKnown = std::any_of(records.begin(), records.end(), [&entity](const auto& record) {
      return isAbout(entity, formOf(record));
    });
    if (!isKnown) return "A result is about something that the filter has not found.";
  }
  return {};
}

/// The outcome of a reply and its results say the same.
std::string brokenOutcome(const NDDictionary& reply) {
  const NDString outcome = textAt(reply, "commandOutcome");
  const bool hasResults = !listAt(reply, "actionResults").empty();
  if (outcome == VAHACommandOutcomeCOMMAND_SUCCESSValue) {
    return hasResults ? "" : "A success has no results.";
  }
  if (hasResults) return "A reply with " + outcome.str() + " has results.";
  const bool isKnown = outcome == VAHACommandOutcomeCOMMAND_FAILUREValue ||
                       outcome == VAHACommandOutcomeFOUND_NO_MATCHING_ENTITIESValue ||
                       outcome == VAHACommandOutcomeREQUIRES_UNLOCKValue;
  return isKnown ? "" : "A reply has an outcome that is none.";
}

/// Whether results that do not match the action's value are left out.
bool mayLeaveOut(const VAHACommand& command) {
  const VAHAActionRef action = firstAction(command);
  return action && action->value() && familyOf(command) == ActionFamily::read &&
         !(action->actionType() == VAHAActionTypeGET_TARGET_VALUEValue);
}

/// The results are those that the homes' answers make.
std::string brokenResults(const Performance& performance, const Expectation& expected,
                          const NDDictionary& report) {
  if (performance.calls.empty()) return {};
  OutcomeCounts wanted = expected.outcomes;
  OutcomeCounts found = outcomesOf(report);
  const std::string success(VAHAActionOutcomeSUCCESSValue);
  if (mayLeaveOut(*performance.command) && found[success] <= wanted[success]) {
    wanted.erase(success);
    found.erase(success);
  }
  std::erase_if(wanted, [](const auto& each) { return each.second == 0; });
  std::erase_if(found, [](const auto& each) { return each.second == 0; });
  if (wanted == found) return {};
  return "The results are " + description(found) + " where the homes' answers make " +
         description(wanted) + '.';
}

std::string brokenReplies(const Performance& performance, const Expectation& expected) {
  const auto& replies = performance.replies;
  const std::size_t count = expected.unlockReplies + (expected.hasReport ? 1 : 0);
  if (replies.size() != count) {
    return std::to_string(replies.size()) + " replies came instead of " + std::to_string(count) +
           '.';
  }
  for (std::size_t i = 0; i < replies.size(); ++i) {
    if (std::string broken = brokenOutcome(replies[i]); !broken.empty()) return broken;
    const bool isUnlock =
        textAt(replies[i], "commandOutcome") == VAHACommandOutcomeREQUIRES_UNLOCKValue;
    if (isUnlock != (i < expected.unlockReplies)) return "An unlock is asked for in vain or late.";
  }
  if (!expected.hasReport) return {};
  const NDDictionary& report = replies.back();
  if (std::string broken = brokenEntities(performance, report); !broken.empty()) return broken;
  return brokenResults(performance, expected, report);
}

/// A command fails before it asks anybody, and for a reason.
std::string brokenFailure(const Performance& performance) {
  for (const NDDictionary& reply : performance.replies) {
    const bool isFailure =
        textAt(reply, "commandOutcome") == VAHACommandOutcomeCOMMAND_FAILUREValue;
    if (isFailure && !performance.calls.empty()) return "A command fails that has asked homes.";
    if (isFailure && familyOf(*performance.command) == ActionFamily::limit) {
      const bool isUnscoped = performance.steps.empty();
      if (!isUnscoped) return "A question about limits fails.";
    }
  }
  return {};
}

}  // namespace

std::string brokenInvariant(const Performance& performance) {
  if (!performance.isHandlerReleased) return "The reply handler is kept after all is over.";
  const Expectation expected = expectationOf(performance);
  for (const std::string& broken :
       {expected.broken, brokenFilter(performance), brokenTargets(performance),
        brokenReplies(performance, expected), brokenFailure(performance)}) {
    if (!broken.empty()) return broken;
  }
  if (dataText(expected.homes) == dataText(performance.after)) return {};
  return "The homes are not as the calls leave them.\n--- expected\n" +
         homeDocumentOf(expected.homes) + "--- actual\n" + homeDocumentOf(performance.after);
}

}  // namespace nidus
