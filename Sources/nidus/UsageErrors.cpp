#include "nidus/UsageErrors.h"

#include <CLI/CLI.hpp>
#include <cstddef>
#include <string_view>
#include <vector>

#include "nidus/Orders/NearMiss.h"

namespace nidus {
namespace {

/// The command that the arguments have led to.
const CLI::App& innermost(const CLI::App& app) {
  const auto below = app.get_subcommands();
  return below.empty() ? app : innermost(*below.front());
}

/// Such as " home add"; nothing for the program itself.
std::string pathOf(const CLI::App& command) {
  const CLI::App* const above = command.get_parent();
  return above ? pathOf(*above) + ' ' + command.get_name() : "";
}

std::vector<std::string> commandsOf(const CLI::App& app) {
  std::vector<std::string> names;
  for (const CLI::App* below : app.get_subcommands(nullptr)) {
    if (!below->get_group().empty()) names.push_back(below->get_name());
  }
  return names;
}

/// The long options, without their dashes, of a command and of all above it.
std::vector<std::string> optionsOf(const CLI::App& command) {
  std::vector<std::string> names;
  for (const CLI::App* app = &command; app; app = app->get_parent()) {
    for (const CLI::Option* option : app->get_options()) {
      names.insert(names.end(), option->get_lnames().begin(), option->get_lnames().end());
    }
  }
  return names;
}

std::string meantOf(std::string_view word, const std::vector<std::string>& known) {
  return std::string(nearMiss(word, {known.begin(), known.end()}));
}

UsageError unknownOption(const std::string& word, const CLI::App& command) {
  const std::string option = word.substr(0, word.find('='));
  const std::string reason = "there is no option " + option;
  const std::size_t start = option.find_first_not_of('-');
  if (start == std::string::npos) return {reason};
  const std::string meant = meantOf(option.substr(start), optionsOf(command));
  return {reason, meant.empty() ? "" : "--" + meant};
}

/// What is wrong with a word that nothing is declared for.
UsageError unknownWord(const std::string& word, const CLI::App& command) {
  if (word.size() > 1 && word.front() == '-') return unknownOption(word, command);
  const auto commands = commandsOf(command);
  if (commands.empty()) return {"there is no place for the argument " + word};
  return {"there is no command " + word, meantOf(word, commands)};
}

/// The option or argument that an error is about: the parser begins its text with the name.
const CLI::Option* subjectOf(const CLI::ParseError& error, const CLI::App& command) {
  const std::string text = error.what();
  const std::string name = text.substr(0, text.find(':'));
  for (const CLI::App* app = &command; app; app = app->get_parent()) {
    if (const CLI::Option* option = app->get_option_no_throw(name)) return option;
  }
  return nullptr;
}

/// The first option or argument that must be there and is not; null when there is none.
const CLI::Option* missingOf(const CLI::App& command) {
  for (const CLI::Option* option : command.get_options()) {
    if (option->get_required() && option->count() == 0) return option;
  }
  return nullptr;
}

std::string reasonOf(const CLI::ParseError& error, const CLI::App& command) {
  if (dynamic_cast<const CLI::ArgumentMismatch*>(&error)) {
    const CLI::Option* const option = subjectOf(error, command);
    const bool isRepeated = option && option->count() > 1;
    if (isRepeated) return option->get_name() + " is given more than once";
    if (option) return option->get_name() + " has no value after it";
  }
  if (dynamic_cast<const CLI::RequiredError*>(&error)) {
    const CLI::Option* const missing = missingOf(command);
    if (missing) return missing->get_name() + " is missing";
    if (!commandsOf(command).empty()) return "a command is missing";
  }
  return error.what();
}

}  // namespace

UsageError usageErrorOf(const CLI::App& program, const CLI::ParseError& error) {
  const CLI::App& command = innermost(program);
  const auto unknown = program.remaining(true);
  UsageError usage = unknown.empty() ? UsageError{reasonOf(error, command)}
                                     : unknownWord(unknown.front(), command);
  usage.command = pathOf(command);
  return usage;
}

}  // namespace nidus
