#pragma once

#include <memory>

#include "Assistant/HomeObjectRecord.h"
#include "Assistant/NDAssistantGather.h"
#include "PlatformModel/Assistant/VAHAAction.h"
#include "PlatformModel/Assistant/VAHAActionResult.h"
#include "PlatformModel/Home/NDService.h"
#include "PlatformModel/System/NDString.h"

namespace nidus {

// Fill in what one result of an action says. All of them may be called from any thread on which the
// home's objects may be read; every pointer and text may be null unless said otherwise.

/// Fills `result`, whose outcome has been set, with the attribute that it answers, the value or the
/// limit that `action` asks for, read from the characteristics of `service` as they are cached, and
/// the entity of `service`, for which `serviceType`, the assistant service type of the command's
/// filter, wins over its own. A result that is not a success gets no value.
///
/// Says whether the result is an answer to the action: false for a question with a value that is
/// not the service's ("which lights are on"), and for a limit that there is not.
bool populateResultWithService(VAHAActionResult& result, const NDString& serviceType,
                               const VAHAActionRef& action,
                               const std::shared_ptr<NDService>& service);

/// The same for a record: a service's record with an action that has an attribute is filled as
/// above, any other gets the attribute and the record's entity, and is always an answer.
bool populateResultWithObject(VAHAActionResult& result, const NDString& serviceType,
                              const VAHAActionRef& action, const HomeObjectRecord& record,
                              const std::shared_ptr<NDAssistantGather>& gather);

/// Fills `result` with the attribute of `action` and with `entity`; always an answer.
bool populateResultWithEntity(VAHAActionResult& result, const VAHAActionRef& action,
                              std::shared_ptr<const VAHAEntity> entity);

}  // namespace nidus
