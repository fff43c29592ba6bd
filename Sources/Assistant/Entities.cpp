#include "Assistant/Entities.h"

#include <array>
#include <string_view>
#include <utility>

#include "Assistant/EntityTypes.h"
#include "Assistant/ObjectURL.h"
#include "PlatformModel/Assistant/VAHAConstants.h"
#include "PlatformModel/Home/NDNAPMetadata.h"
#include "PlatformModel/System/NDNull.h"
#include "PlatformModel/System/NDUUID.h"

namespace nidus {
namespace {

/// The service type of a service that the assistant has no name for.
constexpr std::string_view kCustomServiceType = "CUSTOM";

NDURL freshIdentifier() {
  std::array<char, 1 + NDUUID::kTextLength> path;
  path[0] = '/';
  NDUUID::random().writeText(path.data() + 1);
  return NDURL::make(kIdentifierScheme, kIdentifierHost, {path.data(), path.size()});
}

std::shared_ptr<VAHAEntity> entityWith(NDString name, NDString entityType) {
  auto entity = VAHAEntity::entity();
  entity->setName(std::move(name));
  entity->setIdentifier(freshIdentifier());
  entity->setEntityType(std::move(entityType));
  return entity;
}

NDString assistantServiceType(const NDString& platformServiceType, const NDNAPMetadata* metadata) {
  NDString mapped =
      property(metadata, &NDNAPMetadata::mapToAssistantServiceName, platformServiceType);
  return mapped ? mapped : NDString(kCustomServiceType);
}

NDString assistantServiceTypeOf(const std::shared_ptr<NDService>& service) {
  return assistantServiceType(property(service, &NDService::serviceType),
                              NDNAPMetadata::getSharedInstance().get());
}

}  // namespace

std::shared_ptr<VAHAEntity> entityFromObject(const HomeObjectRecord& record) {
  return entityFromObject(record, NDNAPMetadata::getSharedInstance().get());
}

std::shared_ptr<VAHAEntity> entityFromObject(const HomeObjectRecord& record,
                                             const NDNAPMetadata* metadata) {
  auto entity = entityWith(record.objectName, record.objectType);
  if (record.objectType == VAHAEntityTypeSERVICEValue) {
    if (record.objectRoom != record.objectHome) entity->setRoom(record.objectRoom);
    entity->setServiceType(assistantServiceType(record.objectServiceType, metadata));
  }
  entity->setHome(record.objectHome);
  entity->setZone(record.objectZone);
  return entity;
}

std::shared_ptr<VAHAEntity> entityFromService(const std::shared_ptr<NDService>& service,
                                              const NDString& serviceType) {
  auto entity = entityWith(property(service, &NDService::name), entityTypes().service);
  entity->setServiceType(serviceType ? serviceType : assistantServiceTypeOf(service));
  const auto accessory = property(service, &NDService::accessory);
  const auto home = property(accessory, &NDAccessory::home);
  entity->setHome(property(home, &NDHome::name));
  const auto room = property(accessory, &NDAccessory::room);
  const NDString& roomName = property(room, &NDRoom::name);
  if (roomName != entity->home()) entity->setRoom(roomName);
  return entity;
}

std::shared_ptr<VAHAEntity> entityFromActionSet(const std::shared_ptr<NDActionSet>& actionSet) {
  return entityWith(property(actionSet, &NDActionSet::name), entityTypes().scene);
}

std::shared_ptr<VAHAEntity> entityFromTrigger(const std::shared_ptr<NDTrigger>& trigger) {
  return entityWith(property(trigger, &NDTrigger::name), entityTypes().trigger);
}

}  // namespace nidus
