#include <memory>
#include <string>
#include <utility>
#include <vector>

#include "nidus/CommandSyntax.h"
#include "nidus/Commands/Commands.h"
#include "nidus/Orders/OrderAnswer.h"
#include "nidus/Orders/OrderOptions.h"
#include "nidus/StandardStreams.h"
#include "nidus/Workspace.h"

namespace nidus {
namespace {

constexpr const char kValues[] =
    "Values: on or off, yes or no, true or false (and locked or unlocked, open or closed, muted "
    "or\n"
    "unmuted, for what can be); 40, 40%, 21.5C, 70F; a word of the attribute, such as heat.";

constexpr const char kStatuses[] =
    "Exit status: 0 success, even when single objects failed, 1 any other outcome, 2 bad input,\n"
    "3 no reply, 4 the platform failed.";

/// What is given to one order on the command line.
struct OrderInput {
  OrderWords words;
  std::string attribute;
  std::vector<std::string> more;
  bool isJson = false;
  bool isQuiet = false;
};

ExitStatus runOrder(const OrderInput& input, Workspace& workspace) {
  if (input.isJson && input.isQuiet) {
    return report({Failure::Kind::badInput, "--json and --quiet exclude each other; give one"});
  }
  OrderWords words = input.words;
  if (!input.attribute.empty()) words.words.push_back(input.attribute);
  words.words.insert(words.words.end(), input.more.begin(), input.more.end());
  const auto session = workspace.home();
  if (!session) return report(session.failure());
  return answerOrder(**session, words,
                     input.isJson    ? AnswerForm::json
                     : input.isQuiet ? AnswerForm::quiet
                                     : AnswerForm::table);
}

/// Declares the order of one verb.
class OrderDeclaration {
 public:
  OrderDeclaration(CommandSyntax& program, Workspace& workspace, const std::string& verb,
                   const std::string& help, const std::string& details)
      : syntax_(program.command(verb, help, details + "\n\n" + kStatuses)) {
    if (!syntax_.isWanted()) return;
    input_->words.verb = verb;
    declareFilterOptions(syntax_, input_->words.filter);
    syntax_.flag("--json", input_->isJson, "Print the replies themselves, one JSON line each");
    syntax_.flag("--quiet", input_->isQuiet, "Print nothing: the exit status tells");
    syntax_.run([input = input_, &workspace] { return runOrder(*input, workspace); });
  }

  void attribute(const std::string& help) {
    syntax_.requiredArgument(kAttribute, input_->attribute, help);
    syntax_.candidates(kAttribute, {{CandidateKind::attributes}});
  }
  void optionalAttribute(const std::string& help) {
    syntax_.argument(kAttribute, input_->attribute, help);
    syntax_.candidates(kAttribute, {{CandidateKind::attributes}});
  }
  /// An attribute with nothing behind it, which may be of several words.
  void attributeAlone(const std::string& help) {
    syntax_.requiredArguments(kAttribute, input_->more, help);
    syntax_.candidates(kAttribute, {{CandidateKind::attributes}});
  }
  void words(const std::string& name, const std::string& help, std::vector<Candidates> ofWords) {
    syntax_.optionalArguments(name, input_->more, help);
    syntax_.candidates(name, std::move(ofWords));
  }
  void requiredWords(const std::string& name, const std::string& help,
                     std::vector<Candidates> ofWords) {
    syntax_.requiredArguments(name, input_->more, help);
    syntax_.candidates(name, std::move(ofWords));
  }
  void target(const std::string& help) { syntax_.flag("--target", input_->words.asksTarget, help); }

 private:
  static constexpr const char* kAttribute = "ATTRIBUTE";

  const std::shared_ptr<OrderInput> input_ = std::make_shared<OrderInput>();
  CommandSyntax& syntax_;
};

void declareGet(CommandSyntax& program, Workspace& workspace) {
  OrderDeclaration get(program, workspace, "get", "Tells values, or which objects have one",
                       std::string("Examples:\n"
                                   "  nidus get brightness --room Kitchen\n"
                                   "  nidus get power is on --type light    which lights are on?\n"
                                   "  nidus get temperature --target        what it is to become\n"
                                   "  nidus get --entity room               which rooms are there?"
                                   "\n\n") +
                           kValues);
  get.optionalAttribute("What to tell, in either case; without it the objects alone");
  get.words("is VALUE", "Tells those that have this value",
            {Candidates(std::vector<std::string>{"is"}), {CandidateKind::values}});
  get.target("Tell the value that was set, not the one that is");
}

void declareSet(CommandSyntax& program, Workspace& workspace) {
  OrderDeclaration set(
      program, workspace, "set", "Sets values",
      std::string("Examples:\n"
                  "  nidus set power on --room Kitchen --type light\n"
                  "  nidus set temperature 70F --service Thermostat\n"
                  "  nidus set brightness maximum --group \"Reading Lights\"\n\n") +
          kValues);
  set.attribute("What to set, in either case");
  set.requiredWords("VALUE", "To what; of a number also minimum or maximum",
                    {{CandidateKind::values}});
}

void declareRelative(CommandSyntax& program, Workspace& workspace, const std::string& verb,
                     const std::string& help) {
  const std::string order = "  nidus " + verb;
  OrderDeclaration relative(
      program, workspace, verb, help,
      "By so much from what it is now, within the limits of each device.\n\nExamples:\n" + order +
          " brightness 10% --room Kitchen\n" + order + " temperature 2C --home \"Lake Cabin\"\n" +
          order + " volume");
  relative.attribute("What to change, in either case");
  relative.words("BY", "By how much; 5 when it is left out", {{CandidateKind::values}});
}

void declareToggle(CommandSyntax& program, Workspace& workspace) {
  OrderDeclaration toggle(program, workspace, "toggle", "Turns what is on off and what is off on",
                          "Example:\n  nidus toggle power --service \"Desk Lamp\"");
  toggle.attributeAlone("What to toggle, in either case");
}

void declareLimits(CommandSyntax& program, Workspace& workspace) {
  OrderDeclaration limits(program, workspace, "limits", "Tells minimum, maximum and step of values",
                          "As the devices state them, temperatures in their own unit.\n\n"
                          "Example:\n  nidus limits temperature --type thermostat");
  limits.attributeAlone("Whose limits to tell, in either case");
}

void declareRun(CommandSyntax& program, Workspace& workspace) {
  OrderDeclaration run(program, workspace, "run", "Runs a scene",
                       "The name is taken as it is written, accents aside.\n\n"
                       "Example:\n  nidus run \"Good Night\" --home \"Lake Cabin\"");
  run.words("SCENE", "The name of the scene", {{CandidateKind::scenes}});
}

}  // namespace

void declareOrders(CommandSyntax& program, Workspace& workspace) {
  declareGet(program, workspace);
  declareSet(program, workspace);
  declareRelative(program, workspace, "raise", "Raises values");
  declareRelative(program, workspace, "lower", "Lowers values");
  declareToggle(program, workspace);
  declareLimits(program, workspace);
  declareRun(program, workspace);
}

}  // namespace nidus
