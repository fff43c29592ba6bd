#include "Roads.h"

#include <array>
#include <cstdio>
#include <cstdlib>
#include <functional>
#include <memory>
#include <optional>
#include <sstream>
#include <string>
#include <utility>

#include "BenchmarkPlatform.h"
#include "BenchmarkSync.h"
#include "HomePlatform/Store/HomeDocument.h"
#include "PlatformModel/Assistant/VAHAConstants.h"
#include "Requests.h"
#include "SeededRandom.h"

/// What is counted, by its name: it must stay a function of its own.
extern "C" __attribute__((noinline)) std::size_t nidusCountedRoad(
    const std::function<std::size_t()>& road) {
  return road();
}

namespace nidus {
namespace {

constexpr std::size_t kServices = 1'000;
constexpr std::size_t kNameLength = 24;
constexpr HomeShape kShape{.services = kServices, .nameLength = kNameLength, .hasScene = true};

/// Gives the number of things that it came by.
using Road = std::function<std::size_t()>;

/// How a road is prepared, and what it has to come by.
struct RoadPlan {
  std::string_view name;
  Road (*prepare)();
  std::size_t expected;
};

std::shared_ptr<BenchmarkPlatform> makePlatform() {
  return std::make_shared<BenchmarkPlatform>(BenchmarkPlatform::Kind::embedded, kShape);
}

Road prepareCommand(std::shared_ptr<const VAHACommand> request) {
  return [platform = makePlatform(), request = std::move(request)] {
    return platform->perform(*request);
  };
}

Road prepareSnapshot() {
  const auto platform = makePlatform();
  return [platform, gather = platform->gather()] { return gather->gatherNidusObjects().size(); };
}

Road prepareFilter() {
  const auto platform = makePlatform();
  const auto filter = std::make_shared<VAHASearchCriteriaFilter>();
  filter->setHomeName(numberedName("Home", 0, kNameLength));
  filter->setZoneName(numberedName("Zone", 0, kNameLength));
  filter->setRoomName(numberedName("Room", 0, kNameLength));
  filter->setGroupName(numberedName("Group", 0, kNameLength));
  filter->setServiceType("LIGHT");
  filter->setAttribute("BRIGHTNESS");
  return [platform, filter, command = platform->commandWithSnapshot()] {
    return command->objectsWithSearchFilter_inHome(*filter, filter->homeName())->size();
  };
}

Road prepareBrightness(std::string_view actionType) {
  return prepareCommand(std::make_shared<BrightnessRequest>(actionType, nullptr));
}

Road prepareRead() { return prepareBrightness(VAHAActionTypeGETValue); }
Road prepareWrite() { return prepareBrightness(VAHAActionTypeSETValue); }
Road prepareRaise() { return prepareBrightness(VAHAActionTypeINCREASEValue); }
Road prepareScene() { return prepareCommand(std::make_shared<SceneRequest>(kSceneName)); }

Road prepareSync() {
  return [platform = makePlatform(), sync = std::make_shared<BenchmarkSync>()] {
    sync->begin(*platform);
    const std::size_t entities = sync->pullAll();
    sync->end();
    return entities;
  };
}

/// From the document to the database.
Road prepareImport() {
  std::ostringstream document;
  writeHomeDocument(document, {benchmarkHome(kShape)}, true);
  return [text = document.str(),
          store = std::shared_ptr<HomeStore>(std::move(*HomeStore::open(std::nullopt)))] {
    std::istringstream in(text);
    const auto homes = readHomeDocument(in, "document");
    if (!homes || store->replaceHomes(*homes)) return std::size_t{0};
    return homes->front().accessories.size();
  };
}

/// Services, rooms, zones, groups, the home and its scene.
constexpr std::size_t kRecords = kServices + kServices / 10 + kServices / 50 + kServices / 20 + 2;

constexpr std::array kPlans = {
    RoadPlan{"snapshot", prepareSnapshot, kRecords}, RoadPlan{"filter", prepareFilter, 10},
    RoadPlan{"read", prepareRead, kServices},        RoadPlan{"write", prepareWrite, kServices},
    RoadPlan{"raise", prepareRaise, kServices},      RoadPlan{"scene", prepareScene, 1},
    RoadPlan{"sync", prepareSync, kRecords},         RoadPlan{"import", prepareImport, kServices}};

/// Goes a road, and says so when it leads somewhere else.
bool arrives(const RoadPlan& plan, std::size_t found) {
  if (found == plan.expected) return true;
  std::fprintf(stderr, "NidusBenchmarks: %s comes by %zu things, not by %zu\n",
               std::string(plan.name).c_str(), found, plan.expected);
  return false;
}

}  // namespace

bool goRoad(std::string_view name) {
  for (const RoadPlan& plan : kPlans) {
    if (plan.name != name) continue;
    seedRandomSource();
    const Road road = plan.prepare();
    return arrives(plan, road()) && arrives(plan, nidusCountedRoad(road));
  }
  std::fprintf(stderr, "NidusBenchmarks: no road is called %s\n", std::string(name).c_str());
  return false;
}

}  // namespace nidus
