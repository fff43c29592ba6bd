#pragma once

#include <memory>

#include "Assistant/HomeObjectRecord.h"
#include "PlatformModel/Assistant/VAHAEntity.h"
#include "PlatformModel/Home/NDHome.h"
#include "PlatformModel/Home/NDNAPMetadata.h"
#include "PlatformModel/System/NDString.h"

namespace nidus {

/// Each builds a new entity, never null, with a fresh random identifier; what is missing in the
/// input leaves the entity's field unset. May be called from any thread.
[[nodiscard]] std::shared_ptr<VAHAEntity> entityFromObject(const HomeObjectRecord& record);
/// The same for many: with a mapper, which may be null, that has been asked for.
[[nodiscard]] std::shared_ptr<VAHAEntity> entityFromObject(const HomeObjectRecord& record,
                                                           const NDNAPMetadata* metadata);
/// `service` may be null; `serviceType`, the assistant service type that the command asked for, may
/// be null and otherwise wins over the service's own.
[[nodiscard]] std::shared_ptr<VAHAEntity> entityFromService(
    const std::shared_ptr<NDService>& service, const NDString& serviceType);
/// The argument may be null.
[[nodiscard]] std::shared_ptr<VAHAEntity> entityFromActionSet(
    const std::shared_ptr<NDActionSet>& actionSet);
[[nodiscard]] std::shared_ptr<VAHAEntity> entityFromTrigger(
    const std::shared_ptr<NDTrigger>& trigger);

}  // namespace nidus
