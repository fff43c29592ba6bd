#include "nidus/Answers/OutcomeSentence.h"

#include <algorithm>
#include <cstddef>
#include <initializer_list>
#include <iterator>
#include <string_view>
#include <vector>

#include "PlatformModel/Assistant/VAHAConstants.h"
#include "nidus/Answers/ValueText.h"
#include "nidus/Orders/OrderValue.h"

namespace nidus {
namespace {

using Results = std::vector<ObjectResult>;

/// More than these are counted; the table names them all.
constexpr std::size_t kNamesInSentence = 4;

std::string lowerWords(std::string_view type) {
  std::string words(type);
  for (char& c : words) {
    if (c >= 'A' && c <= 'Z') c = static_cast<char>(c - 'A' + 'a');
    if (c == '_') c = ' ';
  }
  return words;
}

bool endsWithAny(std::string_view word, std::initializer_list<std::string_view> ends) {
  return std::any_of(ends.begin(), ends.end(),
                     [word](std::string_view end) { return word.ends_with(end); });
}

std::string plural(const std::string& noun) {
  const bool isVowelBeforeY = endsWithAny(noun, {"ay", "ey", "oy", "uy"});
  if (noun.ends_with('y') && !isVowelBeforeY) return noun.substr(0, noun.size() - 1) + "ies";
  return noun + (endsWithAny(noun, {"s", "x", "ch", "sh"}) ? "es" : "s");
}

/// What all of these objects are: "light", or "object" when they differ.
std::string nounOf(const Results& results) {
  constexpr std::string_view kUnnamedType = "CUSTOM";
  const std::string& type = results.front().type;
  const bool isOne = std::all_of(results.begin(), results.end(),
                                 [&type](const ObjectResult& r) { return r.type == type; });
  return isOne && !type.empty() && type != kUnnamedType ? lowerWords(type) : "object";
}

Results withOutcome(const Results& results, std::string_view outcome) {
  Results those;
  std::copy_if(results.begin(), results.end(), std::back_inserter(those),
               [outcome](const ObjectResult& r) { return r.outcome == outcome; });
  return those;
}

/// What was asked for: "POWER is on".
std::string questionOf(const Order& order, const Vocabulary& vocabulary) {
  for (const VAHAActionRef& action : order.commands.front()->actions()) {
    if (!action->value()) continue;
    return order.attribute + " is " +
           valueText(action->value()->dictionary(), order.attribute, vocabulary);
  }
  return order.attribute + " is so";
}

/// What was done with objects that succeeded, behind their number.
std::string deedOf(const Order& order, const Vocabulary& vocabulary) {
  switch (order.kind) {
    case Order::Kind::get:
      return " read";
    case Order::Kind::ask:
      return " whose " + questionOf(order, vocabulary);
    case Order::Kind::set:
      return " set";
    case Order::Kind::raise:
      return " raised";
    case Order::Kind::lower:
      return " lowered";
    case Order::Kind::toggle:
      return " toggled";
    case Order::Kind::limits:
      return " with limits";
    case Order::Kind::run:
      break;
  }
  return " run";
}

std::string countOf(std::size_t count, const std::string& noun) {
  if (count == 0) return "No " + noun;
  return std::to_string(count) + ' ' + (count == 1 ? noun : plural(noun));
}

std::string namesOf(const Results& results) {
  const std::size_t shown = std::min(results.size(), kNamesInSentence);
  std::string names;
  for (std::size_t i = 0; i < shown; ++i) {
    names += (i == 0 ? "" : ", ") + results[i].nameText();
  }
  const std::size_t more = results.size() - shown;
  return more == 0 ? names : names + " and " + std::to_string(more) + " more";
}

/// The outcomes that are no success, each once: the known ones first.
std::vector<std::string> troublesOf(const Results& results) {
  std::vector<std::string> troubles = {std::string(VAHAActionOutcomeUNREACHABLEValue),
                                       std::string(VAHAActionOutcomeREAD_ONLYValue),
                                       std::string(VAHAActionOutcomeFAILUREValue)};
  for (const ObjectResult& result : results) {
    const bool isListed = std::count(troubles.begin(), troubles.end(), result.outcome) > 0;
    if (!isListed && !result.isSuccess()) troubles.push_back(result.outcome);
  }
  return troubles;
}

/// Where to look when devices refused a number; empty for another order.
std::string limitsHint(const Order& order, const Vocabulary& vocabulary) {
  if (order.kind != Order::Kind::set) return {};
  const auto& entries = vocabulary.characteristics;
  const bool isNumber =
      std::any_of(entries.begin(), entries.end(), [&order](const CharacteristicEntry& entry) {
        return entry.assistantName.view() == order.attribute && isNumeric(entry);
      });
  if (!isNumber) return {};
  return "; the value may be beyond the limits, see nidus limits " + order.attribute;
}

std::string sentenceOf(const Order& order, const Results& results, const Vocabulary& vocabulary) {
  const Results done = withOutcome(results, VAHAActionOutcomeSUCCESSValue);
  std::string sentence =
      countOf(done.size(), nounOf(done.empty() ? results : done)) + deedOf(order, vocabulary);
  for (const std::string& trouble : troublesOf(results)) {
    const Results those = withOutcome(results, trouble);
    if (those.empty()) continue;
    sentence +=
        ", " + std::to_string(those.size()) + ' ' + outcomeWord(trouble) + ": " + namesOf(those);
  }
  const bool hasFailed = !withOutcome(results, VAHAActionOutcomeFAILUREValue).empty();
  return hasFailed ? sentence + limitsHint(order, vocabulary) : sentence;
}

std::string noMatchSentence(const Order& order, const Vocabulary& vocabulary) {
  constexpr const char kRemedy[] = "; see why with nidus explain and the same words";
  if (order.kind == Order::Kind::ask) {
    return "Nothing matches whose " + questionOf(order, vocabulary) + kRemedy;
  }
  const bool isLimits = order.kind == Order::Kind::limits;
  return std::string(isLimits ? "Nothing with limits matches" : "Nothing matches") + kRemedy;
}

}  // namespace

std::string outcomeWord(const std::string& outcome) {
  if (outcome == VAHAActionOutcomeSUCCESSValue) return "ok";
  if (outcome == VAHAActionOutcomeREAD_ONLYValue) return "read-only";
  if (outcome == VAHAActionOutcomeFAILUREValue) return "failed";
  return lowerWords(outcome);
}

bool requiresUnlock(const ReplyForm& reply) {
  return reply.outcome == VAHACommandOutcomeREQUIRES_UNLOCKValue;
}

std::string outcomeSentence(const Order& order, const ReplyForm& reply,
                            const Vocabulary& vocabulary) {
  if (requiresUnlock(reply)) {
    return "The device must be unlocked for this; unlock it (here: leave out --locked) and try "
           "again";
  }
  if (reply.outcome == VAHACommandOutcomeCOMMAND_FAILUREValue) {
    return "The plug-in refused the order; when there are several homes and none is primary, name "
           "one with --home";
  }
  if (reply.outcome == VAHACommandOutcomeFOUND_NO_MATCHING_ENTITIESValue) {
    return noMatchSentence(order, vocabulary);
  }
  if (reply.outcome != VAHACommandOutcomeCOMMAND_SUCCESSValue) {
    return "The plug-in answered with an outcome unknown here: " + reply.outcome;
  }
  return reply.results.empty() ? kNoResultsSentence : sentenceOf(order, reply.results, vocabulary);
}

}  // namespace nidus
