#include "nidus/Explain/Explanation.h"

#include <algorithm>
#include <array>
#include <utility>

#include "PlatformModel/Assistant/VAHAConstants.h"
#include "nidus/Answers/Answer.h"
#include "nidus/Explain/ActionText.h"
#include "nidus/Explain/FilterText.h"
#include "nidus/Explain/HomeIndex.h"
#include "nidus/Explain/Judgement.h"
#include "nidus/Explain/NameHint.h"
#include "nidus/HomeWords.h"

namespace nidus {
namespace {

struct KindOfAction {
  std::string_view type;
  Order::Kind kind;
};

/// Those that are no questions.
constexpr std::array kKinds = {
    KindOfAction{VAHAActionTypeSETValue, Order::Kind::set},
    KindOfAction{VAHAActionTypeSET_TO_MINIMUMValue, Order::Kind::set},
    KindOfAction{VAHAActionTypeSET_TO_MAXIMUMValue, Order::Kind::set},
    KindOfAction{VAHAActionTypeINCREASEValue, Order::Kind::raise},
    KindOfAction{VAHAActionTypeDECREASEValue, Order::Kind::lower},
    KindOfAction{VAHAActionTypeTOGGLEValue, Order::Kind::toggle},
};

Order::Kind kindOf(const VAHAAction& action) {
  for (const KindOfAction& each : kKinds) {
    if (action.actionType() == each.type) {
      const bool isScene = action.attribute() == VAHAAttributeENABLEDValue;
      return isScene ? Order::Kind::run : each.kind;
    }
  }
  return action.value() ? Order::Kind::ask : Order::Kind::get;
}

std::string section(const std::string& title, const TerminalStyle& style) {
  return coloured(title, Colour::title, style) + '\n';
}

/// What the filter kept in the end.
NDDictionaryList keptBy(const Rehearsal& rehearsal) {
  return rehearsal.steps.empty() ? NDDictionaryList() : rehearsal.steps.back().kept;
}

/// Why an action reaches none of the objects that the filter kept; empty when it does, and when it
/// asks for no value.
std::string unreachedText(const VAHACommand& command, const Rehearsal& rehearsal,
                          const NDNAPMetadata& metadata) {
  if (command.actions().empty() || !rehearsal.reached.empty()) return {};
  const NDString& attribute = command.actions().front()->attribute();
  if (!attribute || attribute == VAHAAttributeENABLEDValue) return {};
  return nameHint("attribute", attribute, attributesOf(keptBy(rehearsal), metadata));
}

std::string wholeActionText(const VAHACommand& command, const Rehearsal& rehearsal,
                            const RehearsalStage& stage, const TerminalStyle& style) {
  if (keptBy(rehearsal).empty()) return "There is nothing to act on.\n";
  HomePlatform& platform = stage.platform();
  return unreachedText(command, rehearsal, *platform.metadata()) +
         actionText(rehearsal, HomeIndex(stage.homes()), HomeWords(platform), style);
}

std::vector<Replies> repliesOf(const Explanation& explanation) {
  std::vector<Replies> replies;
  for (const Rehearsal& rehearsal : explanation.rehearsals) replies.push_back(rehearsal.replies);
  return replies;
}

/// The answer as the order itself would show it; the judgement says enough of one with nothing.
std::string wholeAnswerText(const Explanation& explanation, const Vocabulary& vocabulary,
                            const TerminalStyle& style) {
  const std::vector<Replies> replies = repliesOf(explanation);
  return isAllWithoutMatch(replies) ? ""
                                    : answerText(explanation.order, replies, vocabulary, style);
}

constexpr const char kFooter[] =
    "Nothing was done: no device was asked or set. All this comes from a copy of the homes, whose\n"
    "devices answer with the values that were known last; the true devices may answer otherwise.\n";

}  // namespace

Order orderOf(CommandRef command) {
  Order order;
  if (!command->actions().empty()) {
    const VAHAAction& action = *command->actions().front();
    order.kind = kindOf(action);
    order.attribute = action.attribute().str();
  }
  order.commands.push_back(std::move(command));
  return order;
}

Result<Explanation> explain(Order order, RehearsalStage& stage) {
  Explanation explanation{std::move(order), {}};
  for (const CommandRef& command : explanation.order.commands) {
    auto rehearsal = stage.perform(*command);
    if (!rehearsal) return rehearsal.failure();
    explanation.rehearsals.push_back(std::move(*rehearsal));
  }
  return explanation;
}

std::string explanationText(const Explanation& explanation, const RehearsalStage& stage,
                            const TerminalStyle& style) {
  HomePlatform& platform = stage.platform();
  // The commands of one order differ in what they ask of the same objects.
  const VAHACommand& command = *explanation.order.commands.front();
  const Rehearsal& rehearsal = explanation.rehearsals.front();
  const std::string filter = filterText(command, rehearsal, platform, style);
  const std::string action = wholeActionText(command, rehearsal, stage, style);
  const std::string answer = wholeAnswerText(explanation, platform.vocabulary(), style);
  return section("The filter", style) + filter + '\n' + section("The action", style) + action +
         '\n' + section("The answer would be", style) + answer + judgementText(command, rehearsal) +
         '\n' + kFooter;
}

}  // namespace nidus
