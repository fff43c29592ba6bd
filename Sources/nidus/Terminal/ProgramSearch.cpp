#include "nidus/Terminal/ProgramSearch.h"

#include <unistd.h>

#include <cstdlib>
#include <sstream>
#include <string_view>

namespace nidus {
namespace {

/// Where programs are when nobody says so.
constexpr const char* kUsualFolders = "/usr/local/bin:/usr/bin:/bin";
constexpr std::string_view kVariable = "PATH=";

}  // namespace

std::string programFolders() {
  const char* const path = std::getenv("PATH");
  std::istringstream parts(path ? path : kUsualFolders);
  std::string folders;
  for (std::string part; std::getline(parts, part, ':');) {
    if (part.starts_with('/')) folders.append(":").append(part);
  }
  return folders.empty() ? kUsualFolders : folders.substr(1);
}

std::string findProgram(const std::string& name, const std::string& folders) {
  if (name.find('/') != std::string::npos) return name;
  std::istringstream parts(folders);
  for (std::string folder; std::getline(parts, folder, ':');) {
    std::string program = folder;
    program.append("/").append(name);
    if (::access(program.c_str(), X_OK) == 0) return program;
  }
  return {};
}

std::vector<std::string> environmentWith(const std::string& folders) {
  std::vector<std::string> environment;
  for (char** entry = environ; *entry; ++entry) {
    if (!std::string_view(*entry).starts_with(kVariable)) environment.emplace_back(*entry);
  }
  environment.push_back(std::string(kVariable) + folders);
  return environment;
}

}  // namespace nidus
