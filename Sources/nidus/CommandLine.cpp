#include "nidus/CommandLine.h"

#include <CLI/CLI.hpp>
#include <algorithm>
#include <csignal>
#include <memory>
#include <new>
#include <utility>
#include <vector>

#include "nidus/CommandSyntax.h"
#include "nidus/Commands/Commands.h"
#include "nidus/StandardStreams.h"
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

/// Declares a command to the parser of arguments.
class ParserSyntax final : public CommandSyntax {
 public:
  /// `chosen` takes what runs the command that was given.
  ParserSyntax(CLI::App& app, std::function<ExitStatus()>& chosen) : app_(app), chosen_(chosen) {
    app_.set_help_flag("-h,--help", "Print this help and exit");
  }

  CommandSyntax& command(const std::string& name, const std::string& help,
                         const std::string& details) override {
    CLI::App* below = app_.add_subcommand(name, help);
    below->fallthrough();
    below->footer(details + (details.empty() ? "" : "\n\n") + kOptionsOfAll);
    app_.require_subcommand(1);
    below_.push_back(std::make_unique<ParserSyntax>(*below, chosen_));
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
  CLI::App& app_;
  std::function<ExitStatus()>& chosen_;
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

ExitStatus parseAndRun(CLI::App& app, std::vector<std::string> words,
                       const std::function<ExitStatus()>& chosen, CommandPlace place) {
  try {
    // The parser takes them from the end.
    std::reverse(words.begin(), words.end());
    app.parse(std::move(words));
  } catch (const CLI::CallForHelp&) {
    return printText(app.help());
  } catch (const CLI::CallForVersion& version) {
    return printText(std::string(version.what()) + '\n');
  } catch (const CLI::ParseError& error) {
    return reportUsage(usageErrorOf(app, error), place);
  }
  try {
    return chosen();
  } catch (const std::bad_alloc&) {
    return report({Failure::Kind::platform,
                   "there is not enough memory for this; give the program more of it, or less to "
                   "read"});
  }
}

}  // namespace

ExitStatus runCommand(std::vector<std::string> words,
                      const std::function<void(CommandSyntax&)>& declare, CommandPlace place) {
  CLI::App app("Lets an assistant's commands act on a home.", "nidus");
  app.set_version_flag("--version", "nidus " NIDUS_VERSION);
  app.footer(place == CommandPlace::shell ? kShellHelp : kFirstHelp);
  std::function<ExitStatus()> chosen;
  ParserSyntax program(app, chosen);
  declare(program);
  return parseAndRun(app, std::move(words), chosen, place);
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
