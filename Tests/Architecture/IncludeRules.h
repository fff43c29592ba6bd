#pragma once

#include <functional>
#include <string>
#include <string_view>
#include <vector>

namespace nidus {

/// One file of the sources: its path below `Sources`, such as "Logging/WLOLog.h", and its lines.
struct SourceFile {
  std::string path;
  std::vector<std::string> lines;
};

/// Says whether there is a file of that path below `Sources`.
using FileExists = std::function<bool(std::string_view path)>;

/// Gives what the includes of `file` do against the layers of the design, in the order of the
/// lines, each as "PATH:LINE: reason"; empty when all is well. The rules are tables in the source
/// file: which folder may include which, and where a library's headers may be seen.
[[nodiscard]] std::vector<std::string> includeViolations(const SourceFile& file,
                                                         const FileExists& exists);

}  // namespace nidus
