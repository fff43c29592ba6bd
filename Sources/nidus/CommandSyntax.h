#pragma once

#include <functional>
#include <string>
#include <vector>

#include "nidus/Candidates.h"
#include "nidus/ExitStatus.h"

namespace nidus {

/// Takes the declaration of one command: its options, its arguments, the commands below it, and
/// what runs it. Each command's own unit declares it, and alone knows its options.
///
/// What is declared with a target must keep the target alive through the function given to `run`.
///
///     auto file = std::make_shared<std::string>("-");
///     CommandSyntax& perform = program.command("perform", "Performs commands", "");
///     perform.argument("FILE", *file, "The commands");
///     perform.run([file] { return performFile(*file); });
class CommandSyntax {
 public:
  virtual ~CommandSyntax() = default;

  /// Adds a command below this one. `help` is one line, `details` (may be empty) follow the options
  /// in the command's own help. Valid as long as this one.
  virtual CommandSyntax& command(const std::string& name, const std::string& help,
                                 const std::string& details) = 0;
  /// Adds an option without a value, such as "--merge", that sets `target`.
  virtual void flag(const std::string& name, bool& target, const std::string& help) = 0;
  /// Adds an option with a value, such as "--data"; `value` names it in the help.
  virtual void option(const std::string& name, const std::string& value, std::string& target,
                      const std::string& help) = 0;
  /// The same, and it must be there; and one that may be repeated, each time with one value.
  virtual void requiredOption(const std::string& name, const std::string& value,
                              std::string& target, const std::string& help) = 0;
  virtual void repeatedOption(const std::string& name, const std::string& value,
                              std::vector<std::string>& target, const std::string& help) = 0;
  /// Adds an argument that may be left out, and one that must be there.
  virtual void argument(const std::string& name, std::string& target, const std::string& help) = 0;
  virtual void requiredArgument(const std::string& name, std::string& target,
                                const std::string& help) = 0;
  /// Adds an argument of any number of words, all of them to the end, and one of a word or more.
  virtual void optionalArguments(const std::string& name, std::vector<std::string>& target,
                                 const std::string& help) = 0;
  virtual void requiredArguments(const std::string& name, std::vector<std::string>& target,
                                 const std::string& help) = 0;
  /// Says what may stand for the option or argument `name`, which is declared already. An argument
  /// of several words has one entry for each word; the last one is also for all that follow.
  virtual void candidates(const std::string& name, std::vector<Candidates> ofWords) = 0;
  /// Leaves this command, which is for programs, out of the help and of completion.
  virtual void hide() = 0;
  /// Whether anything asks for this command; what would be declared below it is forgotten if not.
  [[nodiscard]] virtual bool isWanted() const { return true; }
  /// Sets what runs when this command is the one that was given.
  virtual void run(std::function<ExitStatus()> action) = 0;
};

}  // namespace nidus
