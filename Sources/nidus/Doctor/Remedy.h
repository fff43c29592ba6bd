#pragma once

#include <string>

#include "HomePlatform/Result.h"
#include "nidus/Doctor/Finding.h"

namespace nidus {

/// How a command names `object`, a room or something else with a UUID. A name could belong to
/// several, or be another one by the time that the command is typed.
template <class Object>
[[nodiscard]] std::string wordsOf(const Object& object) {
  return object.uuid.UUIDString().str();
}

/// What is found where the platform or the module gives `failure`, whose message ends with the
/// remedy.
[[nodiscard]] Finding findingOf(const Failure& failure);

}  // namespace nidus
