#pragma once

#include <functional>
#include <string>
#include <vector>

#include "nidus/ExitStatus.h"

namespace nidus {

class CommandSyntax;
class Workspace;

/// Runs the program with its arguments; the result is the exit status of the process.
int runCommandLine(int argc, const char* const* argv);

/// Declares the whole program: the options of all commands and the commands.
void declareProgram(CommandSyntax& program, Workspace& workspace);

/// Declares the part of it that the shell runs too: what works on the one workspace.
void declareWorkspaceCommands(CommandSyntax& program, Workspace& workspace);

/// Where a command is given, and so how a person asks for help there.
enum class CommandPlace { outside, shell };

/// Declares a program, reads `words` (without the program's name) as its arguments, and runs the
/// command that they give. What is wrong with them is reported.
ExitStatus runCommand(std::vector<std::string> words,
                      const std::function<void(CommandSyntax&)>& declare,
                      CommandPlace place = CommandPlace::outside);

}  // namespace nidus
