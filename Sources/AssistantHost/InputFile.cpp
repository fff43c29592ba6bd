#include "AssistantHost/InputFile.h"

#include <algorithm>
#include <array>
#include <cerrno>
#include <system_error>

#include "HomePlatform/System/DocumentFile.h"

namespace nidus {
namespace {

Failure inputFailure(const std::string& name, const std::string& reason) {
  return {Failure::Kind::badInput,
          name + ": cannot be read (" + reason + "); name a readable file"};
}

}  // namespace

Result<std::ifstream> openInput(const std::filesystem::path& file) {
  if (const std::string kind = noDocumentBut(file); !kind.empty()) {
    return inputFailure(file.string(), kind);
  }
  std::ifstream in(file, std::ios::binary);
  if (!in) return inputFailure(file.string(), std::generic_category().message(errno));
  return in;
}

Result<std::string> readUpTo(std::size_t mostBytes, std::istream& in, const std::string& name) {
  std::string text;
  std::array<char, 65536> block;
  while (text.size() < mostBytes) {
    const std::size_t size = std::min(block.size(), mostBytes - text.size());
    in.read(block.data(), static_cast<std::streamsize>(size));
    if (in.gcount() == 0) break;
    text.append(block.data(), static_cast<std::size_t>(in.gcount()));
  }
  if (in.bad()) return inputFailure(name, "an error of the disk or the connection");
  return text;
}

}  // namespace nidus
