#include "nidus/CommandLine.h"

#include <CLI/CLI.hpp>
#include <algorithm>
#include <csignal>
#include <memory>
#include <new>
#include <optional>
#include <utility>
#include <vector>

#include "nidus/CommandSyntax.h"
#include "nidus/Commands/Commands.h"
#include "nidus/StandardStreams.h"
#include "nidus/SystemLibrary.h"
#include "nidus/UnusedSyntax.h"
#include "nidus/UsageErrors.h"
#include "nidus/Workspace.h"

namespace nidus {
namespace {

constexpr const char kOptionsOfAll[] =
    "The options of all commands, such as --data, are in nidus --help.";

constexpr const char kFirstHelp[] =
    "See it work with nidus demo; begin with nidus home import FILE.\n"
    "The options may stand before or after a command. Each command has a help of its own:\n"
    "nidus COMMAND --help\n\n"
    "Exit status: 0 success, 1 any other outcome, 2 bad input, 3 no reply, 4 the platform failed.";

/// The same in the shell, which has words of its own and no tour.
constexpr const char kShellHelp[] =
    "help COMMAND tells more about one, exit leaves. Begin with home import FILE.";

/// The check of a value: an empty one, as a script passes by mistake, must not count as none, and
/// so turn an order for one room into one for all of the home.
std::string refuseEmpty(const std::string& value) {
  return value.empty() ? "the value is empty" : "";
}

/// The commands that are declared to the parser, by name; empty declares all.
using DeclaredNames = std::vector<std::string>;

/// Declares a command to the parser of arguments.
class ParserSyntax final : public CommandSyntax {
 public:
  /// `chosen` takes what runs the command that was given.
  ParserSyntax(CLI::App& app, const DeclaredNames& declared, std::function<ExitStatus()>& chosen)
      : app_(app), declared_(declared), chosen_(chosen) {
    app_.set_help_flag("-h,--help", "Print this help and exit");
  }

  CommandSyntax& command(const std::string& name, const std::string& help,
                         const std::string& details) override {
    app_.require_subcommand(1);
    if (!isDeclared(name)) return unused_;
    CLI::App* below = app_.add_subcommand(name, help);
    below->fallthrough();
    below->footer(details + (details.empty() ? "" : "\n\n") + kOptionsOfAll);
    below_.push_back(std::make_unique<ParserSyntax>(*below, declared_, chosen_));
    return *below_.back();
  }
  void flag(const std::string& name, bool& target, const std::string& help) override {
    app_.add_flag(name, target, help);
  }
  void option(const std::string& name, const std::string& value, std::string& target,
              const std::string& help) override {
    app_.add_option(name, target, help)->option_text(value)->check(refuseEmpty);
  }
  void requiredOption(const std::string& name, const std::string& value, std::string& target,
                      const std::string& help) override {
    app_.add_option(name, target, help)->option_text(value + " (required)")->required();
  }
  void repeatedOption(const std::string& name, const std::string& value,
                      std::vector<std::string>& target, const std::string& help) override {
    app_.add_option(name, target, help)->option_text(value)->allow_extra_args(false);
  }
  void argument(const std::string& name, std::string& target, const std::string& help) override {
    app_.add_option(name, target, help)->option_text(" ");
  }
  void requiredArgument(const std::string& name, std::string& target,
                        const std::string& help) override {
    app_.add_option(name, target, help)->option_text(" ")->required();
  }
  void optionalArguments(const std::string& name, std::vector<std::string>& target,
                         const std::string& help) override {
    app_.add_option(name, target, help)->option_text("...");
  }
  void requiredArguments(const std::string& name, std::vector<std::string>& target,
                         const std::string& help) override {
    app_.add_option(name, target, help)->option_text("...")->required();
  }
  void candidates(const std::string&, std::vector<Candidates>) override {}
  void hide() override { app_.group(""); }
  void run(std::function<ExitStatus()> action) override {
    app_.callback([this, action = std::move(action)] { chosen_ = action; });
  }

 private:
  [[nodiscard]] bool isDeclared(const std::string& name) const {
    return declared_.empty() ||
           std::find(declared_.begin(), declared_.end(), name) != declared_.end();
  }

