#pragma once

#include <filesystem>

#include "HomePlatform/Result.h"
#include "PlatformModel/Assistant/NDAssistantModule.h"

namespace nidus {

/// Finds the plug-in module that belongs to the running program: from the folder of the program
/// itself in `../lib/nidus`, or where the installation keeps its libraries. Neither the working
/// folder nor the environment has a say. A failure names the file that is missing.
[[nodiscard]] Result<std::filesystem::path> findAssistantModule();

/// Opens the module in `file`, unless others may change it or what leads there, and checks that it
/// was built for this program, before anything else of it is used. The module stays open until the
/// process ends; the result is never null. Opening it again gives the same module. A failure names
/// the file and the remedy.
[[nodiscard]] Result<const NDAssistantModule*> openAssistantModule(
    const std::filesystem::path& file);

/// Checks what a module offers (may be null) against what this program was built with; `file`
/// stands for the module in the failure.
[[nodiscard]] Status checkAssistantModule(const NDAssistantModule* offered,
                                          const std::filesystem::path& file);

}  // namespace nidus
