#include "Roads.h"

#include <array>
#include <cstdio>
#include <cstring>
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

constexpr std::size_t kNameLength = 24;
/// Homes of a multiple of so many services have no room, zone or group that is not full.
constexpr std::size_t kFullHomes = 100;

/// Gives the number of things that it came by.
using Road = std::function<std::size_t()>;

/// How a road is prepared, and how many things it has to come by in a home of so many services.
struct RoadPlan {
  std::string_view name;
  Road (*prepare)(const HomeShape& shape);
  std::size_t (*expected)(std::size_t services);
};

std::shared_ptr<BenchmarkPlatform> makePlatform(const HomeShape& shape) {
  return std::make_shared<BenchmarkPlatform>(BenchmarkPlatform::Kind::embedded, shape);
}

Road prepareCommand(const HomeShape& shape, std::shared_ptr<const VAHACommand> request) {
  return [platform = makePlatform(shape), request = std::move(request)] {
    return platform->perform(*request);
  };
}

Road prepareSnapshot(const HomeShape& shape) {
  const auto platform = makePlatform(shape);
  return [platform, gather = platform->gather()] { return gather->gatherNidusObjects().size(); };
}

Road prepareSearch(const HomeShape& shape, std::shared_ptr<const VAHASearchCriteriaFilter> filter) {
  const auto platform = makePlatform(shape);
  return [platform, filter = std::move(filter), command = platform->commandWithSnapshot()] {
    return command->objectsWithSearchFilter_inHome(*filter, filter->homeName())->size();
  };
}

Road prepareFilter(const HomeShape& shape) {
  const auto filter = std::make_shared<VAHASearchCriteriaFilter>();
  filter->setHomeName(numberedName("Home", 0, kNameLength));
  filter->setZoneName(numberedName("Zone", 0, kNameLength));
  filter->setRoomName(numberedName("Room", 0, kNameLength));
  filter->setGroupName(numberedName("Group", 0, kNameLength));
  filter->setServiceType("LIGHT");
  filter->setAttribute("BRIGHTNESS");
  return prepareSearch(shape, filter);
}

/// Searches by one field alone.
Road prepareSearchBy(void (VAHASearchCriteriaFilter::*set)(NDString), const NDString& name,
                     const HomeShape& shape) {
  const auto filter = std::make_shared<VAHASearchCriteriaFilter>();
  (filter.get()->*set)(name);
  return prepareSearch(shape, filter);
}

/// The name of the last thing of which there is one for so many services.
NDString lastName(const char* word, std::size_t servicesEach, const HomeShape& shape) {
  return numberedName(word, shape.services / servicesEach - 1, shape.nameLength);
}

Road prepareFilterByRoom(const HomeShape& shape) {
  return prepareSearchBy(&VAHASearchCriteriaFilter::setRoomName, lastName("Room", 10, shape),
                         shape);
}
Road prepareFilterByZone(const HomeShape& shape) {
  return prepareSearchBy(&VAHASearchCriteriaFilter::setZoneName, lastName("Zone", 50, shape),
                         shape);
}
Road prepareFilterByGroup(const HomeShape& shape) {
  return prepareSearchBy(&VAHASearchCriteriaFilter::setGroupName, lastName("Group", 20, shape),
                         shape);
}
Road prepareFilterByName(const HomeShape& shape) {
  return prepareSearchBy(&VAHASearchCriteriaFilter::setServiceName,
                         lastName(kServiceWord, 1, shape), shape);
}
/// Looks for a name with an accent by the name without.
Road prepareFilterByAccent(const HomeShape& shape) {
  HomeShape plain = shape;
  plain.nameLength -= std::strlen(kAccentedServiceWord) - std::strlen(kServiceWord);
  HomeShape accented = shape;
  accented.hasAccents = true;
  return prepareSearchBy(&VAHASearchCriteriaFilter::setServiceName,
                         lastName(kServiceWord, 1, plain), accented);
}

