#include "Load/Judge.h"

#include <algorithm>
#include <string_view>
#include <utility>
#include <variant>

#include "Load/LoadHome.h"
#include "PlatformModel/Assistant/VAHAConstants.h"

namespace nidus {
namespace {

using Aim = LoadCommand::Aim;

const NDDictionary& entityOf(const NDDictionary& result) {
  static const NDDictionary kNone;
  const NDDictionaryValue* value = result.find("entity");
  const auto* entity = value ? std::get_if<NDDictionary>(&value->content()) : nullptr;
  return entity ? *entity : kNone;
}

/// A range of counts, both ends included.
struct Range {
  std::size_t least = 0;
  std::size_t greatest = 0;
  [[nodiscard]] bool holds(std::size_t count) const { return least <= count && count <= greatest; }
};

/// How often a command has to answer.
struct Expectation {
  Range unlocks;
  Range reports;  ///< Of results, of no match or of failure.
};

bool areAnswered(const PlatformFacts& facts) {
  return facts.reads.answered == facts.reads.asked && facts.writes.answered == facts.writes.asked &&
         facts.executions.answered == facts.executions.asked;
}

Expectation expectationFrom(const PlatformFacts& facts, Aim aim) {
  if (!facts.wasAskedForHomes) return {{}, {1, 1}};
  if (!facts.homes) return {};
  if (facts.executions.asked > 0) {
    const std::size_t unlocks = facts.executions.locked;
    const std::size_t reports = facts.executions.answered - unlocks;
    return {{unlocks, unlocks}, {reports, reports}};
  }
  const std::size_t unlocks = facts.reads.locked + facts.writes.locked;
  const bool isReported = areAnswered(facts) && (aim != Aim::update || unlocks == 0);
  // A scene that is gone when it is to be run is answered with silence.
  const bool maySceneBeGone = aim == Aim::scene && facts.haveHomesChanged;
  const std::size_t reports = isReported ? 1 : 0;
  return {{unlocks, unlocks}, {maySceneBeGone ? 0 : reports, reports}};
}

/// What follows when all that is known is that one home at most was asked, and has answered.
Expectation expectationFrom(Aim aim, std::size_t unlocks) {
  const bool isEither = aim == Aim::update || aim == Aim::scene;
  const std::size_t reports = isEither && unlocks > 0 ? 0 : 1;
  return {{0, aim == Aim::tell || aim == Aim::refuse ? 0U : 1U}, {reports, reports}};
}

class Judgement {
 public:
  Judgement(const LoadCommand& command, const std::optional<PlatformFacts>& facts)
      : command_(command), facts_(facts) {}

  std::vector<std::string> of(const Replies& replies) {
    std::size_t unlocks = 0;
    for (const NDDictionary& reply : replies) {
      if (textOf(reply, "commandOutcome") == VAHACommandOutcomeREQUIRES_UNLOCKValue) ++unlocks;
    }
    const auto expected =
        facts_ ? expectationFrom(*facts_, command_.aim) : expectationFrom(command_.aim, unlocks);
    const std::size_t reports = replies.size() - unlocks;
    check(unlocks <= expected.unlocks.greatest, "an unlock too many");
    check(unlocks >= expected.unlocks.least, "an unlock is missing");
    check(reports <= expected.reports.greatest, "a reply too many");
    check(reports >= expected.reports.least, "a reply is missing");
    for (const NDDictionary& reply : replies) judgeReply(reply);
    return std::move(faults_);
  }

 private:
  void check(bool holds, std::string_view fault) {
    if (!holds) faults_.emplace_back(fault);
  }

  void judgeReply(const NDDictionary& reply) {
    const NDString outcome = textOf(reply, "commandOutcome");
    const std::vector<NDDictionary> results = resultsOf(reply);
    const bool isSuccess = outcome == VAHACommandOutcomeCOMMAND_SUCCESSValue;
    check(isSuccess != results.empty(), "the outcome does not agree with the results");
    if (outcome == VAHACommandOutcomeREQUIRES_UNLOCKValue) return;
    if (isSuccess) {
      check(command_.aim != Aim::refuse, "what must be refused was done");
      for (const NDDictionary& result : results) judgeResult(result);
    } else if (outcome == VAHACommandOutcomeCOMMAND_FAILUREValue) {
      check(mayFail(), "a failure without a reason");
    } else {
      check(outcome == VAHACommandOutcomeFOUND_NO_MATCHING_ENTITIESValue, "an unknown outcome");
    }
    if (facts_) judgeCounts(results);
  }

