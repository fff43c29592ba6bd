#include "Replay/ReplayRun.h"

#include <sys/wait.h>

#include <cstdlib>
#include <fstream>
#include <iterator>
#include <stdexcept>

namespace nidus {
namespace {

std::string quoted(const std::filesystem::path& path) { return "'" + path.string() + "'"; }

}  // namespace

ScratchFolder::ScratchFolder() {
  std::string name = (std::filesystem::temp_directory_path() / "nidus-replay-XXXXXX").string();
  if (::mkdtemp(name.data()) == nullptr) throw std::runtime_error("no scratch folder: " + name);
  path_ = name;
}

ScratchFolder::~ScratchFolder() {
  std::error_code ignored;
  std::filesystem::remove_all(path_, ignored);
}

std::filesystem::path ScratchFolder::write(const std::string& name,
                                           std::string_view content) const {
  std::ofstream(path_ / name, std::ios::binary) << content;
  return path_ / name;
}

std::string contentOf(const std::filesystem::path& file) {
  std::ifstream stream(file, std::ios::binary);
  return {std::istreambuf_iterator<char>(stream), std::istreambuf_iterator<char>()};
}

ReplayRun runReplay(const std::filesystem::path& scenario, const std::string& environment) {
  const ScratchFolder folder;
  const auto output = folder.path() / "output";
  const auto errors = folder.path() / "errors";
  // The shell is replaced by the program, so that the program's own end is seen.
  const std::string command = "ulimit -c 0; exec env " + environment + " " + quoted(NIDUS_PROGRAM) +
                              " replay " + quoted(scenario) + " </dev/null >" + quoted(output) +
                              " 2>" + quoted(errors);
  const int status = std::system(command.c_str());
  ReplayRun run;
  if (WIFEXITED(status)) run.exitStatus = WEXITSTATUS(status);
  if (WIFSIGNALED(status)) run.signal = WTERMSIG(status);
  run.output = contentOf(output);
  run.errors = contentOf(errors);
  return run;
}

}  // namespace nidus