Road prepareBrightness(const HomeShape& shape, std::string_view actionType) {
  return prepareCommand(shape, std::make_shared<BrightnessRequest>(actionType, nullptr));
}

Road prepareRead(const HomeShape& shape) {
  return prepareBrightness(shape, VAHAActionTypeGETValue);
}
Road prepareWrite(const HomeShape& shape) {
  return prepareBrightness(shape, VAHAActionTypeSETValue);
}
Road prepareRaise(const HomeShape& shape) {
  return prepareBrightness(shape, VAHAActionTypeINCREASEValue);
}
Road prepareScene(const HomeShape& shape) {
  return prepareCommand(shape, std::make_shared<SceneRequest>(kSceneName));
}

Road prepareSync(const HomeShape& shape) {
  return [platform = makePlatform(shape), sync = std::make_shared<BenchmarkSync>()] {
    sync->begin(*platform);
    const std::size_t entities = sync->pullAll();
    sync->end();
    return entities;
  };
}

/// From the document to the database.
Road prepareImport(const HomeShape& shape) {
  std::ostringstream document;
  writeHomeDocument(document, {benchmarkHome(shape)}, true);
  return [text = document.str(),
          store = std::shared_ptr<HomeStore>(std::move(*HomeStore::open(std::nullopt)))] {
    std::istringstream in(text);
    const auto homes = readHomeDocument(in, "document");
    if (!homes || store->replaceHomes(*homes)) return std::size_t{0};
    return homes->front().accessories.size();
  };
}

/// Services, rooms, zones, groups, the home and its scene.
constexpr std::size_t allRecords(std::size_t services) {
  return services + services / 10 + services / 50 + services / 20 + 2;
}
constexpr std::size_t allServices(std::size_t services) { return services; }
template <std::size_t number>
constexpr std::size_t always(std::size_t /*services*/) {
  return number;
}

constexpr std::array kPlans = {RoadPlan{"snapshot", prepareSnapshot, allRecords},
                               RoadPlan{"filter", prepareFilter, always<10>},
                               RoadPlan{"filter-by-room", prepareFilterByRoom, always<10>},
                               RoadPlan{"filter-by-zone", prepareFilterByZone, always<50>},
                               RoadPlan{"filter-by-group", prepareFilterByGroup, always<10>},
                               RoadPlan{"filter-by-name", prepareFilterByName, always<1>},
                               RoadPlan{"filter-by-accent", prepareFilterByAccent, always<1>},
                               RoadPlan{"read", prepareRead, allServices},
                               RoadPlan{"write", prepareWrite, allServices},
                               RoadPlan{"raise", prepareRaise, allServices},
                               RoadPlan{"scene", prepareScene, always<1>},
                               RoadPlan{"sync", prepareSync, allRecords},
                               RoadPlan{"import", prepareImport, allServices}};

/// Says so when a road leads somewhere else.
bool arrives(const RoadPlan& plan, std::size_t services, std::size_t found) {
  const std::size_t expected = plan.expected(services);
  if (found == expected) return true;
  std::fprintf(stderr, "NidusBenchmarks: %s comes by %zu things, not by %zu\n",
               std::string(plan.name).c_str(), found, expected);
  return false;
}

bool go(const RoadPlan& plan, std::size_t services) {
  seedRandomSource();
  const Road road =
      plan.prepare({.services = services, .nameLength = kNameLength, .hasScene = true});
  return arrives(plan, services, road()) && arrives(plan, services, nidusCountedRoad(road));
}

}  // namespace

bool goRoad(std::string_view name, std::size_t services) {
  if (services == 0 || services % kFullHomes != 0) {
    std::fprintf(stderr, "NidusBenchmarks: the services of a road are a multiple of %zu\n",
                 kFullHomes);
    return false;
  }
  for (const RoadPlan& plan : kPlans) {
    if (plan.name == name) return go(plan, services);
  }
  std::fprintf(stderr, "NidusBenchmarks: no road is called %s\n", std::string(name).c_str());
  return false;
}

}  // namespace nidus
