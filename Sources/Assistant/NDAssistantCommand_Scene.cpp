#include "Assistant/Entities.h"
#include "Assistant/NDAssistantCommand.h"
#include "Assistant/Outcomes.h"
#include "Assistant/Results.h"
#include "Assistant/Values.h"
#include "Logging/WLOLog.h"
#include "PlatformModel/Assistant/VAHAConstants.h"
#include "PlatformModel/System/NDNull.h"

namespace nidus {
namespace {

/// Says whether `action` switches a scene on, and logs why when it does not.
bool switchesOn(const VAHAActionRef& action, const std::shared_ptr<NDNAPMetadata>& mapper) {
  const NDString& attribute = property(action, &VAHAAction::attribute);
  if (!(attribute == VAHAAttributeENABLEDValue)) {
    if (WLOShouldLogAtLevel(4)) {
      WLOLog(4, "Invalid action.attribute %@ for actionSet", {attribute});
    }
    return false;
  }
  const NDString valueType =
      property(mapper, &NDNAPMetadata::mapCharacteristicValueType, attribute);
  const NDValueRef value = getValueOfType(valueType, action);
  if (property(value, &NDValue::boolValue)) return true;
  if (WLOShouldLogAtLevel(4)) WLOLog(4, "ActionSet action value %@ not true", {value});
  return false;
}

/// The one result of a scene that was run. Outcome and value come after the filling, which may have
/// set them too.
std::shared_ptr<const VAHAActionResult> makeResult(const std::shared_ptr<NDActionSet>& actionSet,
                                                   const VAHAActionRef& action, bool isSuccess) {
  auto result = std::make_shared<VAHAActionResult>();
  const auto value = VAHABooleanValue::booleanValue();
  populateResultWithEntity(*result, action, entityFromActionSet(actionSet));
  result->setOutcome(isSuccess ? VAHAActionOutcomeSUCCESSValue : VAHAActionOutcomeFAILUREValue);
  value->setValue(isSuccess);
  result->setResultValue(value);
  return result;
}

}  // namespace

void NDAssistantCommand::executeActionSet_action_withCompletionHandler(
    const std::shared_ptr<NDActionSet>& actionSet, const VAHAActionRef& action,
    const VAHAReplyHandler& handler) {
  if (!switchesOn(action, metadata_)) {
    reportOutcome_results_handler(VAHACommandOutcomeCOMMAND_FAILUREValue, std::nullopt, handler);
    return;
  }
  const auto home = property(actionSet, &NDActionSet::home);
  if (!home) return;  // A scene that is gone is answered with silence.
  home->executeActionSet_completionHandler(
      actionSet,
      [self = shared_from_this(), actionSet, action, handler](const std::optional<NDError>& error) {
        if (requiresUnlock(error)) {
          self->reportUnlockRequired(handler);
        } else {
          self->reportResults_handler(Results{makeResult(actionSet, action, !error)}, handler);
        }
      });
}

}  // namespace nidus
