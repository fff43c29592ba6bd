#include "PlatformModel/Assistant/VAHAEntity.h"

namespace nidus {

std::shared_ptr<VAHAEntity> VAHAEntity::entity() { return std::make_shared<VAHAEntity>(); }

NDDictionary VAHAEntity::dictionary() const {
  NDDictionary form;
  form.reserve(7);
  form.setIfPresent("name", name_);
  if (identifier_) form.setIfPresent("identifier", identifier_.text());
  form.setIfPresent("entityType", entityType_);
  form.setIfPresent("serviceType", serviceType_);
  form.setIfPresent("room", room_);
  form.setIfPresent("home", home_);
  form.setIfPresent("zone", zone_);
  return form;
}

}  // namespace nidus
