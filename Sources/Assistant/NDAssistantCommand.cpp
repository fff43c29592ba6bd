#include "Assistant/NDAssistantCommand.h"

#include <array>
#include <string_view>

#include "Logging/WLOLog.h"
#include "PlatformModel/Assistant/VAHAConstants.h"
#include "PlatformModel/System/NDDeliveryHold.h"

namespace nidus {
namespace {

using ActionHandler = void (NDAssistantCommand::*)(const VAHAActionRef&, const NDString&,
                                                   const NDAssistantCommand::ObjectList&,
                                                   const VAHAReplyHandler&);

struct Route {
  std::string_view actionType;
  ActionHandler handler;
};

constexpr ActionHandler kGet =
    &NDAssistantCommand::handleGetActionTypes_serviceType_forObjects_completionHandler;
constexpr ActionHandler kGetMetadata =
    &NDAssistantCommand::handleGetMetadataActionTypes_serviceType_forObjects_completionHandler;
constexpr ActionHandler kSet =
    &NDAssistantCommand::handleSetActionTypes_serviceType_forObjects_completionHandler;
constexpr ActionHandler kUpdate =
    &NDAssistantCommand::handleUpdateActionTypes_serviceType_forObjects_completionHandler;

constexpr std::array kRoutes = {
    Route{VAHAActionTypeGETValue, kGet},
    Route{VAHAActionTypeGET_TARGET_VALUEValue, kGet},
    Route{VAHAActionTypeGET_MINIMUMValue, kGetMetadata},
    Route{VAHAActionTypeGET_MAXIMUMValue, kGetMetadata},
    Route{VAHAActionTypeGET_STEP_VALUEValue, kGetMetadata},
    Route{VAHAActionTypeSETValue, kSet},
    Route{VAHAActionTypeSET_TO_MINIMUMValue, kSet},
    Route{VAHAActionTypeSET_TO_MAXIMUMValue, kSet},
    Route{VAHAActionTypeINCREASEValue, kUpdate},
    Route{VAHAActionTypeDECREASEValue, kUpdate},
    Route{VAHAActionTypeTOGGLEValue, kUpdate},
};

/// The handler for actions of that type; null when there is none. An action without a type reads.
ActionHandler handlerForActionType(const NDString& actionType) {
  if (!actionType) return kGet;
  for (const Route& route : kRoutes) {
    if (actionType == route.actionType) return route.handler;
  }
  return nullptr;
}

const VAHASearchCriteriaFilter* asSearchFilter(const VAHAFilter* filter) {
  if (!filter || filter->encodedClassName() != VAHASearchCriteriaFilterClassIdentifier) {
    return nullptr;
  }
  return dynamic_cast<const VAHASearchCriteriaFilter*>(filter);
}

std::vector<NDURL> identifiersOf(const VAHAFilter* filter) {
  const auto* identifierFilter = dynamic_cast<const VAHAIdentifierFilter*>(filter);
  return identifierFilter ? identifierFilter->identifiers() : std::vector<NDURL>();
}

void logAction(const VAHAAction& action) {
  if (!WLOShouldLogAtLevel(6)) return;
  if (action.attribute()) {
    WLOLog(6, "Incoming Action: %@/attribute=%@/value=%@",
           {action.actionType(), action.attribute(), action.value()});
  } else {
    WLOLog(6, "Incoming Action: %@", {action.actionType()});
  }
}

}  // namespace

NDAssistantCommand::NDAssistantCommand(const VAHACommand& request,
                                       std::shared_ptr<NDAssistantCommandObserver> observer)
    : VAHACommand(request), observer_(std::move(observer)) {}

NDAssistantCommand::~NDAssistantCommand() = default;

NDAssistantCommand::ObjectList NDAssistantCommand::allObjects() const {
  ObjectList objects;
  objects.reserve(nidusObjects_.size());
  for (const HomeObjectRecord& object : nidusObjects_) objects.push_back(&object);
  return objects;
}

void NDAssistantCommand::performWithCompletion(VAHAReplyHandler handler) {
  const NDDeliveryHold hold;
  setGather(NDAssistantGather::init());
  if (!gather_) {
    if (WLOShouldLogAtLevel(5)) WLOLog(5, "No homes configured - short-circuiting", {});
    reportResults_handler(std::nullopt, handler);
    return;
  }
  // The gatherer lets go of this callback, and with it of the command that owns it, once it has
  // called it or learns that it never will.
  gather_->startWithCompletionHandler([self = shared_from_this(), handler = std::move(handler)](
                                          long count) { self->homesDidLoad(count, handler); });
}

void NDAssistantCommand::homesDidLoad(long count, const VAHAReplyHandler& handler) {
  if (count == 0) {
    reportResults_handler(std::nullopt, handler);
    return;
  }
  setNumberOfHomes(count);
  setPrimaryHomeName(gather_->getPrimaryHomeName());
  setPrimaryHomeID(gather_->getPrimaryHomeID());
  setMetadata(NDNAPMetadata::getSharedInstance());
  setNidusObjects(gather_->gatherNidusObjects());
  if (nidusObjects_.empty()) {
    reportResults_handler(std::nullopt, handler);
    return;
  }
  handleCommandWithCompletionHandler(handler);
}

void NDAssistantCommand::handleCommandWithCompletionHandler(const VAHAReplyHandler& handler) {
  std::optional<ObjectList> objects;
  NDString serviceType;
  if (const auto* search = asSearchFilter(filter().get())) {
    const bool needsPrimaryHome = !search->homeName() && numberOfHomes_ >= 2;
    const NDString& homeName = needsPrimaryHome ? primaryHomeName_ : search->homeName();
    if (needsPrimaryHome && !homeName) {
      reportOutcome_results_handler(VAHACommandOutcomeCOMMAND_FAILUREValue, std::nullopt, handler);
      return;
    }
    serviceType = search->serviceType();
    objects = objectsWithSearchFilter_inHome(*search, homeName);
  } else {
    objects = objectsWithIdentifierList(identifiersOf(filter().get()));
  }
  if (!objects || objects->empty() || actions().empty()) {
    returnResults_serviceType_forAction_completionHandler(objects, serviceType, nullptr, handler);
    return;
  }
  performAction(actions().front(), serviceType, *objects, handler);
}

void NDAssistantCommand::performAction(const VAHAActionRef& action, const NDString& serviceType,
                                       const ObjectList& objects, const VAHAReplyHandler& handler) {
  logAction(*action);
  if (const ActionHandler handle = handlerForActionType(action->actionType())) {
    (this->*handle)(action, serviceType, objects, handler);
    return;
  }
  if (WLOShouldLogAtLevel(3)) {
    WLOLog(3, "%s ### Vela sent an unsupported action type: %@",
           {"-[NDAssistantCommand handleCommandWithCompletionHandler:]", action->actionType()});
  }
  reportOutcome_results_handler(VAHACommandOutcomeCOMMAND_FAILUREValue, std::nullopt, handler);
}

void NDAssistantCommand::reportOutcome_results_handler(const NDString& outcome,
                                                       std::optional<Results> results,
                                                       const VAHAReplyHandler& handler) const {
  if (!handler) return;
  const auto reply = VAHACommandCompleted::commandCompleted();
  reply->setCommandOutcome(outcome);
  reply->setActionResults(std::move(results).value_or(Results()));
  handler(reply->dictionary());
}

void NDAssistantCommand::reportResults_handler(std::optional<Results> results,
                                               const VAHAReplyHandler& handler) const {
  const bool hasResults = results && !results->empty();
  reportOutcome_results_handler(hasResults ? VAHACommandOutcomeCOMMAND_SUCCESSValue
                                           : VAHACommandOutcomeFOUND_NO_MATCHING_ENTITIESValue,
                                std::move(results), handler);
}

void NDAssistantCommand::reportUnlockRequired(const VAHAReplyHandler& handler) const {
  reportOutcome_results_handler(VAHACommandOutcomeREQUIRES_UNLOCKValue, Results(), handler);
}

}  // namespace nidus
