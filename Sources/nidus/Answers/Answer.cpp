#include "nidus/Answers/Answer.h"

#include <algorithm>
#include <cstddef>

#include "PlatformModel/Assistant/VAHAConstants.h"
#include "nidus/Answers/LimitsTable.h"
#include "nidus/Answers/OutcomeSentence.h"
#include "nidus/Answers/ReplyForm.h"
#include "nidus/Answers/ValueText.h"
#include "nidus/Terminal/TextTable.h"

namespace nidus {
namespace {

/// An outcome in a word, on a terminal with a symbol and a colour too.
TextCell outcomeCell(const std::string& outcome, const TerminalStyle& style) {
  const std::string word = outcomeWord(outcome);
  if (!style.hasColour) return word;
  if (outcome == VAHAActionOutcomeSUCCESSValue) return {"✓ " + word, Colour::good};
  if (outcome == VAHAActionOutcomeREAD_ONLYValue) return {"! " + word, Colour::warning};
  return {"✗ " + word, Colour::bad};
}

/// That a scene was run says its outcome alone.
std::string resultText(const Order& order, const ObjectResult& result,
                       const Vocabulary& vocabulary) {
  return order.kind == Order::Kind::run ? "" : valueText(result.value, order.attribute, vocabulary);
}

std::string resultTable(const Order& order, const ReplyForm& reply, const Vocabulary& vocabulary,
                        const TerminalStyle& style) {
  TextTable table({"OBJECT", "ROOM", "HOME", order.attribute, "OUTCOME"});
  for (const ObjectResult& result : reply.results) {
    table.addRow({result.nameText(), result.room, result.home,
                  resultText(order, result, vocabulary), outcomeCell(result.outcome, style)});
  }
  return table.text(style);
}

std::vector<ReplyForm> formsOf(const Replies& replies) {
  std::vector<ReplyForm> forms;
  forms.reserve(replies.size());
  for (const NDDictionary& reply : replies) forms.push_back(replyForm(reply));
  std::stable_partition(forms.begin(), forms.end(), requiresUnlock);
  return forms;
}

/// One reply of several: what has no object then says nothing about what matches.
std::string replyText(const Order& order, const ReplyForm& reply, bool isAlone,
                      const Vocabulary& vocabulary, const TerminalStyle& style) {
  const bool isEmptyCompanion = !isAlone && reply.results.empty() && !requiresUnlock(reply);
  const std::string sentence =
      isEmptyCompanion ? kNoResultsSentence : outcomeSentence(order, reply, vocabulary);
  return resultTable(order, reply, vocabulary, style) + sentence + '\n';
}

std::string commandText(const Order& order, const Replies& replies, const Vocabulary& vocabulary,
                        const TerminalStyle& style) {
  if (replies.empty()) return std::string(kNoReplySentence) + '\n';
  const std::vector<ReplyForm> forms = formsOf(replies);
  if (forms.size() == 1) return replyText(order, forms.front(), true, vocabulary, style);
  std::string text;
  for (std::size_t i = 0; i < forms.size(); ++i) {
    const std::string title =
        "Reply " + std::to_string(i + 1) + " of " + std::to_string(forms.size());
    if (i != 0) text += '\n';
    text += coloured(title, Colour::title, style) + '\n' +
            replyText(order, forms[i], false, vocabulary, style);
  }
  return text;
}

/// An outcome of our own: the plug-in answers what has no limits without a value.
constexpr const char kWithoutLimits[] = "WITHOUT_LIMITS";

/// The reply that a sentence is about: the first with an outcome other than that of one without a
/// limit of its kind, else a success with all objects.
ReplyForm jointReply(const std::vector<ReplyForm>& replies,
                     const std::vector<ObjectLimits>& objects) {
  ReplyForm joint;
  joint.outcome = VAHACommandOutcomeFOUND_NO_MATCHING_ENTITIESValue;
  if (!objects.empty()) joint.outcome = VAHACommandOutcomeCOMMAND_SUCCESSValue;
  for (const ObjectLimits& entry : objects) {
    joint.results.push_back(entry.object);
    if (!entry.hasAny()) joint.results.back().outcome = kWithoutLimits;
  }
  for (const ReplyForm& reply : replies) {
    const bool isUsual = reply.outcome == VAHACommandOutcomeCOMMAND_SUCCESSValue ||
                         reply.outcome == VAHACommandOutcomeFOUND_NO_MATCHING_ENTITIESValue;
    if (!isUsual) return {reply.outcome, {}};
  }
  return joint;
}

std::string limitsText(const Order& order, const std::vector<Replies>& replies,
                       const Vocabulary& vocabulary, const TerminalStyle& style) {
  std::vector<ReplyForm> forms;
  for (const Replies& each : replies) {
    if (each.empty()) return std::string(kNoReplySentence) + '\n';
    forms.push_back(formsOf(each).front());
  }
  const std::vector<ObjectLimits> objects = limitsByObject(forms, order.attribute, vocabulary);
  return limitsTable(objects).text(style) +
         outcomeSentence(order, jointReply(forms, objects), vocabulary) + '\n';
}

bool isWithoutMatch(const NDDictionary& reply) {
  return replyForm(reply).outcome == VAHACommandOutcomeFOUND_NO_MATCHING_ENTITIESValue;
}

}  // namespace

bool isAllWithoutMatch(const std::vector<Replies>& replies) {
  return std::all_of(replies.begin(), replies.end(), [](const Replies& ofCommand) {
    return std::all_of(ofCommand.begin(), ofCommand.end(), isWithoutMatch);
  });
}

std::string answerText(const Order& order, const std::vector<Replies>& replies,
                       const Vocabulary& vocabulary, const TerminalStyle& style) {
  if (order.kind == Order::Kind::limits) return limitsText(order, replies, vocabulary, style);
  std::string text;
  for (const Replies& each : replies) text += commandText(order, each, vocabulary, style);
  return text;
}

}  // namespace nidus
