#include <cstddef>
#include <utility>

#include "Assistant/ActionRun.h"
#include "Assistant/AddressTable.h"
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

/// The characteristics that are to be written, each once and in the order in which they were met.
class WriteTable {
 public:
  explicit WriteTable(std::size_t greatestSize) : isKnown_(greatestSize) {}

  void add(const std::shared_ptr<NDCharacteristic>& characteristic) {
    if (!std::exchange(isKnown_[characteristic.get()], true)) {
      characteristics_.push_back(characteristic);
    }
  }

  [[nodiscard]] const NDAssistantCommand::CharacteristicList& characteristics() const {
    return characteristics_;
  }

 private:
  NDAssistantCommand::CharacteristicList characteristics_;
  AddressTable<bool> isKnown_;
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

/// Says whether an action of that type writes a writable characteristic: one that goes to a limit
/// leaves alone what lacks it, otherwise the limits decide nothing.
bool isToBeWritten(const NDCharacteristic& characteristic, const NDString& actionType) {
  if (actionType == VAHAActionTypeSETValue) return true;
  const auto& limits = characteristic.metadata();
  if (actionType == VAHAActionTypeSET_TO_MAXIMUMValue) {
    return property(limits, &NDCharacteristicMetadata::maximumValue) != nullptr;
  }
  return actionType == VAHAActionTypeSET_TO_MINIMUMValue &&
         property(limits, &NDCharacteristicMetadata::minimumValue) != nullptr;
}

/// Decides about each characteristic. What is read-only gets its result now and never reaches the
/// platform.
WriteTable decideWrites(const ActionRun& run,
                        const NDAssistantCommand::CharacteristicList& characteristics) {
  WriteTable table(characteristics.size());
  ActionRun::ResultWriter results(run);
  for (const auto& characteristic : characteristics) {
    if (!isWritable(*characteristic)) {
      results.add(VAHAActionOutcomeREAD_ONLYValue, characteristic->service());
    } else if (isToBeWritten(*characteristic, run.action()->actionType())) {
      table.add(characteristic);
    }
  }
  return table;
}

/// Takes the answer of one home. The batch leaves the group also when the device must be unlocked,
/// so that the handler hears of that and then of what became of the other batches.
void batchDidWrite(const ActionRun& run, const std::optional<NDError>& error,
                   const std::vector<NDCharacteristicResponse>& responses) {
  ActionRun::Answer answer(run);
  ActionRun::ResultWriter results(run);
  const bool isUnlocked =
      visitUntilLocked(error, responses, [&results](const NDCharacteristicResponse& response) {
        results.add(outcomeOfWrite(response.error), response.characteristic->service());
      });
  answer.leave();
  if (!isUnlocked) run.reportUnlockRequired();
}

/// Writes `setValue` to all of the table as the assistant gave it, also when the action goes to a
/// limit: the platform judges the value itself.
void writeByHome(const std::shared_ptr<const ActionRun>& run, const WriteTable& writes,
                 const NDValueRef& setValue) {
  using Tuple = NDCharacteristicWriteRequestTuple;
  HomeTable<Tuple> table(writes.characteristics().size());
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
  const auto run = std::make_shared<ActionRun>(shared_from_this(), action, serviceType, handler,
                                               characteristics.size());
  writeByHome(run, decideWrites(*run, characteristics), setValue);
}

}  // namespace nidus
