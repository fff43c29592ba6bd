#include "Assistant/Results.h"

#include <utility>

#include "Assistant/Entities.h"
#include "Assistant/ObjectLookUp.h"
#include "Assistant/Units.h"
#include "Assistant/Values.h"
#include "PlatformModel/Assistant/VAHAConstants.h"
#include "PlatformModel/Home/NDLookUp.h"
#include "PlatformModel/Home/NDNAPMetadata.h"
#include "PlatformModel/System/NDNull.h"

namespace nidus {
namespace {

using Limit = const NDValueRef& (NDCharacteristicMetadata::*)() const;

bool isQuestion(const NDString& actionType) {
  return !actionType || actionType == VAHAActionTypeGETValue;
}

bool asksForCurrentValue(const NDString& actionType) {
  return isQuestion(actionType) || actionType == VAHAActionTypeGET_TARGET_VALUEValue ||
         actionType == VAHAActionTypeSETValue || actionType == VAHAActionTypeINCREASEValue ||
         actionType == VAHAActionTypeDECREASEValue;
}

bool setsToLimit(const NDString& actionType) {
  return actionType == VAHAActionTypeSET_TO_MINIMUMValue ||
         actionType == VAHAActionTypeSET_TO_MAXIMUMValue;
}

/// The limit that an action of that type is about; null when it is about none.
Limit limitOf(const NDString& actionType) {
  if (actionType == VAHAActionTypeSET_TO_MINIMUMValue ||
      actionType == VAHAActionTypeGET_MINIMUMValue) {
    return &NDCharacteristicMetadata::minimumValue;
  }
  if (actionType == VAHAActionTypeSET_TO_MAXIMUMValue ||
      actionType == VAHAActionTypeGET_MAXIMUMValue) {
    return &NDCharacteristicMetadata::maximumValue;
  }
  if (actionType == VAHAActionTypeGET_STEP_VALUEValue) return &NDCharacteristicMetadata::stepValue;
  return nullptr;
}

/// Fills in the cached value of `characteristic`, in the units that the action asks for or else the
/// user's.
bool fillCurrentValue(VAHAActionResult& result, const VAHAAction& action,
                      const NDCharacteristic& characteristic, const NDString& type,
                      const NDString& format) {
  const auto mapper = NDNAPMetadata::getSharedInstance();
  const NDString& attribute = action.attribute();
  const NDString requested = property(mapper, &NDNAPMetadata::mapFromAssistantUnitName,
                                      property(action.value(), &VAHAValue::units));
  const NDString reporting = getReportingUnits(requested, type);
  const NDString native = property(mapper, &NDNAPMetadata::characteristicValueUnit, type);
  const NDValueRef converted = convertValue(characteristic.value(), native, reporting);
  const NDValueRef assistantValue = property(
      mapper, &NDNAPMetadata::mapToAssistantCharacteristicValue_name, converted, attribute);
  const NDString units = property(mapper, &NDNAPMetadata::mapToAssistantUnitName, reporting);
  result.setResultValue(setValue(assistantValue, format, units));
  if (!action.value() || !isQuestion(action.actionType())) return true;
  return isAttributeValueEqual(action.value(), result.resultValue());
}

/// Fills in a limit in the characteristic's own unit and under the platform's name of it: limits
/// are told as the accessory states them.
bool fillLimit(VAHAActionResult& result, const VAHAAction& action,
               const std::shared_ptr<const NDCharacteristicMetadata>& metadata, Limit limit,
               const NDString& format) {
  if (!metadata) return false;
  const NDValueRef& value = ((*metadata).*limit)();
  result.setResultValue(setValue(value, format, metadata->units()));
  if (!action.value() || setsToLimit(action.actionType())) return value != nullptr;
  return isAttributeValueEqual(action.value(), result.resultValue());
}

/// Fills in the value of a result that is a success; `action` has an attribute.
bool fillValue(VAHAActionResult& result, const VAHAAction& action,
               const std::shared_ptr<NDService>& service) {
  const auto mapper = NDNAPMetadata::getSharedInstance();
  const auto mapping = isQuestion(action.actionType())
                           ? &NDNAPMetadata::mapReadCharcteristicFromAssistantName
                           : &NDNAPMetadata::mapWriteCharcteristicFromAssistantName;
  const NDString type = property(mapper, mapping, action.attribute());
  const NDString format =
      property(mapper, &NDNAPMetadata::mapCharacteristicValueType, action.attribute());
  const auto characteristic =
      findInArrayByCharacteristicType(property(service, &NDService::characteristics), type);
  if (!characteristic) return true;
  if (asksForCurrentValue(action.actionType())) {
    return fillCurrentValue(result, action, *characteristic, type, format);
  }
  const Limit limit = limitOf(action.actionType());
  return !limit || fillLimit(result, action, characteristic->metadata(), limit, format);
}

}  // namespace

bool populateResultWithService(VAHAActionResult& result, const NDString& serviceType,
                               const VAHAActionRef& action,
                               const std::shared_ptr<NDService>& service) {
  const NDString& attribute = property(action, &VAHAAction::attribute);
  result.setResultAttribute(attribute);
  const bool carriesValue = attribute && result.outcome() == VAHAActionOutcomeSUCCESSValue;
  const bool isAnswer = !carriesValue || fillValue(result, *action, service);
  result.setEntity(entityFromService(service, serviceType));
  return isAnswer;
}

bool populateResultWithObject(VAHAActionResult& result, const NDString& serviceType,
                              const VAHAActionRef& action, const HomeObjectRecord& record,
                              const std::shared_ptr<NDAssistantGather>& gather) {
  const NDString& attribute = property(action, &VAHAAction::attribute);
  result.setResultAttribute(attribute);
  if (attribute && record.objectType == VAHAEntityTypeSERVICEValue) {
    return populateResultWithService(result, serviceType, action,
                                     serviceFromObject(record, gather));
  }
  result.setEntity(entityFromObject(record));
  return true;
}

bool populateResultWithEntity(VAHAActionResult& result, const VAHAActionRef& action,
                              std::shared_ptr<const VAHAEntity> entity) {
  result.setResultAttribute(property(action, &VAHAAction::attribute));
  result.setEntity(std::move(entity));
  return true;
}

}  // namespace nidus