  [[nodiscard]] bool mayFail() const {
    if (command_.aim == Aim::refuse) return true;
    const bool isPrimaryNeeded = !command_.home && facts_ && facts_->homes.value_or(0) > 1;
    return isPrimaryNeeded && facts_->executions.asked + facts_->reads.asked == 0;
  }

  void judgeResult(const NDDictionary& result) {
    check(textOf(result, "resultAttribute") == command_.attribute, "a result of another attribute");
    const NDDictionary& entity = entityOf(result);
    const std::string_view type =
        command_.scene ? VAHAEntityTypeSCENEValue : VAHAEntityTypeSERVICEValue;
    check(textOf(entity, "entityType") == type, "a result of another kind of object");
    checkName(entity, "name", command_.scene ? command_.scene : command_.service);
    if (command_.scene) return;
    checkName(entity, "room", command_.room);
    checkName(entity, "home", command_.home);
    const NDString name = textOf(entity, "name");
    const bool isUnnamed = !name && mayBeGone();
    check(!command_.group || isUnnamed || isInGroup(name, command_.group),
          "a result of an object that the command does not name");
  }

  /// An object that was renamed or removed under the command may have its other name, or none.
  void checkName(const NDDictionary& entity, std::string_view key, const NDString& asked) {
    if (!asked) return;
    const NDString name = textOf(entity, key);
    const bool isMeant = mayBeGone() ? !name || isSameObject(name, asked) : name == asked;
    check(isMeant, "a result of an object that the command does not name");
  }

  [[nodiscard]] bool mayBeGone() const { return facts_ && facts_->haveHomesChanged; }

  /// Each answer of a home makes one result, and read-only objects make theirs without being asked.
  void judgeCounts(const std::vector<NDDictionary>& results) {
    if (command_.aim == Aim::tell || command_.aim == Aim::refuse) return;
    const PlatformFacts::Calls& read = facts_->reads;
    const PlatformFacts::Calls& written = facts_->writes;
    const PlatformFacts::Calls& run = facts_->executions;
    const bool isUpdate = command_.aim == Aim::update;
    const std::size_t successes = (isUpdate ? 0 : read.successes) + written.successes;
    const auto count = [&results](std::string_view outcome) {
      return static_cast<std::size_t>(std::count_if(
          results.begin(), results.end(),
          [outcome](const NDDictionary& result) { return textOf(result, "outcome") == outcome; }));
    };
    const std::size_t unreachable = read.unreachable + written.unreachable;
    const std::size_t runFailures = run.answered - run.locked - run.successes;
    const std::size_t failures = read.failures + read.readOnly + written.failures + runFailures;
    check(count(VAHAActionOutcomeSUCCESSValue) == successes + run.successes,
          "successes are lost or invented");
    check(count(VAHAActionOutcomeUNREACHABLEValue) == unreachable,
          "unreachable objects are lost or invented");
    check(count(VAHAActionOutcomeFAILUREValue) == failures, "failures are lost or invented");
    check(count(VAHAActionOutcomeREAD_ONLYValue) >= written.readOnly, "read-only objects are lost");
  }

  const LoadCommand& command_;
  const std::optional<PlatformFacts>& facts_;
  std::vector<std::string> faults_;
};

}  // namespace

std::vector<std::string> judge(const LoadCommand& command,
                               const std::optional<PlatformFacts>& facts, const Replies& replies) {
  return Judgement(command, facts).of(replies);
}

NDString textOf(const NDDictionary& dictionary, std::string_view key) {
  const NDDictionaryValue* value = dictionary.find(key);
  const NDString* text = value ? std::get_if<NDString>(&value->content()) : nullptr;
  return text ? *text : NDString();
}

std::vector<NDDictionary> resultsOf(const NDDictionary& reply) {
  std::vector<NDDictionary> results;
  const NDDictionaryValue* value = reply.find("actionResults");
  const auto* list = value ? std::get_if<NDDictionaryList>(&value->content()) : nullptr;
  if (!list) return results;
  for (const auto& result : *list) results.push_back(std::get<NDDictionary>(result.content()));
  return results;
}

}  // namespace nidus
