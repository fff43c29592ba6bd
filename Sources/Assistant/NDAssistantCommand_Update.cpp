#include <compare>

#include "Assistant/ActionRun.h"
#include "Assistant/HomeTable.h"
#include "Assistant/NDAssistantCommand.h"
#include "Assistant/Outcomes.h"
#include "Assistant/Units.h"
#include "Assistant/WritableCharacteristic.h"
#include "Logging/WLOLog.h"
#include "PlatformModel/Assistant/VAHAConstants.h"
#include "PlatformModel/Home/NDCharacteristicConstants.h"
#include "PlatformModel/Home/NDLookUp.h"
#include "PlatformModel/System/NDNull.h"

namespace nidus {
namespace {

constexpr float kDefaultStep = 5.0F;

std::shared_ptr<NDCharacteristic> characteristicOfType(const std::shared_ptr<NDService>& service,
                                                       const NDString& type) {
  return findInArrayByCharacteristicType(property(service, &NDService::characteristics), type);
}

bool suits(const NDString& actionType, const NDString& valueType) {
  if (actionType == VAHAActionTypeTOGGLEValue) {
    return valueType == NDCharacteristicMetadataFormatBool;
  }
  if (actionType == VAHAActionTypeINCREASEValue || actionType == VAHAActionTypeDECREASEValue) {
    return valueType == NDCharacteristicMetadataFormatInt ||
           valueType == NDCharacteristicMetadataFormatFloat;
  }
  return true;
}

void logUnsuitable(const NDString& actionType, const NDString& valueType) {
  if (!WLOShouldLogAtLevel(3)) return;
  WLOLog(3, "%s ### Vela passed an incorrect action (%@) to a %@ value type.",
         {"-[NDAssistantCommand handleUpdateActionTypes:serviceType:forObjects:completionHandler:]",
          actionType, valueType});
}

float stepOf(const VAHAAction& action) {
  const VAHAValue* value = action.value().get();
  if (const auto* integer = dynamic_cast<const VAHAIntegerValue*>(value)) {
    return static_cast<float>(integer->value());
  }
  const auto* floating = dynamic_cast<const VAHAFloatValue*>(value);
  return floating ? floating->value() : kDefaultStep;
}

float moved(float current, const VAHAAction& action) {
  if (action.actionType() == VAHAActionTypeINCREASEValue) return current + stepOf(action);
  if (action.actionType() == VAHAActionTypeDECREASEValue) return current - stepOf(action);
  return current;
}

/// The value within the limits; the minimum is compared with what the maximum has left.
NDValueRef clampedInOrder(NDValueRef value,
                          const std::shared_ptr<const NDCharacteristicMetadata>& limits) {
  const NDValueRef& maximum = property(limits, &NDCharacteristicMetadata::maximumValue);
  const NDValueRef& minimum = property(limits, &NDCharacteristicMetadata::minimumValue);
  if (maximum && std::is_lt(maximum->compare(value))) value = maximum;
  if (minimum && std::is_gt(minimum->compare(value))) value = minimum;
  return value;
}

/// The update of one home: a read, and a write of what was made of the values.
struct HomeUpdate {
  std::shared_ptr<const ActionRun> run;
  std::weak_ptr<NDHome> home;  ///< Weak: the home holds this update until it has answered.
  NDString writeType;

  using Responses = std::vector<NDCharacteristicResponse>;
  using Writes = std::vector<NDCharacteristicWriteRequestTuple>;
  using ResultWriter = ActionRun::ResultWriter;

