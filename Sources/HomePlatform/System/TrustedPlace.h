#pragma once

#include <filesystem>

#include "HomePlatform/Result.h"

namespace nidus {

/// Whose word counts: a file or folder is trusted when it belongs to the user, to root or to the
/// owner of the running program, and has no write permission for its group or for all. What others
/// could have written is refused, as with it they would decide what the assistant does. The failure
/// names the place and the remedy.

/// Fails when others may change the file or folder. One that is missing is trusted. What leads
/// there is not looked at, but for a symbolic link that `path` itself is.
[[nodiscard]] Status checkTrusted(const std::filesystem::path& path);

/// The same for it and for all that leads there, folders and symbolic links, from the root on:
/// whoever may change one of them may exchange all below. A folder with the sticky bit, such as
/// /tmp, keeps what is in it from others. Nothing that has been found trusted can be exchanged by
/// others afterwards, so it may be opened by its name.
[[nodiscard]] Status checkTrustedWay(const std::filesystem::path& path);

}  // namespace nidus
