#pragma once

#include <memory>
#include <string>
#include <string_view>

#include "HomePlatform/Json/JsonObject.h"
#include "HomePlatform/Result.h"
#include "PlatformModel/Assistant/VAHACommand.h"

namespace nidus {

/// A command that nobody changes any more; never null.
using CommandRef = std::shared_ptr<const VAHACommand>;

/// Reads a command: an optional "filter" (`{"search": {…}}` or `{"identifiers": […]}`) and a list
/// "actions". Texts are passed on as they stand: judging them is the plug-in's work. Throws
/// `JsonError`.
[[nodiscard]] CommandRef commandFromJson(const JsonPlaced& command);

/// Reads a text that is one command; `name` stands for the text in the failure, which is bad input.
[[nodiscard]] Result<CommandRef> readCommand(std::string_view text, const std::string& name);

/// How much of a text has to be read to see whether it is one command or too long to be one.
inline constexpr std::size_t kBytesToJudge = kCommandLimits.documentBytes + 1;

}  // namespace nidus
