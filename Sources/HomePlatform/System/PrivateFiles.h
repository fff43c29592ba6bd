#pragma once

#include <filesystem>

namespace nidus {

/// Files and folders that nobody but their owner may read, whatever the process' file creation mask
/// says.

/// Makes `folder` and those above it that are missing. Gives 0, also when it is there, or the error
/// of the system.
[[nodiscard]] int makePrivateFolder(const std::filesystem::path& folder);

/// Makes an empty `file`. One that is there is left alone, and not even opened: closing it would
/// drop the locks that a database connection of this process holds on it. Gives 0 or the error.
[[nodiscard]] int makePrivateFile(const std::filesystem::path& file);

/// Whether the permissions give anything to others than the owner; a symbolic link gives nothing.
[[nodiscard]] bool isOpenToOthers(const std::filesystem::path& path);

/// Takes from others what the permissions give them. What cannot be taken stays, and so does what a
/// symbolic link leads to, which others may be meant to use.
void keepPrivate(const std::filesystem::path& path);

}  // namespace nidus
