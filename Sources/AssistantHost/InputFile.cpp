#include "AssistantHost/InputFile.h"

#include <cerrno>
#include <system_error>

namespace nidus {
namespace {

Failure inputFailure(const std::string& name, const std::string& reason) {
  return {Failure::Kind::badInput,
          name + ": cannot be read (" + reason + "); name a readable file"};
}

}  // namespace

Result<std::ifstream> openInput(const std::filesystem::path& file) {
  std::error_code error;
  if (std::filesystem::is_directory(file, error)) return inputFailure(file.string(), "a folder");
  std::ifstream in(file, std::ios::binary);
  if (!in) return inputFailure(file.string(), std::generic_category().message(errno));
  return in;
}

Result<std::string> readAll(std::istream& in, const std::string& name) {
  std::string text;
  char block[65536];
  while (in.read(block, sizeof block) || in.gcount() > 0) {
    text.append(block, static_cast<std::size_t>(in.gcount()));
  }
  if (in.bad()) return inputFailure(name, "an error of the disk or the connection");
  return text;
}

}  // namespace nidus
