#include "Replay/ReplayRun.h"

#include <sys/wait.h>

#include <cstdlib>

#include "Support/TestFolder.h"

namespace nidus {
namespace {

/// The program that is tried: the one that was built, unless the environment names another.
std::filesystem::path program() {
  const char* const given = std::getenv("NIDUS_PROGRAM");
  return given ? given : NIDUS_PROGRAM;
}

std::string quoted(const std::filesystem::path& path) { return "'" + path.string() + "'"; }

}  // namespace

ReplayRun runReplay(const std::filesystem::path& scenario, const std::string& environment) {
  const TestFolder folder;
  const auto output = folder.path() / "output";
  const auto errors = folder.path() / "errors";
  // The shell is replaced by the program, so that the program's own end is seen.
  const std::string command = "ulimit -c 0; exec env " + environment + " " + quoted(program()) +
                              " replay " + quoted(scenario) + " </dev/null >" + quoted(output) +
                              " 2>" + quoted(errors);
  const int status = std::system(command.c_str());
  ReplayRun run;
  if (WIFEXITED(status)) run.exitStatus = WEXITSTATUS(status);
  if (WIFSIGNALED(status)) run.signal = WTERMSIG(status);
  run.output = contentOfFile(output);
  run.errors = contentOfFile(errors);
  return run;
}

}  // namespace nidus
