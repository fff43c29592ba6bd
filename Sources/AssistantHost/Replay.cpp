#include "AssistantHost/Replay.h"

#include <cstdint>
#include <memory>
#include <sstream>
#include <string>
#include <utility>

#include "AssistantHost/CommandRunner.h"
#include "AssistantHost/JsonLine.h"
#include "AssistantHost/RegisteredPlatform.h"
#include "AssistantHost/SyncClient.h"
#include "AssistantHost/Transcript.h"
#include "HomePlatform/HomePlatform.h"
#include "HomePlatform/Store/HomeDocument.h"

namespace nidus {
namespace {

/// What the platform heard and said during one step. Everything runs on one thread.
struct StepEvents {
  NDDictionaryList calls;
  NDDictionaryList log;
};

HomePlatformOptions optionsOf(const Scenario& scenario, const std::shared_ptr<StepEvents>& events) {
  HomePlatformOptions options;
  options.locked = scenario.locked;
  options.drainsOnCaller = true;
  options.metric = scenario.metric;
  options.homes = scenario.homes;
  options.preferences = scenario.preferences;
  options.internalBuild = scenario.internalBuild;
  options.logSink = [events](const NDSystemLogMessage& message) {
    events->log.emplace_back(transcriptOf(message));
  };
  options.callObserver = [events](const PlatformCall& call) {
    events->calls.emplace_back(transcriptOf(call));
  };
  return options;
}

/// Performs the steps of one scenario and gives the line of each.
class StepRunner {
 public:
  StepRunner(const NDAssistantModule& module, std::shared_ptr<HomePlatform> platform,
             std::shared_ptr<StepEvents> events)
      : module_(module),
        platform_(std::move(platform)),
        events_(std::move(events)),
        runner_(module, platform_->mainQueue(), [this] { platform_->drain(); }) {}

  [[nodiscard]] Result<std::string> run(const ScenarioStep& step, std::int64_t number) {
    *events_ = {};
    line_ = {};
    line_.set("step", NDDictionaryValue(number));
    return std::visit([this](const auto& kind) { return perform(kind); }, step);
  }

 private:
  Result<std::string> perform(const RecordsStep& /*step*/) {
    auto records = runner_.records();
    if (!records) return records.failure();
    line_.set("records", NDDictionaryValue(std::move(*records)));
    return jsonLine(line_);
  }

  Result<std::string> perform(const PerformStep& step) {
    auto replies = runner_.perform(*step.command);
    if (!replies) return replies.failure();
    NDDictionaryList list;
    for (NDDictionary& reply : *replies) list.emplace_back(std::move(reply));
    line_.set("replies", NDDictionaryValue(std::move(list)));
    return lineWithEvents();
  }

  Result<std::string> perform(const SyncStep& step) {
    const auto client = SyncClient::make(module_);
    if (!client) return client.failure();
    SyncClient& sync = **client;
    sync.begin(step.key, step.anchor, step.validity);
    NDDictionaryList changes;
    for (const SyncChange& change : changesOf(step, sync))
      changes.emplace_back(transcriptOf(change));
    sync.end();
    platform_->drain();
    NDDictionaryList resets;
    for (const NDString& validity : sync.resets()) resets.emplace_back(validity);
    line_.set("resets", NDDictionaryValue(std::move(resets)));
    line_.set("changes", NDDictionaryValue(std::move(changes)));
    return lineWithEvents();
  }

  Result<std::string> perform(const SetStep& step) {
    if (step.locked) platform_->setLocked(*step.locked);
    if (step.silent) platform_->setSilent(*step.silent);
    if (step.preferences) {
      if (auto failure = platform_->changePreferences(*step.preferences)) return *failure;
    }
    platform_->drain();
    return jsonLine(line_);
  }

  Result<std::string> perform(const ExportStep& /*step*/) {
    const auto homes = platform_->exportHomes();
    if (!homes) return homes.failure();
    std::string line = jsonLine(line_);
    line.erase(line.rfind('}'));
    std::ostringstream document;
    writeHomeDocument(document, *homes, false);
    return line + ", \"home\": " + document.str() + "}\n";
  }

  static std::vector<SyncChange> changesOf(const SyncStep& step, SyncClient& sync) {
    if (!step.after) return sync.allChanges();
    std::vector<SyncChange> changes;
    for (const NDString& anchor : *step.after) changes.push_back(sync.changeAfter(anchor));
    return changes;
  }

  std::string lineWithEvents() {
    line_.set("platform", NDDictionaryValue(std::move(events_->calls)));
    line_.set("log", NDDictionaryValue(std::move(events_->log)));
    return jsonLine(line_);
  }

  const NDAssistantModule& module_;
  const std::shared_ptr<HomePlatform> platform_;
  const std::shared_ptr<StepEvents> events_;
  CommandRunner runner_;
  NDDictionary line_;
};

Status runSteps(StepRunner& runner, const Scenario& scenario,
                const std::function<Status(std::string_view line)>& write) {
  std::int64_t number = 0;
  for (const ScenarioStep& step : scenario.steps) {
    const auto line = runner.run(step, number++);
    if (!line) return line.failure();
    if (auto failure = write(*line)) return failure;
  }
  return std::nullopt;
}

}  // namespace

Status replay(const Scenario& scenario, const NDAssistantModule& module,
              const std::function<Status(std::string_view line)>& write) {
  const auto events = std::make_shared<StepEvents>();
  const auto registered = RegisteredPlatform::open(optionsOf(scenario, events));
  if (!registered) return registered.failure();
  const auto& platform = (*registered)->platform();
  StepRunner runner(module, platform, events);
  return runSteps(runner, scenario, write);
}

}  // namespace nidus
