#include "Assistant/ActionRun.h"
#include "Assistant/HomeTable.h"
#include "Assistant/NDAssistantCommand.h"
#include "Assistant/Outcomes.h"
#include "Assistant/ResultMaker.h"
#include "Assistant/Results.h"
#include "PlatformModel/Assistant/VAHAConstants.h"
#include "PlatformModel/System/NDNull.h"

namespace nidus {
namespace {

/// Takes the answer of one home. The batch leaves the group also when the device must be unlocked,
/// so that the handler hears of that and then of what the other batches have found.
void batchDidRead(const ActionRun& run, const std::optional<NDError>& error,
                  const std::vector<NDCharacteristicResponse>& responses) {
  ActionRun::Answer answer(run);
  ActionRun::ResultWriter results(run);
  const bool isUnlocked =
      visitUntilLocked(error, responses, [&results](const NDCharacteristicResponse& response) {
        results.addIfAnswer(outcomeOfRead(response.error), response.characteristic->service());
      });
  answer.leave();
  if (!isUnlocked) run.reportUnlockRequired();
}

void readByHome(const std::shared_ptr<const ActionRun>& run,
                const NDAssistantCommand::CharacteristicList& characteristics) {
  HomeTable<std::shared_ptr<NDCharacteristic>> table(characteristics.size());
  for (const auto& characteristic : characteristics) table.add(*characteristic, characteristic);
  table.forEachHome(
      [&run](const std::shared_ptr<NDHome>& home, NDAssistantCommand::CharacteristicList batch) {
        run->enter();
        home->readCharacteristicValues_withCompletionHandler(
            NDArray<NDCharacteristic>(std::move(batch)),
            [run](const std::optional<NDError>& error,
                  const std::vector<NDCharacteristicResponse>& responses) {
              batchDidRead(*run, error, responses);
            });
      });
  run->reportWhenAnswered();
}

}  // namespace

void NDAssistantCommand::returnResults_serviceType_forAction_completionHandler(
    const std::optional<ObjectList>& objects, const NDString& serviceType,
    const VAHAActionRef& action, const VAHAReplyHandler& handler) {
  Results results;
  for (const HomeObjectRecord* object : objects.value_or(ObjectList())) {
    auto result = std::make_shared<VAHAActionResult>();
    result->setOutcome(VAHAActionOutcomeSUCCESSValue);
    populateResultWithObject(*result, serviceType, action, *object, gather_);
    results.push_back(std::move(result));
  }
  reportResults_handler(std::move(results), handler);
}

void NDAssistantCommand::handleGetActionTypes_serviceType_forObjects_completionHandler(
    const VAHAActionRef& action, const NDString& serviceType, const ObjectList& objects,
    const VAHAReplyHandler& handler) {
  const NDString& attribute = property(action, &VAHAAction::attribute);
  if (!attribute) {
    returnResults_serviceType_forAction_completionHandler(objects, serviceType, action, handler);
    return;
  }
  const ObjectList candidates = filterObjects_byAttribute(objects, attribute);
  const auto mapping = action->actionType() == VAHAActionTypeGET_TARGET_VALUEValue
                           ? &NDNAPMetadata::mapWriteCharcteristicFromAssistantName
                           : &NDNAPMetadata::mapReadCharcteristicFromAssistantName;
  const CharacteristicList characteristics =
      filterObjects_forcharacteristicType(candidates, property(metadata_, mapping, attribute));
  if (characteristics.empty()) {
    returnResults_serviceType_forAction_completionHandler(std::nullopt, serviceType, action,
                                                          handler);
    return;
  }
  readByHome(std::make_shared<ActionRun>(shared_from_this(), action, serviceType, handler,
                                         characteristics.size()),
             characteristics);
}

void NDAssistantCommand::handleGetMetadataActionTypes_serviceType_forObjects_completionHandler(
    const VAHAActionRef& action, const NDString& serviceType, const ObjectList& objects,
    const VAHAReplyHandler& handler) {
  const NDString& attribute = property(action, &VAHAAction::attribute);
  if (!attribute) {
    returnResults_serviceType_forAction_completionHandler(objects, serviceType, action, handler);
    return;
  }
  const ObjectList candidates = filterObjects_byAttribute(objects, attribute);
  const NDString type =
      property(metadata_, &NDNAPMetadata::mapReadCharcteristicFromAssistantName, attribute);
  const CharacteristicList characteristics = filterObjects_forcharacteristicType(candidates, type);
  if (characteristics.empty()) {
    returnResults_serviceType_forAction_completionHandler(std::nullopt, serviceType, action,
                                                          handler);
    return;
  }
  Results results;
  ResultMaker maker(action, serviceType);
  for (const auto& characteristic : characteristics) {
    auto result = maker.makeIfAnswer(VAHAActionOutcomeSUCCESSValue, characteristic->service());
    if (result) results.push_back(std::move(result));
  }
  reportResults_handler(std::move(results), handler);
}

}  // namespace nidus
