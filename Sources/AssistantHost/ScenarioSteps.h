#pragma once

#include <optional>

#include "AssistantHost/Scenario.h"
#include "HomePlatform/Json/JsonObject.h"

namespace nidus {

/// Reads one step of a scenario. Throws `JsonError`.
[[nodiscard]] ScenarioStep stepFromJson(const JsonPlaced& placed);

/// The value of the key "preferences" of a scenario or of a step; none when it is absent. Throws
/// `JsonError`.
[[nodiscard]] std::optional<PreferenceChanges> preferencesFromJson(JsonObject& object);

/// The value of a key that is true or false; none when it is absent. Throws `JsonError`.
[[nodiscard]] std::optional<bool> optionalBoolean(JsonObject& object, std::string_view key);

}  // namespace nidus
