#include <iostream>
#include <memory>

#include "AssistantHost/CommandReader.h"
#include "AssistantHost/InputFile.h"
#include "nidus/CommandSyntax.h"
#include "nidus/Commands/Commands.h"
#include "nidus/Explain/Explanation.h"
#include "nidus/Orders/OrderOptions.h"
#include "nidus/Orders/OrderRun.h"
#include "nidus/StandardStreams.h"
#include "nidus/Workspace.h"

namespace nidus {
namespace {

struct ExplainInput {
  OrderWords words;
  std::string command;
  bool isJson = false;
};

Result<std::string> textOf(const std::string& file) {
  if (file == "-") return readUpTo(kBytesToJudge, std::cin, "standard input");
  auto in = openInput(file);
  if (!in) return in.failure();
  return readUpTo(kBytesToJudge, *in, file);
}

/// The command that is given itself, in a file or as its name says.
Result<Order> readCommandOrder(const std::string& given) {
  const bool isText = given.find('{') != std::string::npos;
  const auto text = isText ? Result<std::string>(given) : textOf(given);
  if (!text) return text.failure();
  auto command = readCommand(*text, isText ? "--command" : given);
  if (!command) return command.failure();
  return orderOf(std::move(*command));
}

Result<Order> readInput(const ExplainInput& input, Workspace& workspace) {
  const bool hasWords = !input.words.verb.empty();
  if (hasWords == !input.command.empty()) {
    return Failure{Failure::Kind::badInput,
                   "explain takes either an order, such as get brightness, or --command COMMAND"};
  }
  if (!hasWords) return readCommandOrder(input.command);
  const auto session = workspace.home();
  if (!session) return session.failure();
  return readOrderFor(**session, input.words);
}

ExitStatus explainInput(ExplainInput input, Workspace& workspace) {
  auto& words = input.words.words;
  if (!words.empty()) {
    input.words.verb = words.front();
    words.erase(words.begin());
  }
  auto order = readInput(input, workspace);
  if (!order) return report(order.failure());
  const auto stage = RehearsalStage::open(workspace);
  if (!stage) return report(stage.failure());
  const auto explanation = explain(std::move(*order), **stage);
  if (!explanation) return report(explanation.failure());
  return printText(input.isJson ? explanationJson(*explanation, **stage)
                                : explanationText(*explanation, **stage, standardOutputStyle()));
}

}  // namespace

void declareExplain(CommandSyntax& program, Workspace& workspace) {
  const auto input = std::make_shared<ExplainInput>();
  CommandSyntax& syntax = program.command(
      "explain", "Tells what an order would do, and why, without doing it",
      "What the filter keeps after each step, what the action reaches, what would be read or\n"
      "written, and how the answer comes about. No device is asked, nothing is changed.\n\n"
      "Examples:\n"
      "  nidus explain set brightness 40% --room Kitchen\n"
      "  nidus explain --command '{\"filter\": {\"search\": {\"serviceType\": \"LIGHT\"}}}'\n\n"
      "Exit status: 0 explained, whatever the answer would be; 2 bad input, 4 the platform "
      "failed.");
  syntax.optionalArguments("ORDER", input->words.words, "An order, as it is given to nidus");
  syntax.candidates("ORDER", {Candidates(std::vector<std::string>{"get", "set", "raise", "lower",
                                                                  "toggle", "limits", "run"}),
                              {CandidateKind::attributes},
                              {CandidateKind::values}});
  declareFilterOptions(syntax, input->words.filter);
  syntax.flag("--target", input->words.asksTarget, "With get: the value that was set");
  syntax.option("--command", "COMMAND", input->command,
                "A command of nidus perform instead: JSON, a file, or - for standard input");
  syntax.flag("--json", input->isJson, "Print a JSON line for each command of the order");
  syntax.run([input, &workspace] { return explainInput(*input, workspace); });
}

}  // namespace nidus
