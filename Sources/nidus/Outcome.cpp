#include "nidus/Outcome.h"

#include <algorithm>

#include "PlatformModel/Assistant/VAHAConstants.h"

namespace nidus {
namespace {

bool isSuccess(const NDDictionary& reply) {
  const NDDictionaryValue* outcome = reply.find("commandOutcome");
  const auto* text = outcome ? std::get_if<NDString>(&outcome->content()) : nullptr;
  return text && *text == VAHACommandOutcomeCOMMAND_SUCCESSValue;
}

}  // namespace

ExitStatus statusOf(const std::vector<NDDictionary>& replies) {
  if (replies.empty()) return ExitStatus::noReply;
  return std::all_of(replies.begin(), replies.end(), isSuccess) ? ExitStatus::success
                                                                : ExitStatus::otherOutcome;
}

}  // namespace nidus
