#include "Load/Stress.h"

#include <fcntl.h>

#include <algorithm>
#include <atomic>
#include <chrono>
#include <thread>
#include <utility>

#include "Load/EmbeddedStage.h"
#include "Load/UnrulyStage.h"

namespace nidus {
namespace {

using Clock = std::chrono::steady_clock;

/// The database engine puts the closing of a file off while another connection to it holds a lock.
constexpr std::size_t kDescriptorsPutOff = 4;
constexpr std::size_t kStepsPerChange = 64;
constexpr std::size_t kStepsPerSync = 50;
constexpr std::size_t kLeak = std::size_t{1} << 20;

// Sanitizers keep what was freed, so the memory says nothing there.
#if defined(__SANITIZE_THREAD__) || defined(__SANITIZE_ADDRESS__)
constexpr bool kIsMemoryTelling = false;
#else
constexpr bool kIsMemoryTelling = true;
#endif

std::unique_ptr<Stage> makeStage(const StressOptions& options, StressRecord& record) {
  if (options.platform == StressOptions::Platform::embedded) {
    return std::make_unique<EmbeddedStage>(record, options.threads);
  }
  return std::make_unique<UnrulyStage>(record, options.threads);
}

double secondsSince(Clock::time_point begin) {
  return std::chrono::duration<double>(Clock::now() - begin).count();
}

}  // namespace

Stress::Stress(const StressOptions& options, std::uint64_t seed)
    : options_(options), random_(seed), record_(options.plant) {}

Stress::~Stress() = default;

void Stress::run() {
  stage_ = makeStage(options_, record_);
  runRounds();
  stage_.reset();
  judgeGrowth();
}

void Stress::runRounds() {
  const auto begin = Clock::now();
  do {
    runRound();
    plantLeaks();
    last_ = {record_.commands, ProcessFigures::now()};
    if (first_.commands == 0) first_ = last_;
    seconds_ = secondsSince(begin);
  } while (!isOver());
}

bool Stress::isOver() const {
  if (options_.seconds) return seconds_ >= static_cast<double>(*options_.seconds);
  return record_.commands >= options_.commands;
}

void Stress::runRound() {
  roundEnd_ = record_.commands + options_.round;
  if (!options_.seconds) roundEnd_ = std::min(roundEnd_, options_.commands);
  stage_->beginRound(roundEnd_ - record_.commands, random_);
  std::atomic<std::size_t> calling = options_.threads;
  std::vector<std::thread> callers;
  for (std::size_t caller = 0; caller < options_.threads; ++caller) {
    callers.emplace_back([this, caller, &calling, random = Random(random_.seed())] {
      call(caller, random);
      --calling;
      stage_->wakeMainQueue();
    });
  }
  stage_->runMainQueue([&calling] { return calling == 0; });
  for (auto& thread : callers) thread.join();
  stage_->endRound();
}

void Stress::call(std::size_t caller, Random random) {
  while (record_.commands < roundEnd_) {
    if (random.oneIn(kStepsPerChange)) {
      stage_->change(caller, random);
    } else if (random.oneIn(kStepsPerSync)) {
      stage_->sync(caller, random);
    } else {
      stage_->command(caller, random);
    }
  }
}

void Stress::plantLeaks() {
  if (record_.isPlanted(Plant::leakedDescriptor)) {
    static_cast<void>(open("/dev/null", O_RDONLY | O_CLOEXEC));
  }
  if (record_.isPlanted(Plant::leakedMemory)) {
    static auto& kept = *new std::vector<std::vector<char>>;
    kept.emplace_back(kLeak, 'x');
  }
}

void Stress::judgeGrowth() {
  const ProcessFigures& before = first_.figures;
  const ProcessFigures& after = last_.figures;
  const std::string where = "from the first round to the last";
  record_.expect(after.threads <= before.threads, "there are more threads", where);
  record_.expect(after.descriptors <= before.descriptors + kDescriptorsPutOff,
                 "there are more descriptors", where);
  if (!kIsMemoryTelling) return;
  record_.expect(after.residentKiB <= before.residentKiB + options_.growthKiB,
                 "the memory has grown", where);
  record_.expect(after.allocatedKiB <= before.allocatedKiB + options_.growthKiB,
                 "what is allocated has grown", where);
}

std::vector<std::string> Stress::report() const {
  const auto after = [](const Measured& measured) {
    return "after " + std::to_string(measured.commands) + " commands: " + measured.figures.text();
  };
  return {std::to_string(record_.commands) + " commands, of which " +
              std::to_string(record_.unanswered) + " ended without a reply; " +
              std::to_string(record_.replies) + " replies",
          std::to_string(record_.syncs) + " syncs, " + std::to_string(record_.resets) +
              " resets; " + std::to_string(record_.changes) + " changes of the homes",
          std::to_string(static_cast<std::size_t>(seconds_)) + " seconds", after(first_),
          after(last_)};
}

}  // namespace nidus
