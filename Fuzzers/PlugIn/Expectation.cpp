#include "PlugIn/Expectation.h"

#include <algorithm>
#include <set>
#include <utility>

#include "PlatformModel/Assistant/VAHAConstants.h"
#include "PlatformModel/Home/NDCharacteristicConstants.h"
#include "PlatformModel/Home/NDError.h"
#include "PlatformModel/Home/NDLookUp.h"
#include "PlugIn/Words.h"

namespace nidus {
namespace {

using Kind = PlatformCall::Kind;

bool isWritable(const std::vector<NDString>& properties) {
  return std::find(properties.begin(), properties.end(), NDCharacteristicPropertyWritable) !=
         properties.end();
}

std::string outcomeOf(std::int32_t code, bool isWrite) {
  if (code == 0) return std::string(VAHAActionOutcomeSUCCESSValue);
  if (code == kNDErrorUnreachable) return std::string(VAHAActionOutcomeUNREACHABLEValue);
  const bool isReadOnly = isWrite && code == kNDErrorNotWritable;
  return std::string(isReadOnly ? VAHAActionOutcomeREAD_ONLYValue : VAHAActionOutcomeFAILUREValue);
}

/// Says whether a limit of `target` is the same boolean as `value`: what is beyond a limit becomes
/// the limit, whatever kind that is of.
bool isBooleanLimit(const CharacteristicData& target, const NDValue& value) {
  const auto isSame = [&value](const NDValueRef& limit) {
    return limit && limit->isBoolean() && limit->isEqual(value);
  };
  return target.metadata &&
         (isSame(target.metadata->minimumValue) || isSame(target.metadata->maximumValue));
}

/// Follows one command.
class CallFollower {
 public:
  CallFollower(const Performance& performance, Expectation& expected)
      : performance_(performance),
        expected_(expected),
        family_(familyOf(*performance.command)),
        model_(expected.homes, performance.isLocked) {}

  void follow() {
    for (const PlatformCall& call : performance_.calls) followCall(call);
    if (family_ == ActionFamily::set) countReadOnly();
    if (family_ == ActionFamily::update) {
      expected_.hasReport = expected_.unlockReplies == 0;
      countLeftAlone();
    }
  }

 private:
  void complain(const std::string& what) {
    if (expected_.broken.empty()) expected_.broken = what;
  }

  void followCall(const PlatformCall& call) {
    if (!asked_.insert({call.home, call.kind}).second) complain("A home is asked twice.");
    if (call.kind == Kind::write) checkWrites(call);
    const ModelAnswer answer = model_.answer(call);
    if (call.kind == Kind::execute) return followScene(answer.batch);
    const bool isUpdateRead = family_ == ActionFamily::update && call.kind == Kind::read;
    if (isUpdateRead) readForUpdate_ += call.characteristics.size();
    const bool stopsAtLocked = family_ != ActionFamily::update || isUpdateRead;
    if (stopsAtLocked && answer.batch == kNDErrorMustUnlock) ++expected_.unlockReplies;
    for (const std::int32_t code : answer.codes) {
      if (stopsAtLocked && code == kNDErrorMustUnlock) {
        ++expected_.unlockReplies;
        return;
      }
      // What an update could read gets its result when it is written.
      if (!isUpdateRead || code != 0)
        ++expected_.outcomes[outcomeOf(code, call.kind == Kind::write)];
    }
  }

  void followScene(std::int32_t code) {
    if (performance_.calls.size() != 1) complain("A scene is run, and more.");
    if (code == kNDErrorMustUnlock) {
      ++expected_.unlockReplies;
      expected_.hasReport = false;
    } else {
      const auto outcome =
          code == 0 ? VAHAActionOutcomeSUCCESSValue : VAHAActionOutcomeFAILUREValue;
      ++expected_.outcomes[std::string(outcome)];
    }
  }

  void checkWrites(const PlatformCall& call) {
    if (family_ != ActionFamily::set && family_ != ActionFamily::update) {
      complain("An action that only looks writes.");
    }
    for (std::size_t i = 0; i < call.characteristics.size(); ++i) {
      const CharacteristicData* target = model_.find(call.home, call.characteristics[i]);
      if (!target) return complain("A characteristic is written that is not there.");
      if (!isWritable(target->properties))
        complain("A characteristic is written that is read-only.");
      if (family_ == ActionFamily::set) checkSetValue(call.values[i]);
      if (family_ == ActionFamily::update) checkUpdatedValue(call, call.characteristics[i], i);
    }
  }

