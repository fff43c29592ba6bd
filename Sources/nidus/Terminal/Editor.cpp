#include "nidus/Terminal/Editor.h"

#include <cstdlib>
#include <string>

#include "nidus/Terminal/ForegroundProgram.h"

namespace nidus {
namespace {

constexpr int kNotFound = 127;  ///< As shells have it.

/// Edits the file "$1" with the command "$2", or, when that is empty, the machine's own editor.
/// What the shell would say about a command that it cannot read or find is left to us. The shell
/// outlives an interrupt that the editor takes.
constexpr const char kScript[] = R"(
editor=$2
[ "$editor" ] || { editor=vi; command -v editor >/dev/null && editor=editor; }
(
  eval "set -- $editor"
  case $1 in *=*) ;; *) command -v "$1" ;; esac
) >/dev/null 2>&1 || exit 127
trap : INT QUIT
eval "$editor \"\$1\""
)";

std::string editorCommand() {
  for (const char* variable : {"VISUAL", "EDITOR"}) {
    const char* const editor = std::getenv(variable);
    if (editor && *editor != '\0') return editor;
  }
  return "";
}

}  // namespace

Status editInForeground(const std::filesystem::path& file) {
  const std::string command = editorCommand();
  const auto ended = runInForeground({"/bin/sh", "-c", kScript, "nidus", file.string(), command});
  if (!ended) return ended.failure();
  if (*ended == 0) return std::nullopt;
  const std::string what =
      *ended == kNotFound
          ? "the editor " + (command.empty() ? "vi" : command) + " cannot be started"
          : "the editor ended with status " + std::to_string(*ended);
  return Failure{Failure::Kind::badInput, what + "; set EDITOR to one that works here"};
}

}  // namespace nidus