  void didRead(const std::optional<NDError>& error, const Responses& responses) const;
  void didWrite(const Responses& responses) const;
  void addWriteOrResult(Writes& writes, ResultWriter& results,
                        const NDCharacteristicResponse& response) const;
  void addWrite(Writes& writes, ResultWriter& results,
                const std::shared_ptr<NDCharacteristic>& characteristic) const;
};

void HomeUpdate::didRead(const std::optional<NDError>& error, const Responses& responses) const {
  ActionRun::Answer answer(*run);
  ResultWriter results(*run);
  Writes writes;
  writes.reserve(responses.size());
  const bool isUnlocked =
      visitUntilLocked(error, responses, [&](const NDCharacteristicResponse& response) {
        addWriteOrResult(writes, results, response);
      });
  if (!isUnlocked) {
    // The unlock is the only reply of the command: the group stays entered for good, and the report
    // of the results never comes due.
    answer.stayEntered();
    run->reportUnlockRequired();
    return;
  }
  const auto asked = home.lock();
  if (writes.empty() || !asked) return;
  answer.stayEntered();  // Until the write is answered.
  asked->writeCharacteristicValues_withCompletionHandler(
      std::move(writes), [update = *this](const std::optional<NDError>&, const Responses& written) {
        update.didWrite(written);
      });
}

/// Makes the write of a value that was read, and the result of one that could not be.
void HomeUpdate::addWriteOrResult(Writes& writes, ResultWriter& results,
                                  const NDCharacteristicResponse& response) const {
  if (response.error) {
    results.add(outcomeOfRead(response.error), response.characteristic->service());
  } else {
    addWrite(writes, results, response.characteristic);
  }
}

void HomeUpdate::addWrite(Writes& writes, ResultWriter& results,
                          const std::shared_ptr<NDCharacteristic>& characteristic) const {
  const auto service = characteristic->service();
  NDString outcome;
  NDValueRef value =
      run->command().updateValue_forAction_outcome(characteristic, run->action(), &outcome);
  if (outcome) {
    results.add(outcome.view(), service);
    if (WLOShouldLogAtLevel(4)) {
      const auto accessory = property(service, &NDService::accessory);
      WLOLog(4, "Update boundary error %@ for service %@/%@",
             {outcome, property(accessory, &NDAccessory::name),
              property(service, &NDService::instanceID)});
    }
    return;
  }
  auto target = characteristicOfType(service, writeType);
  if (!target) return;
  writes.push_back(NDCharacteristicWriteRequestTuple::tupleWithCharacteristic_value(
      std::move(target), std::move(value)));
}

void HomeUpdate::didWrite(const Responses& responses) const {
  const ActionRun::Answer answer(*run);
  ResultWriter results(*run);
  for (const NDCharacteristicResponse& response : responses) {
    results.add(outcomeOfWrite(response.error), response.characteristic->service());
  }
}

/// Updates the characteristics whose counterpart of `writeType` can be written; the others are
/// read-only.
void updateByHome(const std::shared_ptr<const ActionRun>& run,
                  const NDAssistantCommand::CharacteristicList& characteristics,
                  const NDString& writeType) {
  HomeTable<std::shared_ptr<NDCharacteristic>> table(characteristics.size());
  ActionRun::ResultWriter results(*run);
  for (const auto& characteristic : characteristics) {
    const auto service = characteristic->service();
    const auto target = characteristicOfType(service, writeType);
    if (target && isWritable(*target)) {
      table.add(*characteristic, characteristic);
    } else {
      results.add(VAHAActionOutcomeREAD_ONLYValue, service);
    }
  }
  table.forEachHome(
      [&](const std::shared_ptr<NDHome>& home, NDAssistantCommand::CharacteristicList batch) {
        run->enter();
        home->readCharacteristicValues_withCompletionHandler(
            NDArray<NDCharacteristic>(std::move(batch)),
            [update = HomeUpdate{run, home, writeType}](const std::optional<NDError>& error,
                                                        const HomeUpdate::Responses& responses) {
              update.didRead(error, responses);
            });
      });
  run->reportWhenAnswered();
}

}  // namespace

void NDAssistantCommand::handleUpdateActionTypes_serviceType_forObjects_completionHandler(
    const VAHAActionRef& action, const NDString& serviceType, const ObjectList& objects,
    const VAHAReplyHandler& handler) {
  const NDString& attribute = property(action, &VAHAAction::attribute);
  if (!attribute) {
    returnResults_serviceType_forAction_completionHandler(objects, serviceType, action, handler);
    return;
  }
  const NDString& actionType = action->actionType();
  const ObjectList services = filterObjects_byAttribute(objects, attribute);
  const NDString writeType =
      property(metadata_, &NDNAPMetadata::mapWriteCharcteristicFromAssistantName, attribute);
  const NDString readType =
      property(metadata_, &NDNAPMetadata::mapReadCharcteristicFromAssistantName, attribute);
  const CharacteristicList characteristics = filterObjects_forcharacteristicType(
      services, actionType == VAHAActionTypeGET_TARGET_VALUEValue ? writeType : readType);
  if (characteristics.empty()) {
    returnResults_serviceType_forAction_completionHandler(std::nullopt, serviceType, action,
                                                          handler);
    return;
  }
  const NDString valueType =
      property(metadata_, &NDNAPMetadata::mapCharacteristicValueType, attribute);
  if (!suits(actionType, valueType)) {
    logUnsuitable(actionType, valueType);
    reportOutcome_results_handler(VAHACommandOutcomeCOMMAND_FAILUREValue, std::nullopt, handler);
    return;
  }
  updateByHome(std::make_shared<ActionRun>(shared_from_this(), action, serviceType, handler,
                                           characteristics.size()),
               characteristics, writeType);
}

NDValueRef NDAssistantCommand::updateValue_forAction_outcome(
    const std::shared_ptr<NDCharacteristic>& characteristic, const VAHAActionRef& action,
    NDString* /*outcome*/) const {
  const NDValueRef current = characteristic->value();
  const NDString& attribute = action->attribute();
  if (action->actionType() == VAHAActionTypeTOGGLEValue) {
    return NDValue::boolean(!property(current, &NDValue::boolValue));
  }
  const NDString valueType =
      property(metadata_, &NDNAPMetadata::mapCharacteristicValueType, attribute);
  const float number = valueType == NDCharacteristicMetadataFormatInt
                           ? static_cast<float>(property(current, &NDValue::integerValue))
                           : property(current, &NDValue::floatValue);
  const NDString& units = property(action->value(), &VAHAValue::units);
  // The user speaks in units of their own: the step is taken in those, the result goes back into
  // the characteristic's. Both adjusters take what stands in each position for what it is.
  const NDValueRef adjusted = adjustGetValue(NDValue::floating(number), valueType, units,
                                             characteristic->characteristicType());
  const NDValueRef updated =
      NDValue::floating(moved(property(adjusted, &NDValue::floatValue), *action));
  const NDString writeType =
      property(metadata_, &NDNAPMetadata::mapWriteCharcteristicFromAssistantName, attribute);
  const auto target = characteristicOfType(characteristic->service(), writeType);
  return clampedInOrder(adjustSetValue(updated, units, valueType, attribute),
                        target ? target->metadata() : nullptr);
}

}  // namespace nidus
