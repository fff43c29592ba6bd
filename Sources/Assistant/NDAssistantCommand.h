#pragma once

#include <memory>
#include <optional>
#include <utility>
#include <vector>

#include "Assistant/HomeObjectRecord.h"
#include "Assistant/NDAssistantGather.h"
#include "PlatformModel/Assistant/AFServiceCommand.h"
#include "PlatformModel/Assistant/NDAssistantModule.h"
#include "PlatformModel/Assistant/VAHACommand.h"
#include "PlatformModel/Home/NDHome.h"
#include "PlatformModel/Home/NDNAPMetadata.h"
#include "PlatformModel/System/NDString.h"
#include "PlatformModel/System/NDURL.h"
#include "PlatformModel/System/NDValue.h"

namespace nidus {

/// Performs one home-automation command of the assistant: takes a snapshot of the homes, finds the
/// objects that the filter names, performs the first action on them and replies.
///
/// One object serves one command; it is owned by shared pointers and keeps itself alive until the
/// last reply. The entry runs on the caller's thread, filtering and dispatch on the thread on which
/// the platform delivers the homes, the answers of the platform on its threads, the report of an
/// action's results on the main queue. It takes no lock of its own; each step follows the one
/// before.
///
///     auto command = std::make_shared<NDAssistantCommand>(request);
///     command->performWithCompletion([](const NDDictionary& reply) { show(reply); });
///
/// The operations below `performWithCompletion` are its steps. They need the properties that the
/// snapshot sets, take an `action`, texts and a `handler` that may be null unless said otherwise,
/// and end in a report to the handler, except where they say that they do not.
class NDAssistantCommand : public VAHACommand,
                           public AFServiceCommand,
                           public std::enable_shared_from_this<NDAssistantCommand> {
 public:
  /// Records of the command's own snapshot, none null, in an order and with duplicates that matter.
  using ObjectList = std::vector<const HomeObjectRecord*>;
  using CharacteristicList = std::vector<std::shared_ptr<NDCharacteristic>>;
  using Results = VAHACommandCompleted::Results;

  /// Takes the filter and the actions of `request`; `observer` hears what the command does.
  explicit NDAssistantCommand(const VAHACommand& request,
                              std::shared_ptr<NDAssistantCommandObserver> observer = nullptr);
  ~NDAssistantCommand() override;

  /// The gatherer of this command, and with it the homes; null before the command is performed and
  /// when no homes are configured.
  [[nodiscard]] const std::shared_ptr<NDAssistantGather>& gather() const noexcept {
    return gather_;
  }
  void setGather(std::shared_ptr<NDAssistantGather> gather) { gather_ = std::move(gather); }
  /// The snapshot. `ObjectList`s point into it, so it is set once.
  [[nodiscard]] const HomeObjectRecords& nidusObjects() const noexcept { return nidusObjects_; }
  void setNidusObjects(HomeObjectRecords objects) { nidusObjects_ = std::move(objects); }
  [[nodiscard]] long numberOfHomes() const noexcept { return numberOfHomes_; }
  void setNumberOfHomes(long count) noexcept { numberOfHomes_ = count; }
  /// The name of the primary home; null without one.
  [[nodiscard]] const NDString& primaryHomeName() const noexcept { return primaryHomeName_; }
  void setPrimaryHomeName(NDString name) { primaryHomeName_ = std::move(name); }
  /// The UUID's text of the primary home; null without one.
  [[nodiscard]] const NDString& primaryHomeID() const noexcept { return primaryHomeID_; }
  void setPrimaryHomeID(NDString identifier) { primaryHomeID_ = std::move(identifier); }
  [[nodiscard]] const std::shared_ptr<NDNAPMetadata>& metadata() const noexcept {
    return metadata_;
  }
  void setMetadata(std::shared_ptr<NDNAPMetadata> metadata) { metadata_ = std::move(metadata); }

  /// Every record of the snapshot, in order.
  [[nodiscard]] ObjectList allObjects() const;

  // Entry, dispatch and reports.

  void performWithCompletion(VAHAReplyHandler handler) override;
  /// Finds the objects of the filter and hands them, with the first action, to its handler.
  void handleCommandWithCompletionHandler(const VAHAReplyHandler& handler);
  /// Replies with `outcome` (never null) and `results`; no results make an empty list.
  void reportOutcome_results_handler(const NDString& outcome, std::optional<Results> results,
                                     const VAHAReplyHandler& handler) const;
  /// Replies with success when there is any result, be it a failed one, else with "no match".
  void reportResults_handler(std::optional<Results> results, const VAHAReplyHandler& handler) const;
  /// Replies that the device must be unlocked first.
  void reportUnlockRequired(const VAHAReplyHandler& handler) const;

  // The filter. Each operation gives what it found and reports nothing to a handler.

  /// The records that `filter` names in the home called `homeName`, or in every home without a
  /// name. None when several homes bear the name and none of them is the primary one, and when the
  /// service type is unknown. The pieces of the filter are logged at level 6 as far as they were
  /// reached.
  [[nodiscard]] std::optional<ObjectList> objectsWithSearchFilter_inHome(
      const VAHASearchCriteriaFilter& filter, const NDString& homeName) const;
  /// The records of `objects` in the rooms of that name that lie in a zone of that name, room by
  /// room; rooms are looked up in the whole snapshot, so rooms of one name repeat their records.
  [[nodiscard]] ObjectList filterObjects_forRoom_andZone(const ObjectList& objects,
                                                         const NDString& roomName,
                                                         const NDString& zoneName) const;
  /// The records whose groups include that name.
  [[nodiscard]] ObjectList filterObjects_forGroup(const ObjectList& objects,
                                                  const NDString& groupName) const;
  /// The service records that can be read for the assistant's attribute name.
  [[nodiscard]] ObjectList filterObjects_byAttribute(const ObjectList& objects,
                                                     const NDString& attribute) const;
  /// The characteristic of the platform's type `type` of each record that is a service and has
  /// one; none for a null type. Records that are no service are logged at level 4.
  [[nodiscard]] CharacteristicList filterObjects_forcharacteristicType(const ObjectList& objects,
                                                                       const NDString& type) const;
  /// Gives the empty list, whatever the identifiers: hosts rely on commands that name their
  /// objects by identifiers finding no match.
  [[nodiscard]] ObjectList objectsWithIdentifierList(const std::vector<NDURL>& identifiers) const;

  // Reading.

  /// Reports a success for each object, without reading it; none, as well as the empty list, is "no
  /// match".
  void returnResults_serviceType_forAction_completionHandler(
      const std::optional<ObjectList>& objects, const NDString& serviceType,
      const VAHAActionRef& action, const VAHAReplyHandler& handler);
  /// Reads the attribute's values, one batch per home, and reports them. A batch that meets a
  /// locked accessory reports the unlock by itself, and the results are reported all the same.
  void handleGetActionTypes_serviceType_forObjects_completionHandler(
      const VAHAActionRef& action, const NDString& serviceType, const ObjectList& objects,
      const VAHAReplyHandler& handler);
  /// Reports the attribute's limits as the homes state them; asks no accessory.
  void handleGetMetadataActionTypes_serviceType_forObjects_completionHandler(
      const VAHAActionRef& action, const NDString& serviceType, const ObjectList& objects,
      const VAHAReplyHandler& handler);

  // Writing and scenes.

  /// Writes the action's value to the attribute's characteristics, one batch per home, and reports
  /// one result for each that was written or is read-only; a scene among the objects is run
  /// instead. A batch that meets a locked accessory replies twice, as in reading.
  void handleSetActionTypes_serviceType_forObjects_completionHandler(
      const VAHAActionRef& action, const NDString& serviceType, const ObjectList& objects,
      const VAHAReplyHandler& handler);
  /// Runs a scene that `action` switches on, and reports one result. Without a scene nothing is run
  /// and nothing is reported.
  void executeActionSet_action_withCompletionHandler(const std::shared_ptr<NDActionSet>& actionSet,
                                                     const VAHAActionRef& action,
                                                     const VAHAReplyHandler& handler);

  // Relative updates.

  /// Reads, changes and writes the attribute's values, one read and at most one write per home, and
  /// reports one result for each. A batch that meets a locked accessory makes the unlock the only
  /// reply of the command.
  void handleUpdateActionTypes_serviceType_forObjects_completionHandler(
      const VAHAActionRef& action, const NDString& serviceType, const ObjectList& objects,
      const VAHAReplyHandler& handler);
  /// The value that `action` makes of the current value of `characteristic`, neither null: the
  /// opposite boolean, or the sum in the characteristic's own units, kept within its limits. The
  /// slot `outcome` (never null) is for an override that refuses: what it puts there becomes the
  /// outcome, and nothing is written. This one never touches it. Reports nothing.
  [[nodiscard]] virtual NDValueRef updateValue_forAction_outcome(
      const std::shared_ptr<NDCharacteristic>& characteristic, const VAHAActionRef& action,
      NDString* outcome) const;

 private:
  void homesDidLoad(long count, const VAHAReplyHandler& handler);
  void performAction(const VAHAActionRef& action, const NDString& serviceType,
                     const ObjectList& objects, const VAHAReplyHandler& handler);

  const std::shared_ptr<NDAssistantCommandObserver> observer_;
  std::shared_ptr<NDAssistantGather> gather_;
  HomeObjectRecords nidusObjects_;
  long numberOfHomes_ = 0;
  NDString primaryHomeName_;
  NDString primaryHomeID_;
  std::shared_ptr<NDNAPMetadata> metadata_;
};

}  // namespace nidus
