#include <memory>
#include <string_view>
#include <utility>

#include "nidus/CommandSyntax.h"
#include "nidus/Commands/Commands.h"
#include "nidus/StandardStreams.h"

namespace nidus {

/// The texts of Resources/Completion.
extern const std::string_view kBashCompletion;
extern const std::string_view kZshCompletion;
extern const std::string_view kFishCompletion;

namespace {

ExitStatus printScript(const std::string& shell) {
  const std::pair<std::string_view, std::string_view> scripts[] = {
      {"bash", kBashCompletion}, {"zsh", kZshCompletion}, {"fish", kFishCompletion}};
  for (const auto& [name, script] : scripts) {
    if (name == shell) return printText(script);
  }
  return report({Failure::Kind::badInput,
                 "completion: there is no script for " + shell + "; give bash, zsh or fish"});
}

}  // namespace

void declareCompletion(CommandSyntax& program) {
  const auto shell = std::make_shared<std::string>();
  CommandSyntax& syntax = program.command(
      "completion", "Prints the script by which a shell completes commands of nidus",
      "It completes commands, options, attributes, and the names of your own home. Its first\n"
      "lines say where it goes.\n\nExample: to try it in this session of bash\n"
      "  source <(nidus completion bash)\n\n"
      "Exit status: 0 success, 2 bad input, such as another shell, 4 the platform failed.");
  syntax.requiredArgument("SHELL", *shell, "bash, zsh or fish");
  syntax.candidates("SHELL", {Candidates(std::vector<std::string>{"bash", "zsh", "fish"})});
  syntax.run([shell] { return printScript(*shell); });
}

}  // namespace nidus
