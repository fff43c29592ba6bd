#include <string>
#include <utility>

#include "Assistant/NDAssistantCommand.h"
#include "AssistantHost/AnswerCollector.h"
#include "AssistantHost/JsonLine.h"
#include "AssistantHost/RegisteredPlatform.h"
#include "AssistantHost/Transcript.h"
#include "PlugIn/CommandChoices.h"
#include "PlugIn/HomeChoices.h"
#include "PlugIn/Invariants.h"
#include "PlugIn/Words.h"
#include "Support/CommandText.h"
#include "Support/Finding.h"
#include "Support/HomeRoundTrip.h"

// The plug-in on homes and with commands that the input chooses: what must hold for every command
// does. A finding is shown as a scenario that `nidus replay` performs, with what happened.

namespace nidus {
namespace {

/// Keeps what a command does in a performance.
class StepKeeper final : public NDAssistantCommandObserver {
 public:
  explicit StepKeeper(Performance& performance) : performance_(performance) {}
  void filterDidRunStep(std::string_view step, const NDDictionaryList& kept) override {
    performance_.steps.push_back({std::string(step), kept});
  }
  void actionDidReach(const std::vector<std::shared_ptr<NDCharacteristic>>& reached) override {
    performance_.reached = reached;
  }

 private:
  Performance& performance_;
};

/// One machine with homes of its own, and the commands that it performs.
class Machine {
 public:
  explicit Machine(Choices& choices);

  /// Performs a command and checks it.
  void perform(const CommandRef& command);
  /// Checks that the homes, as they are, can be kept and carried away.
  void checkHomes() const { checkHomesSurvive(homesNow_); }
  void lock(bool isLocked) {
    steps_ += (steps_.empty() ? "" : ",\n") + std::string(R"({"set": {"locked": )") +
              (isLocked ? "true}}" : "false}}");
    isLocked_ = isLocked;
    platform().setLocked(isLocked);
  }

 private:
  [[nodiscard]] HomePlatform& platform() const { return *(**registered_)->platform(); }
  [[nodiscard]] std::vector<HomeData> homes() const;
  void checkWithoutHomes(const Performance& performance) const;
  [[noreturn]] void report(const std::string& broken, const Performance& performance) const;

  const std::vector<HomeData> homes_;
  const bool isConfigured_;
  bool isLocked_;
  std::vector<HomeData> homesNow_;
  std::string scenario_;  ///< Up to its steps.
  std::string steps_;
  std::vector<PlatformCall> calls_;
  std::optional<Result<std::unique_ptr<RegisteredPlatform>>> registered_;
};

Machine::Machine(Choices& choices)
    : homes_(chooseHomes(choices)),
      isConfigured_(!choices.chance(2)),
      isLocked_(choices.chance(40)) {
  HomePlatformOptions options;
  options.drainsOnCaller = true;
  options.locked = isLocked_;
  options.metric = false;
  options.homes = homes_;
  options.vocabulary = words();
  options.preferences = {{"kHomesConfigured", {isConfigured_}},
                         {"NidusLogLevel", {std::int64_t{7}}}};
  options.logSink = [](const NDSystemLogMessage& /*message*/) {};
  options.failureHandler = [](const Failure& failure) { reportFinding(failure.message); };
  options.callObserver = [this](const PlatformCall& call) { calls_.push_back(call); };
  scenario_ = std::string(R"({"format": "nidus-scenario/1", "metric": false, "locked": )") +
              (isLocked_ ? "true" : "false") +
              ", \"preferences\": {\"kHomesConfigured\": " + (isConfigured_ ? "true" : "false") +
              ", \"NidusLogLevel\": 7},\n\"home\": " + homeDocumentOf(homes_) + ",\n\"steps\": [\n";
  registered_.emplace(RegisteredPlatform::open(std::move(options)));
  if (!*registered_) reportFinding("The platform refuses homes: " + registered_->failure().message);
  homesNow_ = homes();
}

std::vector<HomeData> Machine::homes() const {
  auto homes = platform().exportHomes();
  if (!homes) reportFinding("Homes cannot be exported: " + homes.failure().message);
  return std::move(*homes);
}

void Machine::perform(const CommandRef& request) {
  using Replies = AnswerCollector<NDDictionary>;
  steps_ += (steps_.empty() ? "" : ",\n") + ("{\"perform\": " + commandText(*request) + "}");
  Performance performance;
  performance.command = request;
  performance.isLocked = isLocked_;
  performance.before = homesNow_;
  calls_.clear();
  const auto replies = std::make_shared<Replies>();
  std::make_shared<NDAssistantCommand>(*request, std::make_shared<StepKeeper>(performance))
      ->performWithCompletion(Replies::handler(replies, platform().mainQueue()));
  platform().drain();
  performance.calls = calls_;
  performance.isHandlerReleased = replies->isOver();
  performance.replies = replies->take();
  performance.after = homesNow_ = homes();
  if (!isConfigured_ || homes_.empty()) return checkWithoutHomes(performance);
  const std::string broken = brokenInvariant(performance);
  if (!broken.empty()) report(broken, performance);
}

void Machine::checkWithoutHomes(const Performance& performance) const {
  const bool isOneReply = performance.replies.size() == 1 && performance.isHandlerReleased;
  if (!isOneReply || !performance.calls.empty()) {
    report("A command without homes does not end in one reply.", performance);
  }
}

void Machine::report(const std::string& broken, const Performance& performance) const {
  std::string text = broken + "\n--- scenario\n" + scenario_ + steps_ + "\n]}\n--- calls\n";
  for (const PlatformCall& call : performance.calls) text += jsonLine(transcriptOf(call));
  text += "--- replies\n";
  for (const NDDictionary& reply : performance.replies) text += jsonLine(reply);
  reportFinding(text);
}

}  // namespace
}  // namespace nidus

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
  nidus::Choices choices(data, size);
  nidus::Machine machine(choices);
  for (std::size_t commands = 1 + choices.upTo(5); commands > 0; --commands) {
    if (choices.chance(15)) machine.lock(choices.chance(50));
    machine.perform(nidus::chooseCommand(choices));
  }
  machine.checkHomes();
  return 0;
}
