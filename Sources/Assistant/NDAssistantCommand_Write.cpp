#include <compare>
#include <unordered_map>

#include "Assistant/ActionRun.h"
#include "Assistant/HomeTable.h"
#include "Assistant/NDAssistantCommand.h"
#include "Assistant/ObjectLookUp.h"
#include "Assistant/Outcomes.h"
#include "Assistant/Units.h"
#include "Assistant/Values.h"
#include "Assistant/WritableCharacteristic.h"
#include "PlatformModel/Assistant/VAHAConstants.h"
#include "PlatformModel/System/NDNull.h"
#include "PlatformModel/System/NDTextMatching.h"

namespace nidus {
namespace {

/// The characteristics that are to be written, each once and in the order in which they were met,
/// with the value that was decided for each.
class WriteTable {
 public:
  void decide(const std::shared_ptr<NDCharacteristic>& characteristic, NDValueRef value) {
    const auto [entry, isNew] = values_.insert_or_assign(characteristic.get(), std::move(value));
    if (isNew) characteristics_.push_back(characteristic);
  }

  [[nodiscard]] const NDAssistantCommand::CharacteristicList& characteristics() const {
    return characteristics_;
  }

 private:
  NDAssistantCommand::CharacteristicList characteristics_;
  std::unordered_map<const NDCharacteristic*, NDValueRef> values_;
};

const HomeObjectRecord* firstScene(const NDAssistantCommand::ObjectList& objects) {
  for (const HomeObjectRecord* object : objects) {
    if (object->objectType &&
        isEqualIgnoringDiacritics(object->objectType.view(), VAHAEntityTypeSCENEValue)) {
      return object;
    }
  }
  return nullptr;
}

/// The value within the limits, both of which are compared with the value as it was asked for.
NDValueRef clamped(const NDValueRef& value,
                   const std::shared_ptr<const NDCharacteristicMetadata>& limits) {
  const NDValueRef& maximum = property(limits, &NDCharacteristicMetadata::maximumValue);
  const NDValueRef& minimum = property(limits, &NDCharacteristicMetadata::minimumValue);
  NDValueRef decided = value;
  if (maximum && std::is_lt(maximum->compare(value))) decided = maximum;
  if (minimum && std::is_gt(minimum->compare(value))) decided = minimum;
  return decided;
}

/// Decides what a writable characteristic is to become; it is left alone when it lacks the limit
/// that the action names.
void decide(WriteTable& table, const std::shared_ptr<NDCharacteristic>& characteristic,
            const NDString& actionType, const NDValueRef& setValue) {
  const auto& limits = characteristic->metadata();
  if (actionType == VAHAActionTypeSETValue) {
    table.decide(characteristic, clamped(setValue, limits));
    return;
  }
  const bool toMaximum = actionType == VAHAActionTypeSET_TO_MAXIMUMValue;
  if (!toMaximum && !(actionType == VAHAActionTypeSET_TO_MINIMUMValue)) return;
  const NDValueRef& limit = property(limits, toMaximum ? &NDCharacteristicMetadata::maximumValue
                                                       : &NDCharacteristicMetadata::minimumValue);
  if (limit) table.decide(characteristic, limit);
}

/// Decides about each characteristic. What is read-only gets its result now and never reaches the
/// platform.
WriteTable decideWrites(const ActionRun& run,
                        const NDAssistantCommand::CharacteristicList& characteristics,
                        const NDValueRef& setValue) {
  WriteTable table;
  for (const auto& characteristic : characteristics) {
    if (isWritable(*characteristic)) {
      decide(table, characteristic, run.action()->actionType(), setValue);
    } else {
      run.addResult(VAHAActionOutcomeREAD_ONLYValue, characteristic->service());
    }
  }
  return table;
}

/// Takes the answer of one home. The batch leaves the group also when the device must be unlocked,
/// so that the handler hears of that and then of what became of the other batches.
void batchDidWrite(const ActionRun& run, const std::optional<NDError>& error,
                   const std::vector<NDCharacteristicResponse>& responses) {
  ActionRun::Answer answer(run);
  const bool isUnlocked =
      visitUntilLocked(error, responses, [&run](const NDCharacteristicResponse& response) {
        run.addResult(outcomeOfWrite(response.error), response.characteristic->service());
      });
  answer.leave();
  if (!isUnlocked) run.reportUnlockRequired();
}

/// Writes `setValue` to all of the table. The values decided there are not what is written: they
/// say which characteristics are written, the platform judges the value itself.
void writeByHome(const std::shared_ptr<const ActionRun>& run, const WriteTable& writes,
                 const NDValueRef& setValue) {
  using Tuple = NDCharacteristicWriteRequestTuple;
  HomeTable<Tuple> table;
  for (const auto& characteristic : writes.characteristics()) {
    table.add(*characteristic, Tuple::tupleWithCharacteristic_value(characteristic, setValue));
  }
  table.forEachHome([&run](const std::shared_ptr<NDHome>& home, std::vector<Tuple> batch) {
    run->enter();
    home->writeCharacteristicValues_withCompletionHandler(
        std::move(batch), [run](const std::optional<NDError>& error,
                                const std::vector<NDCharacteristicResponse>& responses) {
          batchDidWrite(*run, error, responses);
        });
  });
  run->reportWhenAnswered();
}

}  // namespace

void NDAssistantCommand::handleSetActionTypes_serviceType_forObjects_completionHandler(
    const VAHAActionRef& action, const NDString& serviceType, const ObjectList& objects,
    const VAHAReplyHandler& handler) {
  const NDString& attribute = property(action, &VAHAAction::attribute);
  if (!attribute) {
    returnResults_serviceType_forAction_completionHandler(objects, nullptr, action, handler);
    return;
  }
  if (const HomeObjectRecord* scene = firstScene(objects)) {
    executeActionSet_action_withCompletionHandler(actionSetFromObject(*scene, gather_), action,
                                                  handler);
    return;
  }
  const NDString type =
      property(metadata_, &NDNAPMetadata::mapWriteCharcteristicFromAssistantName, attribute);
  const NDString valueType =
      property(metadata_, &NDNAPMetadata::mapCharacteristicValueType, attribute);
  const CharacteristicList characteristics = filterObjects_forcharacteristicType(objects, type);
  if (characteristics.empty()) {
    returnResults_serviceType_forAction_completionHandler(std::nullopt, serviceType, action,
                                                          handler);
    return;
  }
  const NDValueRef setValue =
      adjustSetValue(getValueOfType(valueType, action), valueType,
                     property(action->value(), &VAHAValue::units), attribute);
  const auto run = std::make_shared<ActionRun>(shared_from_this(), action, serviceType, handler);
  writeByHome(run, decideWrites(*run, characteristics, setValue), setValue);
}

}  // namespace nidus
