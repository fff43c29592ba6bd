#include "Assistant/ResultMaker.h"

#include <utility>

#include "Assistant/Entities.h"
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

/// Says whether both are the same boolean or the same integer. Floats that are equal may be told
/// differently, such as 0 and -0.
bool areSame(const NDValueRef& a, const NDValueRef& b) {
  if (!a || !b) return false;
  const bool areOfOneKind =
      (a->isBoolean() && b->isBoolean()) || (a->isInteger() && b->isInteger());
  return areOfOneKind && a->isEqual(*b);
}

}  // namespace

/// What the mapper says of an action that has an attribute.
struct ResultMaker::Mapping {
  /// Of a value that is told in the units that the action asks for or else the user's.
  struct Units {
    NDString native;
    NDString reported;
    NDString reportedName;  ///< The assistant's.
  };

  explicit Mapping(const VAHAAction& action)
      : mapper(NDNAPMetadata::getSharedInstance()),
        type(property(mapper,
                      isQuestion(action.actionType())
                          ? &NDNAPMetadata::mapReadCharcteristicFromAssistantName
                          : &NDNAPMetadata::mapWriteCharcteristicFromAssistantName,
                      action.attribute())),
        format(property(mapper, &NDNAPMetadata::mapCharacteristicValueType, action.attribute())) {}

  const Units& unitsFor(const VAHAAction& action) {
    if (units) return *units;
    const NDString requested = property(mapper, &NDNAPMetadata::mapFromAssistantUnitName,
                                        property(action.value(), &VAHAValue::units));
    const NDString reported = getReportingUnits(requested, type, mapper.get());
    units = {property(mapper, &NDNAPMetadata::characteristicValueUnit, type), reported,
             property(mapper, &NDNAPMetadata::mapToAssistantUnitName, reported)};
    return *units;
  }

  /// Fills in the cached value of `characteristic`.
  bool fillCurrentValue(VAHAActionResult& result, const VAHAAction& action,
                        const NDCharacteristic& characteristic) {
    NDValueRef value = characteristic.value();
    if (!areSame(value, last)) {
      told = toldValue(value, action);
      last = std::move(value);
    }
    result.setResultValue(told);
    if (!action.value() || !isQuestion(action.actionType())) return true;
    return isAttributeValueEqual(action.value(), told);
  }

  /// The assistant's value of what a characteristic holds.
  VAHAValueRef toldValue(const NDValueRef& value, const VAHAAction& action) {
    const auto& [native, reported, reportedName] = unitsFor(action);
    const NDValueRef converted = convertValue(value, native, reported);
    return setValue(property(mapper, &NDNAPMetadata::mapToAssistantCharacteristicValue_name,
                             converted, action.attribute()),
                    format, reportedName);
  }

  const std::shared_ptr<NDNAPMetadata> mapper;
  const NDString type;         ///< Of the characteristic that a result tells of.
  const NDString format;       ///< Of its values.
  std::optional<Units> units;  ///< None until the first value.
  // Services that follow each other mostly hold the same value: most lights of a home are off.
  NDValueRef last;
  VAHAValueRef told;  ///< The assistant's value of `last`.
};

ResultMaker::ResultMaker(VAHAActionRef action, NDString serviceType)
    : action_(std::move(action)), serviceType_(std::move(serviceType)) {}

ResultMaker::~ResultMaker() = default;

std::shared_ptr<VAHAActionResult> ResultMaker::make(std::string_view outcome,
                                                    const std::shared_ptr<NDService>& service) {
  auto result = std::make_shared<VAHAActionResult>();
  result->setOutcome(sharedOutcome(outcome));
  fill(*result, service);
  return result;
}

std::shared_ptr<VAHAActionResult> ResultMaker::makeIfAnswer(
    std::string_view outcome, const std::shared_ptr<NDService>& service) {
  auto result = std::make_shared<VAHAActionResult>();
  result->setOutcome(sharedOutcome(outcome));
  return fill(*result, service) ? result : nullptr;
}

bool ResultMaker::fill(VAHAActionResult& result, const std::shared_ptr<NDService>& service) {
  const NDString& attribute = property(action_, &VAHAAction::attribute);
  result.setResultAttribute(attribute);
  const bool carriesValue = attribute && result.outcome() == VAHAActionOutcomeSUCCESSValue;
  const bool isAnswer = !carriesValue || fillValue(result, service);
  result.setEntity(entityFromService(service, serviceType_));
  return isAnswer;
}

const NDString& ResultMaker::sharedOutcome(std::string_view outcome) {
  if (!(outcome_ == outcome)) outcome_ = outcome;
  return outcome_;
}

/// Fills in the value of a result that is a success; the action has an attribute.
bool ResultMaker::fillValue(VAHAActionResult& result, const std::shared_ptr<NDService>& service) {
  if (!mapping_) mapping_ = std::make_unique<Mapping>(*action_);
  const auto characteristic = findInArrayByCharacteristicType(
      property(service, &NDService::characteristics), mapping_->type);
  if (!characteristic) return true;
  if (asksForCurrentValue(action_->actionType())) {
    return mapping_->fillCurrentValue(result, *action_, *characteristic);
  }
  const Limit limit = limitOf(action_->actionType());
  return !limit || fillLimit(result, *action_, characteristic->metadata(), limit, mapping_->format);
}

}  // namespace nidus
