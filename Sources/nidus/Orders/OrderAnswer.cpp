#include "nidus/Orders/OrderAnswer.h"

#include <algorithm>
#include <string>

#include "AssistantHost/JsonLine.h"
#include "nidus/Answers/Answer.h"
#include "nidus/MissingHomes.h"
#include "nidus/Orders/OrderRun.h"
#include "nidus/StandardStreams.h"

namespace nidus {
namespace {

std::string jsonLines(const std::vector<Replies>& replies) {
  std::string lines;
  for (const Replies& ofCommand : replies) {
    for (const NDDictionary& reply : ofCommand) lines += jsonLine(reply);
  }
  return lines;
}

bool isSilent(const std::vector<Replies>& replies) {
  return std::all_of(replies.begin(), replies.end(),
                     [](const Replies& ofCommand) { return ofCommand.empty(); });
}

/// Why there was nothing to match, when it is not for the words of the order; else empty.
std::string missingHomes(const std::vector<Replies>& replies, HomePlatform& platform) {
  if (!isAllWithoutMatch(replies)) return {};
  const auto homes = platform.exportHomes();
  return homes ? missingHomesText(!homes->empty(), platform) : "";
}

ExitStatus show(const Order& order, const std::vector<Replies>& replies, HomePlatform& platform,
                AnswerForm form) {
  if (form == AnswerForm::quiet) return ExitStatus::success;
  if (isSilent(replies)) {
    reportLine("the plug-in gave no reply; see why with nidus explain and the same words");
    return ExitStatus::noReply;
  }
  if (form == AnswerForm::json) return printText(jsonLines(replies));
  const std::string missing = missingHomes(replies, platform);
  if (!missing.empty()) return printText(missing + '\n');
  return printText(answerText(order, replies, platform.vocabulary(), standardOutputStyle()));
}

}  // namespace

ExitStatus answerOrder(Session& session, const OrderWords& words, AnswerForm form) {
  const auto order = readOrderFor(session, words);
  if (!order) return report(order.failure());
  const auto replies = performOrder(session, *order);
  if (!replies) return report(replies.failure());
  const ExitStatus status = session.statusAfter(statusOf(*order, *replies));
  return std::max(status, show(*order, *replies, session.platform(), form));
}

}  // namespace nidus
