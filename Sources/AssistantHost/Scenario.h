#pragma once

#include <filesystem>
#include <map>
#include <optional>
#include <string>
#include <variant>
#include <vector>

#include "AssistantHost/CommandReader.h"
#include "HomePlatform/Json/JsonValue.h"
#include "HomePlatform/Result.h"
#include "HomePlatform/Store/HomeData.h"
#include "PlatformModel/System/NDString.h"

namespace nidus {

/// Takes a snapshot.
struct RecordsStep {};

/// Performs a command.
struct PerformStep {
  CommandRef command;
};

/// Begins a sync, pulls changes and ends it.
struct SyncStep {
  NDString key;
  NDString anchor;                             ///< May be null.
  NDString validity;                           ///< May be null.
  std::optional<std::vector<NDString>> after;  ///< The anchors to ask with; none asks for all.
};

/// Preferences by key; null stands for none.
using PreferenceChanges = std::map<std::string, JsonValue>;

/// Changes the machine that the plug-in runs on; what is none stays as it is.
struct SetStep {
  std::optional<bool> locked;
  std::optional<bool> silent;
  std::optional<PreferenceChanges> preferences;
};

/// Shows the homes as they are.
struct ExportStep {};

using ScenarioStep = std::variant<RecordsStep, PerformStep, SyncStep, SetStep, ExportStep>;

/// A scripted run of the plug-in on a machine of its own.
struct Scenario {
  PreferenceChanges preferences;
  bool internalBuild = false;
  bool metric = true;
  bool locked = false;
  std::vector<HomeData> homes;
  std::vector<ScenarioStep> steps;
};

/// Reads a scenario (`nidus-scenario/1`) whole, the home document that it names included. A failure
/// is bad input and names the file and the place.
[[nodiscard]] Result<Scenario> readScenario(const std::filesystem::path& file);

}  // namespace nidus
