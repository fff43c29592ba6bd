#pragma once

#include <memory>
#include <string>
#include <vector>

#include "HomePlatform/PlatformCall.h"
#include "HomePlatform/Result.h"
#include "HomePlatform/Store/HomeData.h"
#include "PlatformModel/Assistant/VAHACommand.h"
#include "PlatformModel/System/NDDictionary.h"
#include "PlatformModel/System/NDSystemLog.h"
#include "nidus/Session.h"
#include "nidus/Workspace.h"

namespace nidus {

/// Where a characteristic is among all homes.
struct HomeCharacteristic {
  NDUUID home;
  CharacteristicAddress address;
  // NOLINTNEXTLINE(modernize-use-nullptr): a mistake of the check about defaulted comparisons
  friend auto operator<=>(const HomeCharacteristic&, const HomeCharacteristic&) = default;
};

/// What the filter of a command kept after one of its steps.
struct FilterStep {
  std::string name;       ///< As the plug-in calls it, such as "room and zone".
  NDDictionaryList kept;  ///< The records, in dictionary form.
};

/// What was seen while a command was performed on a copy of the homes.
struct Rehearsal {
  std::vector<FilterStep> steps;            ///< In the order in which they ran.
  std::vector<HomeCharacteristic> reached;  ///< What the action found, in order.
  std::vector<PlatformCall> calls;          ///< What the homes were asked to do, in order.
  std::vector<NDSystemLogMessage> log;      ///< What the plug-in logged, whatever the log level.
  std::vector<NDDictionary> replies;
  std::vector<HomeData> after;  ///< The copy as the command left it.
};

/// A copy of all homes in memory on which commands are performed as they would be on the homes,
/// while neither the homes nor their devices are asked or changed. Each device of the copy answers
/// with the value that was known last.
///
/// Used by the main thread alone. While it is open no other platform can be used.
///
///     const auto stage = RehearsalStage::open(workspace);
///     if (!stage) return report(stage.failure());
///     const auto rehearsal = (*stage)->perform(**command);
class RehearsalStage {
 public:
  /// Copies the homes of `workspace`, with its words, preferences and lock, and closes its session.
  /// Never null.
  [[nodiscard]] static Result<std::unique_ptr<RehearsalStage>> open(Workspace& workspace);

  /// Performs `command` on the copy.
  [[nodiscard]] Result<Rehearsal> perform(const VAHACommand& command);

  /// The homes as they were copied.
  [[nodiscard]] const std::vector<HomeData>& homes() const noexcept { return homes_; }
  /// The platform of the copy.
  [[nodiscard]] HomePlatform& platform() const noexcept { return session_->platform(); }

 private:
  /// What is seen while a command runs, all of it on one thread.
  struct Notes;

  RehearsalStage(std::vector<HomeData> homes, std::shared_ptr<Notes> notes,
                 std::unique_ptr<Session> session);

  const std::vector<HomeData> homes_;
  const std::shared_ptr<Notes> notes_;
  const std::unique_ptr<Session> session_;
};

}  // namespace nidus
