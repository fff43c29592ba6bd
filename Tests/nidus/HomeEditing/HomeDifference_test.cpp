#include "nidus/HomeEditing/HomeDifference.h"

#include <functional>

#include "nidus/HomeEditing/HomeMoving.h"
#include "nidus/HomeEditing/HomeRemoval.h"
#include "nidus/HomeEditing/SampleHomes.h"

namespace nidus {
namespace {

struct DifferenceCase {
  const char* text;
  std::function<void(std::vector<HomeData>&)> change;
};

TEST(DifferenceTextTest, CountsWhatWasDone) {
  const DifferenceCase table[] = {
      {"", [](std::vector<HomeData>&) {}},
      {"1 home added", [](auto& homes) { homes.emplace_back(); }},
      {"1 home renamed", [](auto& homes) { homes[1].name = "Hut"; }},
      {"1 home changed", [](auto& homes) { homes[1].primary = true; }},
      {"1 home removed, 1 room removed", [](auto& homes) { homes.pop_back(); }},
      {"1 room renamed", [](auto& homes) { homes[0].rooms[0].name = "Galley"; }},
      {"1 zone changed", [](auto& homes) { homes[0].zones[0].rooms.clear(); }},
      {"1 accessory changed", [](auto& homes) { homes[0].accessories[0].room.reset(); }},
      {"1 accessory renamed, 1 accessory changed",
       [](auto& homes) {
         homes[0].accessories[0].name = "Globe";
         homes[0].accessories[0].reachable = false;
       }},
      {"1 service added",
       [](auto& homes) {
         homes[0].accessories[0].services.push_back({12, "", "t", "", {}});
       }},
      {"1 service renamed",
       [](auto& homes) { homes[0].accessories[1].services[1].name = "Battery"; }},
      {"1 service changed",
       [](auto& homes) {
         homes[0].accessories[0].services[0].characteristics[0].value = NDValue::boolean(false);
       }},
      {"1 service changed",
       [](auto& homes) {
         homes[0].accessories[0].services[0].characteristics[0].metadata->units = "percentage";
       }},
      {"1 scene changed",
       [](auto& homes) { homes[0].actionSets[0].actions[0].value = NDValue::integer(1); }},
      {"1 accessory removed, 2 services removed, 1 scene changed",
       [](auto& homes) {
         ASSERT_TRUE(removeObject(homes, {ObjectKind::accessory, "Floor lamp", ""}));
       }},
      {"1 group changed", [](auto& homes) { homes[0].serviceGroups[0].services.clear(); }},
      {"1 scene changed", [](auto& homes) { homes[0].actionSets[0].actions.clear(); }},
      {"1 trigger removed", [](auto& homes) { homes[0].triggers.clear(); }},
      {"", [](auto& homes) { std::swap(homes[0].rooms[0], homes[0].rooms[1]); }},
  };
  for (const DifferenceCase& test : table) {
    SCOPED_TRACE(test.text);
    auto homes = sampleHomes();
    test.change(homes);
    EXPECT_EQ(differenceText(sampleHomes(), homes), test.text);
  }
}

TEST(DifferenceTextTest, TellsObjectsOfOneUUIDApartByHome) {
  auto homes = sampleHomes();
  homes[1].rooms[0].uuid = homes[0].rooms[0].uuid;
  EXPECT_EQ(differenceText(sampleHomes(), homes), "1 room added, 1 room removed");
}

TEST(IsSameHomesTest, TellsOrderAndValuesApart) {
  EXPECT_TRUE(isSame(sampleHomes(), sampleHomes()));
  auto homes = sampleHomes();
  std::swap(homes[0].rooms[0], homes[0].rooms[1]);
  EXPECT_FALSE(isSame(sampleHomes(), homes));
  homes = sampleHomes();
  homes[0].accessories[0].services[0].characteristics[1].deviceValue = nullptr;
  EXPECT_FALSE(isSame(sampleHomes(), homes));
}

}  // namespace
}  // namespace nidus
