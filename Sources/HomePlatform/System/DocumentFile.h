#pragma once

#include <filesystem>
#include <string>

namespace nidus {

/// What the file at `path` is when it is none that a document can be read from: a folder, or a
/// named pipe, which could be waited for without end. Empty for all others and for one that is
/// missing. A pipe that a shell has made, such as /dev/stdin, has no name and is one of the others.
[[nodiscard]] std::string noDocumentBut(const std::filesystem::path& path);

}  // namespace nidus