  /// All characteristics of one command get the same value.
  void checkSetValue(const NDValueRef& value) {
    if (!setValue_) setValue_ = description(value);
    if (*setValue_ != description(value)) complain("One command sets different values.");
  }

  /// A toggle writes the opposite of what was read; the others stay within the limits.
  void checkUpdatedValue(const PlatformCall& call, const CharacteristicAddress& address,
                         std::size_t index) {
    const NDValueRef& value = call.values[index];
    if (!value) return complain("An update writes nothing.");
    const bool isToggle =
        firstAction(*performance_.command)->actionType() == VAHAActionTypeTOGGLEValue;
    const CharacteristicData& target = *model_.find(call.home, address);
    if (value->isBoolean() != isToggle && (isToggle || !isBooleanLimit(target, *value))) {
      complain("An update writes a value of the wrong kind.");
    }
    if (!isToggle) checkWithinLimits(target, *value);
  }

  void checkWithinLimits(const CharacteristicData& target, const NDValue& value) {
    if (!target.metadata) return;
    const NDValueRef& least = target.metadata->minimumValue;
    const NDValueRef& greatest = target.metadata->maximumValue;
    const bool areInOrder = !least || std::is_lteq(least->compare(greatest)) || !greatest ||
                            least->isText() || greatest->isText();
    if (!areInOrder) return;  // no value is between limits that are the wrong way round
    if (std::is_lt(value.compare(least)) || std::is_gt(value.compare(greatest))) {
      complain("An update writes a value beyond the limits.");
    }
  }

  /// What cannot be written gets its result without a call.
  void countReadOnly() {
    for (const auto& characteristic : performance_.reached) {
      if (isWritable(characteristic->properties())) continue;
      ++expected_.outcomes[std::string(VAHAActionOutcomeREAD_ONLYValue)];
    }
  }

  /// An update reads only what it can write.
  void countLeftAlone() {
    const bool isDispatched = !performance_.replies.empty() && !isRefused();
    const std::size_t reached = performance_.reached.size();
    if (!isDispatched || reached == readForUpdate_) return;
    if (reached < readForUpdate_) return complain("More is read than was found.");
    expected_.outcomes[std::string(VAHAActionOutcomeREAD_ONLYValue)] += reached - readForUpdate_;
  }

  [[nodiscard]] bool isRefused() const {
    return textAt(performance_.replies.front(), "commandOutcome") ==
           VAHACommandOutcomeCOMMAND_FAILUREValue;
  }

  const Performance& performance_;
  Expectation& expected_;
  const ActionFamily family_;
  AccessoryModel model_;
  std::set<std::pair<NDUUID, Kind>> asked_;
  std::size_t readForUpdate_ = 0;
  std::optional<std::string> setValue_;
};

}  // namespace

VAHAActionRef firstAction(const VAHACommand& command) {
  return command.actions().empty() ? nullptr : command.actions().front();
}

ActionFamily familyOf(const VAHACommand& command) {
  const VAHAActionRef action = firstAction(command);
  if (!action) return ActionFamily::unknown;
  const NDString& type = action->actionType();
  if (!type || type == VAHAActionTypeGETValue || type == VAHAActionTypeGET_TARGET_VALUEValue) {
    return ActionFamily::read;
  }
  if (type == VAHAActionTypeGET_MINIMUMValue || type == VAHAActionTypeGET_MAXIMUMValue ||
      type == VAHAActionTypeGET_STEP_VALUEValue) {
    return ActionFamily::limit;
  }
  if (type == VAHAActionTypeSETValue || type == VAHAActionTypeSET_TO_MINIMUMValue ||
      type == VAHAActionTypeSET_TO_MAXIMUMValue) {
    return ActionFamily::set;
  }
  const bool isUpdate = type == VAHAActionTypeINCREASEValue ||
                        type == VAHAActionTypeDECREASEValue || type == VAHAActionTypeTOGGLEValue;
  return isUpdate ? ActionFamily::update : ActionFamily::unknown;
}

Expectation expectationOf(const Performance& performance) {
  Expectation expected;
  expected.homes = performance.before;
  CallFollower(performance, expected).follow();
  return expected;
}

}  // namespace nidus
