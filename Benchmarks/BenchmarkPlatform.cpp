#include "BenchmarkPlatform.h"

#include <cstdio>
#include <cstdlib>
#include <map>
#include <string>
#include <utility>
#include <variant>

#include "LightHome.h"
#include "LightPlatform.h"
#include "PlatformModel/System/NDDeliveryHold.h"

namespace nidus {
namespace {

[[noreturn]] void fail(const std::string& reason) {
  std::fprintf(stderr, "NidusBenchmarks: %s\n", reason.c_str());
  std::exit(1);
}

std::shared_ptr<HomePlatform> openSystem(std::vector<HomeData> homes) {
  HomePlatformOptions options;
  options.drainsOnCaller = true;
  options.metric = true;
  options.homes = std::move(homes);
  options.preferences = {{"kHomesConfigured", JsonValue{true}}};
  options.logSink = [](const NDSystemLogMessage&) {};
  auto opened = HomePlatform::open(std::move(options));
  if (!opened) fail(opened.failure().message);
  return *opened;
}

/// The light home of that shape; each is made once, because the great ones take their time.
std::shared_ptr<NDHome> lightHome(const HomeShape& shape) {
  static std::map<HomeShape, std::shared_ptr<NDHome>> homes;
  std::shared_ptr<NDHome>& home = homes[shape];
  if (!home) home = makeLightHome(benchmarkHome(shape));
  return home;
}

std::vector<HomeData> homesOfSystem(BenchmarkPlatform::Kind kind, const HomeShape& shape) {
  if (kind == BenchmarkPlatform::Kind::light) return {};
  return {benchmarkHome(shape)};
}

std::size_t resultsIn(const NDDictionary& reply) {
  const NDDictionaryValue* results = reply.find("actionResults");
  return results ? std::get<NDDictionaryList>(results->content()).size() : 0;
}

}  // namespace

BenchmarkPlatform::BenchmarkPlatform(Kind kind, const HomeShape& shape)
    : system_(openSystem(homesOfSystem(kind, shape))), platform_(system_) {
  if (kind == Kind::light) {
    platform_ = std::make_shared<LightPlatform>(system_, NDArray<NDHome>{lightHome(shape)});
  }
  if (const auto refusal = NDPlatform::registerPlatform(platform_); !refusal.empty()) fail(refusal);
}

BenchmarkPlatform::~BenchmarkPlatform() {
  NDPlatform::unregisterPlatform(platform_);
  system_->shutDown();
}

std::size_t BenchmarkPlatform::perform(const VAHACommand& request) const {
  std::size_t results = 0;
  std::make_shared<NDAssistantCommand>(request)->performWithCompletion(
      [&results](const NDDictionary& reply) { results += resultsIn(reply); });
  if (platform_ == system_) {
    system_->drain();
  } else {
    platform_->mainQueue()->drain();
  }
  return results;
}

std::shared_ptr<NDAssistantGather> BenchmarkPlatform::gather() const {
  std::shared_ptr<NDAssistantGather> gather;
  {
    const NDDeliveryHold hold;
    gather = NDAssistantGather::init();
    if (!gather) fail("no homes are configured");
    gather->startWithCompletionHandler([](long) {});
  }
  drain();
  return gather;
}

std::shared_ptr<NDAssistantCommand> BenchmarkPlatform::commandWithSnapshot() const {
  auto command = std::make_shared<NDAssistantCommand>(VAHACommand());
  command->setGather(gather());
  command->setNumberOfHomes(1);
  command->setMetadata(NDNAPMetadata::getSharedInstance());
  command->setNidusObjects(command->gather()->gatherNidusObjects());
  return command;
}

void BenchmarkPlatform::drain() const {
  system_->drain();
  platform_->mainQueue()->drain();
}

}  // namespace nidus
