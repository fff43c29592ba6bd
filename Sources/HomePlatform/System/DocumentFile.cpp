#include "HomePlatform/System/DocumentFile.h"

#include <system_error>

namespace nidus {

namespace fs = std::filesystem;

std::string noDocumentBut(const fs::path& path) {
  std::error_code error;
  // What leads to a pipe without a name leads, followed to its end, to nothing.
  const fs::path target = fs::canonical(path, error);
  if (error) return {};
  switch (fs::status(target, error).type()) {
    case fs::file_type::directory:
      return "a folder";
    case fs::file_type::fifo:
      return "a named pipe";
    default:
      return {};
  }
}

}  // namespace nidus
