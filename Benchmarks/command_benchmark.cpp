#include <benchmark/benchmark.h>

#include <cstdlib>
#include <memory>
#include <string_view>

#include "Assistant/NDAssistantCommand.h"
#include "BenchmarkHome.h"
#include "HomePlatform/HomePlatform.h"
#include "PlatformModel/Assistant/VAHAConstants.h"

namespace nidus {
namespace {

/// A platform in memory with its threads, registered for as long as it lives.
class BenchmarkPlatform {
 public:
  explicit BenchmarkPlatform(std::size_t services) {
    auto opened = HomePlatform::open({.logSink = [](const NDSystemLogMessage&) {}});
    if (!opened) std::abort();
    platform_ = *opened;
    if (platform_->importHomes(benchmarkHomes(services), false)) std::abort();
    if (!NDPlatform::registerPlatform(platform_).empty()) std::abort();
  }
  ~BenchmarkPlatform() {
    platform_->shutDown();
    NDPlatform::unregisterPlatform(platform_);
  }
  BenchmarkPlatform(const BenchmarkPlatform&) = delete;
  BenchmarkPlatform& operator=(const BenchmarkPlatform&) = delete;

  /// Performs one command to its end; gives the number of replies.
  std::size_t perform(const VAHACommand& request) {
    std::size_t replies = 0;
    bool isOver = false;
    {
      const auto mainQueue = platform_->mainQueue();
      std::shared_ptr<void> end(
          nullptr, [&isOver, mainQueue](void*) { mainQueue->async([&isOver] { isOver = true; }); });
      std::make_shared<NDAssistantCommand>(request)->performWithCompletion(
          [&replies, end](const NDDictionary&) { ++replies; });
    }
    platform_->mainQueue()->runUntil([&isOver] { return isOver; });
    return replies;
  }

 private:
  std::shared_ptr<HomePlatform> platform_;
};

struct Request : VAHACommand {
  Request(NDString serviceName, std::string_view type, std::string_view attribute) {
    auto filter = std::make_shared<VAHASearchCriteriaFilter>();
    filter->setServiceType("LIGHT");
    filter->setServiceName(std::move(serviceName));
    setFilter(std::move(filter));
    auto action = std::make_shared<VAHAAction>();
    action->setActionType(type);
    action->setAttribute(attribute);
    setActions({std::move(action)});
  }
};

/// A whole command, threads and hops included: one target among `range(0)` services.
void BM_ReadOne(benchmark::State& state) {
  BenchmarkPlatform platform(static_cast<std::size_t>(state.range(0)));
  const Request request("Lamp 5", VAHAActionTypeGETValue, "POWER");
  for (auto _ : state) benchmark::DoNotOptimize(platform.perform(request));
}
BENCHMARK(BM_ReadOne)->Arg(10)->Arg(100)->Arg(1'000)->UseRealTime();

/// The same with every service a target.
void BM_ReadAll(benchmark::State& state) {
  BenchmarkPlatform platform(static_cast<std::size_t>(state.range(0)));
  const Request request(nullptr, VAHAActionTypeGETValue, "POWER");
  for (auto _ : state) benchmark::DoNotOptimize(platform.perform(request));
  state.SetItemsProcessed(state.iterations() * state.range(0));
}
BENCHMARK(BM_ReadAll)->Arg(10)->Arg(100)->Arg(1'000)->UseRealTime();

}  // namespace
}  // namespace nidus
