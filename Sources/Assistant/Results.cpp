#include "Assistant/Results.h"

#include <utility>

#include "Assistant/Entities.h"
#include "Assistant/ObjectLookUp.h"
#include "Assistant/ResultMaker.h"
#include "PlatformModel/Assistant/VAHAConstants.h"
#include "PlatformModel/System/NDNull.h"

namespace nidus {

bool populateResultWithService(VAHAActionResult& result, const NDString& serviceType,
                               const VAHAActionRef& action,
                               const std::shared_ptr<NDService>& service) {
  return ResultMaker(action, serviceType).fill(result, service);
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
