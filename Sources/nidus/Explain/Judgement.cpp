#include "nidus/Explain/Judgement.h"

#include <algorithm>
#include <string_view>

#include "HomePlatform/System/LogOutput.h"
#include "HomePlatform/System/OneLine.h"
#include "PlatformModel/Assistant/VAHAConstants.h"
#include "nidus/Answers/ReplyForm.h"

namespace nidus {
namespace {

struct Reason {
  std::string_view outcome;
  std::string_view reason;
};

constexpr Reason kReplyReasons[] = {
    {VAHACommandOutcomeCOMMAND_SUCCESSValue,
     "there is a result; each result has an outcome of its own"},
    {VAHACommandOutcomeFOUND_NO_MATCHING_ENTITIESValue, "there is no result"},
    {VAHACommandOutcomeREQUIRES_UNLOCKValue,
     "a device answers that this one must be unlocked first"},
    {VAHACommandOutcomeCOMMAND_FAILUREValue, "the plug-in refuses the command as it stands"},
};

constexpr Reason kResultReasons[] = {
    {VAHAActionOutcomeSUCCESSValue, "no error is met"},
    {VAHAActionOutcomeUNREACHABLEValue, "the device answers that it can not be reached"},
    {VAHAActionOutcomeREAD_ONLYValue, "the value can not be written"},
    {VAHAActionOutcomeFAILUREValue,
     "the device answers with another error, such as a value beyond its limits"},
};

template <std::size_t kCount>
std::string lineOf(const Reason (&reasons)[kCount], const std::string& outcome) {
  const auto* found =
      std::find_if(std::begin(reasons), std::end(reasons),
                   [&outcome](const Reason& reason) { return reason.outcome == outcome; });
  if (found == std::end(reasons)) return {};
  return outcome + ", because " + std::string(found->reason) + ".\n";
}

/// A reason for each kind of outcome that the results have.
std::string resultLines(const ReplyForm& reply) {
  std::string lines;
  for (const Reason& reason : kResultReasons) {
    const auto count = std::count_if(
        reply.results.begin(), reply.results.end(),
        [&reason](const ObjectResult& result) { return result.outcome == reason.outcome; });
    if (count > 0) {
      lines += "  " + std::to_string(count) + " x " +
               lineOf(kResultReasons, std::string(reason.outcome));
    }
  }
  return lines;
}

bool isQuestion(const VAHACommand& command) {
  if (command.actions().empty()) return false;
  const VAHAAction& action = *command.actions().front();
  const bool isGet = !action.actionType() || action.actionType() == VAHAActionTypeGETValue;
  return isGet && action.value();
}

/// The limit that a command asks for; empty when it asks for none.
std::string_view limitAskedBy(const VAHACommand& command) {
  if (command.actions().empty()) return {};
  const NDString& type = command.actions().front()->actionType();
  if (type == VAHAActionTypeGET_MINIMUMValue) return "minimum";
  if (type == VAHAActionTypeGET_MAXIMUMValue) return "maximum";
  return type == VAHAActionTypeGET_STEP_VALUEValue ? "step" : "";
}

/// Why not all that was reached gives a result, for commands that leave some out.
std::string omissionText(const VAHACommand& command) {
  if (isQuestion(command)) {
    return "Of what is read, only what has the value that was asked for gives a result.\n";
  }
  const std::string limit(limitAskedBy(command));
  if (limit.empty()) return {};
  return "Of what is reached, only what states a " + limit + " of its own gives a result.\n";
}

/// What the plug-in logs as a warning or worse.
std::string warningLines(const Rehearsal& rehearsal) {
  constexpr std::string_view kWarning = "4";
  std::string lines;
  for (const NDSystemLogMessage& message : rehearsal.log) {
    if (logField(message, "Level") > kWarning) continue;
    lines += "The plug-in logs: " + onOneLine(logField(message, "Message")) + '\n';
  }
  return lines;
}

}  // namespace

std::string judgementText(const VAHACommand& command, const Rehearsal& rehearsal) {
  std::string text = warningLines(rehearsal);
  if (rehearsal.replies.empty()) {
    text += "There is no reply: the plug-in can not find again what the filter found.\n";
  }
  for (const NDDictionary& reply : rehearsal.replies) {
    const ReplyForm form = replyForm(reply);
    text += lineOf(kReplyReasons, form.outcome) + resultLines(form);
  }
  return rehearsal.reached.empty() ? text : text + omissionText(command);
}

}  // namespace nidus
