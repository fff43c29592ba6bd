#pragma once

#include <filesystem>

#include "HomePlatform/Result.h"

namespace nidus {

/// Opens a file in the person's editor, which is what VISUAL, else EDITOR, says as a command of the
/// shell, else the machine's own, and waits for its end. A failure is the only line about it: one
/// that does not exist is not started.
[[nodiscard]] Status editInForeground(const std::filesystem::path& file);

}  // namespace nidus
