#include "nidus/Shell/Shell.h"

#include <unistd.h>

#include <iostream>

#include "nidus/CommandLine.h"
#include "nidus/CommandSyntax.h"
#include "nidus/Commands/Commands.h"
#include "nidus/StandardStreams.h"
#include "nidus/Workspace.h"

namespace nidus {
namespace {

ExitStatus runShell(Workspace& workspace) {
  const auto session = workspace.assistant();
  if (!session) return report(session.failure());
  Shell shell(workspace, [&workspace](CommandSyntax& program) {
    declareWorkspaceCommands(program, workspace);
  });
  const bool isOnTerminal = isatty(STDIN_FILENO) != 0 && isatty(STDOUT_FILENO) != 0;
  const ExitStatus status = isOnTerminal ? shell.talk() : shell.runLines(std::cin);
  // The session of the beginning may be gone: `explain` ends it.
  const auto last = workspace.home();
  return last ? (*last)->statusAfter(status) : report(last.failure());
}

}  // namespace

void declareShell(CommandSyntax& program, Workspace& workspace) {
  CommandSyntax& syntax = program.command(
      "shell", "Runs commands line by line, with history and completion",
      "The commands are those of the program. Words are quoted as in other shells: 'Café Corner',\n"
      "\"Café Corner\" or Café\\ Corner; # begins a comment. On a terminal the tab key completes\n"
      "commands, words and the names of your homes, earlier lines come back with the arrow keys,\n"
      "an interrupt throws the line away, and the time of each command is shown. From a pipe the\n"
      "lines are run one after the other; a bad one is reported with its number.\n\n"
      "Example:\n"
      "  printf 'home show\\nrecords\\n' | nidus shell\n\n"
      "Exit status: on a terminal 0; from a pipe the highest of all lines, 0 success, 1 any other\n"
      "outcome, 2 bad input, 3 no reply, 4 the platform failed.");
  syntax.run([&workspace] { return runShell(workspace); });
}

}  // namespace nidus
