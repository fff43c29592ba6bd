#pragma once

#include <cstdint>
#include <memory>
#include <string>
#include <vector>

#include "Assistant/NDAssistantCommand.h"
#include "PlatformModel/Assistant/VAHAFilter.h"
#include "PlatformModel/Assistant/VAHAValue.h"

namespace nidus {

/// The values that tests put into actions.
[[nodiscard]] VAHAValueRef booleanValue(bool value);
[[nodiscard]] VAHAValueRef integerValue(std::int64_t value, const NDString& units = nullptr);
[[nodiscard]] VAHAValueRef floatValue(float value, const NDString& units = nullptr);
[[nodiscard]] VAHAValueRef stringValue(const NDString& value);

/// What a test asks for, each field by its name; a field that is not named is null.
///
///     makeCommand({.room = "Hall"}, {{.type = "SET", .attribute = "POWER", .value = ...}})
struct Search {
  const char* home = nullptr;
  const char* entityType = nullptr;
  const char* attribute = nullptr;
  const char* serviceType = nullptr;
  const char* room = nullptr;
  const char* zone = nullptr;
  const char* group = nullptr;
  const char* service = nullptr;
  const char* scene = nullptr;
};

struct Action {
  const char* type = nullptr;
  const char* attribute = nullptr;
  VAHAValueRef value = nullptr;
};

[[nodiscard]] std::shared_ptr<VAHASearchCriteriaFilter> searchFilter(const Search& search);
[[nodiscard]] VAHAActionRef makeAction(const Action& action);

/// A command with any filter, which may be null.
[[nodiscard]] std::shared_ptr<NDAssistantCommand> makeCommand(
    std::shared_ptr<const VAHAFilter> filter, const std::vector<Action>& actions,
    std::shared_ptr<NDAssistantCommandObserver> observer = nullptr);
[[nodiscard]] std::shared_ptr<NDAssistantCommand> makeCommand(
    const Search& search, const std::vector<Action>& actions,
    std::shared_ptr<NDAssistantCommandObserver> observer = nullptr);

/// A result on one line: the entity's name, the outcome and, if they are there, the attribute, the
/// value and its units, such as "Lamp SUCCESS BRIGHTNESS=45 PERCENTAGE".
[[nodiscard]] std::string summary(const VAHAActionResult& result);
/// A reply on one line: its outcome, and each result behind a semicolon.
[[nodiscard]] std::string summary(const NDDictionary& reply);

}  // namespace nidus
