#pragma once

#include "AssistantHost/CommandReader.h"
#include "PlugIn/Choices.h"

namespace nidus {

/// Makes a command: every kind of filter with any of its fields, every type of action, attributes
/// that the vocabulary knows or not, values of each class with units or without.
[[nodiscard]] CommandRef chooseCommand(Choices& choices);

}  // namespace nidus