  CLI::App& app_;
  const DeclaredNames& declared_;
  std::function<ExitStatus()>& chosen_;
  UnusedSyntax unused_;
  std::vector<std::unique_ptr<ParserSyntax>> below_;
};

}  // namespace

void declareProgram(CommandSyntax& program, Workspace& workspace) {
  program.option("--data", "DIR", workspace.settings().dataFolder,
                 "The folder of the homes and preferences (else NIDUS_DATA, else nidus in the "
                 "user's data folder)");
  program.candidates("--data", {{CandidateKind::files}});
  declareWorkspaceCommands(program, workspace);
  declareReplay(program);
  declareDemo(program);
  declareShell(program, workspace);
  declareComplete(program, workspace);
  declareCompletion(program);
}

void declareWorkspaceCommands(CommandSyntax& program, Workspace& workspace) {
  program.flag("--locked", workspace.settings().isLocked, "The device is locked");
  declareHome(program, workspace);
  declareOrders(program, workspace);
  declarePerform(program, workspace);
  declareSync(program, workspace);
  declareRecords(program, workspace);
  declareVocabulary(program, workspace);
  declarePreferences(program, workspace);
  declareExplain(program, workspace);
  declareDoctor(program, workspace);
  declareWatch(program, workspace);
}

namespace {

ExitStatus reportUsage(const UsageError& error, CommandPlace place) {
  const bool isInShell = place == CommandPlace::shell;
  const std::string help = isInShell ? "help" + error.command : "nidus" + error.command + " --help";
  const std::string remedy =
      error.meant.empty() ? "see " + help : "did you mean " + error.meant + '?';
  return report({Failure::Kind::badInput, error.reason + "; " + remedy});
}

/// The words of one command with the parser that takes them.
class CommandParser {
 public:
  CommandParser(const std::function<void(CommandSyntax&)>& declare, DeclaredNames declared,
                CommandPlace place)
      : declared_(std::move(declared)), place_(place) {
    app_.set_version_flag("--version", "nidus " NIDUS_VERSION);
    app_.footer(place == CommandPlace::shell ? kShellHelp : kFirstHelp);
    declare(program_.emplace(app_, declared_, chosen_));
  }

  /// Whether they are a command to be run.
  [[nodiscard]] bool takes(std::vector<std::string> words) {
    try {
      parse(std::move(words));
      return true;
    } catch (const CLI::ParseError&) {
      return false;
    }
  }
  /// Runs the command that was taken.
  [[nodiscard]] ExitStatus run() const {
    try {
      return chosen_();
    } catch (const std::bad_alloc&) {
      return report({Failure::Kind::platform,
                     "there is not enough memory for this; give the program more of it, or less to "
                     "read"});
    } catch (const MissingLibrary& missing) {
      return report({Failure::Kind::platform, missing.what()});
    }
  }

  /// Runs the command that they are, or says why they are none or what was asked for instead.
  ExitStatus runOrTell(std::vector<std::string> words) {
    try {
      parse(std::move(words));
    } catch (const CLI::CallForHelp&) {
      return printText(app_.help());
    } catch (const CLI::CallForVersion& version) {
      return printText(std::string(version.what()) + '\n');
    } catch (const CLI::ParseError& error) {
      return reportUsage(usageErrorOf(app_, error), place_);
    }
    return run();
  }

 private:
  void parse(std::vector<std::string> words) {
    // The parser takes them from the end.
    std::reverse(words.begin(), words.end());
    app_.parse(std::move(words));
  }

  CLI::App app_{"Lets an assistant's commands act on a home.", "nidus"};
  const DeclaredNames declared_;
  std::function<ExitStatus()> chosen_;
  std::optional<ParserSyntax> program_;
  const CommandPlace place_;
};

}  // namespace

/// Declaring all commands costs more than running one, so first those alone are declared that the
/// words name. Whatever is to be said of all of them, as by help and by most errors, needs all.
ExitStatus runCommand(std::vector<std::string> words,
                      const std::function<void(CommandSyntax&)>& declare, CommandPlace place) {
  CommandParser named(declare, words, place);
  if (named.takes(words)) return named.run();
  return CommandParser(declare, {}, place).runOrTell(std::move(words));
}

int runCommandLine(int argc, const char* const* argv) {
  // A reader that has gone is an error of the write that meets it, not the end of the process.
  std::signal(SIGPIPE, SIG_IGN);
  Workspace workspace;
  return static_cast<int>(runCommand({argv + 1, argv + argc}, [&workspace](CommandSyntax& program) {
    declareProgram(program, workspace);
  }));
}

}  // namespace nidus
