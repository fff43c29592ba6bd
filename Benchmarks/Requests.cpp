#include "Requests.h"

#include <memory>
#include <utility>

#include "PlatformModel/Assistant/VAHAConstants.h"

namespace nidus {

BrightnessRequest::BrightnessRequest(std::string_view actionType, const NDString& serviceName) {
  auto filter = std::make_shared<VAHASearchCriteriaFilter>();
  filter->setServiceType("LIGHT");
  filter->setServiceName(serviceName);
  auto action = std::make_shared<VAHAAction>();
  action->setActionType(actionType);
  action->setAttribute("BRIGHTNESS");
  if (actionType != VAHAActionTypeGETValue) {
    auto value = VAHAIntegerValue::integerValue();
    value->setValue(10);
    action->setValue(std::move(value));
  }
  setFilter(std::move(filter));
  setActions({std::move(action)});
}

SceneRequest::SceneRequest(const NDString& sceneName) {
  auto filter = std::make_shared<VAHASearchCriteriaFilter>();
  filter->setSceneName(sceneName);
  auto value = VAHABooleanValue::booleanValue();
  value->setValue(true);
  auto action = std::make_shared<VAHAAction>();
  action->setActionType(VAHAActionTypeSETValue);
  action->setAttribute(VAHAAttributeENABLEDValue);
  action->setValue(std::move(value));
  setFilter(std::move(filter));
  setActions({std::move(action)});
}

}  // namespace nidus
