#include "Assistant/ServiceLookUp.h"

#include <string>
#include <utility>
#include <vector>

#include "Assistant/ObjectLookUp.h"
#include "Assistant/ObjectURL.h"
#include "PlatformModel/Home/NDLookUp.h"
#include "Support/PlatformTest.h"
#include "Support/TestUUID.h"

namespace nidus {
namespace {

using Index = ListIndex<NDService, &NDService::instanceID>;

/// The services of an accessory with `count` of them, whose numbers come twice each.
NDArray<NDService> twins(int count) {
  HomeBuilder builder("Cabin");
  builder.accessory("Box");
  for (int i = 0; i < count; ++i) builder.service("Lamp", "light", {}).serviceID(i / 2);
  return builder.build()->accessory("Box")->services();
}

TEST(ListIndexTest, FindsTheFirstAsAWalkDoes) {
  for (const int count : {0, 1, 32, 33, 60}) {
    SCOPED_TRACE(count);
    const NDArray<NDService> list = twins(count);
    Index index;
    for (int round = 0; round < 3; ++round) {
      for (int number = 35; number >= -1; --number) {
        EXPECT_EQ(index.find(list, number), findInArrayByInstanceID(list, number));
      }
    }
  }
}

TEST(ListIndexTest, NoNumberFindsNothing) {
  const NDArray<NDService> list = twins(60);
  Index index;
  for (int i = 0; i < 9; ++i) EXPECT_FALSE(index.find(list, std::nullopt));
  EXPECT_EQ(index.find(list, 7), list[14]);
}

TEST(ListIndexTest, AnotherListTakesThePlace) {
  const NDArray<NDService> former = twins(60);
  const NDArray<NDService> list = twins(40);
  Index index;
  for (int number = 0; number < 30; ++number) EXPECT_TRUE(index.find(former, number));
  for (int number = 0; number < 30; ++number) {
    EXPECT_EQ(index.find(list, number), findInArrayByInstanceID(list, number));
  }
  const NDArray<NDService> few = twins(20);
  EXPECT_EQ(index.find(few, 7), few[14]);
  EXPECT_EQ(index.find(list, 7), list[14]);
  EXPECT_FALSE(index.find({}, 7));
  EXPECT_EQ(index.find(former, 7), former[14]);
}

/// A home that counts how often it is asked for its UUID.
class CountedHome final : public TestHome {
 public:
  using TestHome::TestHome;
  [[nodiscard]] const NDUUID& uuid() const override {
    ++asked_;
    return TestHome::uuid();
  }
  /// How often since the last call.
  int takeAsked() const { return std::exchange(asked_, 0); }

 private:
  mutable int asked_ = 0;
};

/// Looks for many services in homes that are too great for walks.
class ServiceLookUpTest : public PlatformTest {
 protected:
  using Records = std::vector<HomeObjectRecord>;

  /// A home of forty lamps; two accessories have the same UUID. Homes of one name have the same
  /// UUIDs.
  static std::shared_ptr<TestHome> greatHome(const NDString& name) {
    HomeBuilder builder(name);
    for (std::uint32_t i = 0; i < 40; ++i) {
      builder.uuid(testUUID(i == 30 ? 20 : i, 7)).light("Lamp " + std::to_string(i));
    }
    return builder.build();
  }
  static HomeObjectRecord recordOf(const NDService& service) {
    HomeObjectRecord record;
    record.objectIdentifier = url(service);
    return record;
  }
  static Records recordsOf(const TestHome& home) {
    Records records;
    for (const auto& accessory : home.accessories()) {
      records.push_back(recordOf(*accessory->services()[0]));
    }
    return records;
  }
  /// Finds each record with one look-up as it is found alone; gives how many were found.
  [[nodiscard]] int foundAsAlone(const Records& records) {
    int found = 0;
    for (const HomeObjectRecord& record : records) {
      const auto service = lookUp_.service(record);
      EXPECT_EQ(service, serviceFromObject(record, gather_));
      if (service) ++found;
    }
    return found;
  }
  /// How often the first of `count` homes is asked for its UUID by each of six look-ups of what is
  /// in the last one.
  std::vector<int> askedOfFirstAmong(std::uint32_t count) {
    const auto first = std::make_shared<CountedHome>(testUUID(0, 8), "Cabin", false);
    NDArray<NDHome> homes{first};
    for (std::uint32_t i = 1; i < count; ++i) {
      const auto home = std::make_shared<TestHome>(testUUID(i, 8), "Cottage", false);
      append<NDHome>(homes, HomeBuilder(home).light("Lamp").build());
    }
    const auto last = homes[count - 1]->accessories()[0]->services()[0];
    setHomes(std::move(homes));
    std::vector<int> asked;
    for (int i = 0; i < 6; ++i) {
      first->takeAsked();
      EXPECT_EQ(lookUp_.service(recordOf(*last)), last);
      asked.push_back(first->takeAsked());
    }
    return asked;
  }
  static void setHomes(NDArray<NDHome> homes) {
    platform().lastManager()->setHomes(std::move(homes));
  }

  const std::shared_ptr<NDAssistantGather> gather_ = NDAssistantGather::init();
  ServiceLookUp lookUp_{gather_};
};

TEST_F(ServiceLookUpTest, FirstOfTwoAccessoriesIsFound) {
  const auto home = greatHome("Cabin");
  setHomes({home});
  EXPECT_EQ(foundAsAlone(recordsOf(*home)), 40);
  EXPECT_EQ(lookUp_.service(recordOf(*home->service("Lamp 30"))), home->service("Lamp 20"));
  EXPECT_FALSE(lookUp_.service(recordOf(*greatHome("Cottage")->service("Lamp 1"))));
}

TEST_F(ServiceLookUpTest, AccessoriesOfTwoHomesAreKeptApart) {
  const auto cabin = greatHome("Cabin");
  const auto cottage = greatHome("Cottage");
  setHomes({cabin, cottage});
  for (int i = 0; i < 40; ++i) {
    const std::string name = "Lamp " + std::to_string(i == 30 ? 20 : i);
    EXPECT_EQ(lookUp_.service(recordOf(*cabin->service(name))), cabin->service(name));
    EXPECT_EQ(lookUp_.service(recordOf(*cottage->service(name))), cottage->service(name));
  }
}

TEST_F(ServiceLookUpTest, FirstOfTwoHomesIsFound) {
  NDArray<NDHome> homes;
  for (int i = 0; i < 36; ++i) append<NDHome>(homes, greatHome("Cabin " + std::to_string(i / 2)));
  setHomes(homes);
  for (int i = 0; i < 36; ++i) {
    const auto record =
        recordOf(*homes[static_cast<std::size_t>(i)]->accessories()[3]->services()[0]);
    const auto& first = homes[static_cast<std::size_t>(i) / 2 * 2];
    EXPECT_EQ(lookUp_.service(record), first->accessories()[3]->services()[0]);
  }
}

TEST_F(ServiceLookUpTest, FewHomesAreWalkedThroughAlways) {
  EXPECT_EQ(askedOfFirstAmong(32), (std::vector<int>{1, 1, 1, 1, 1, 1}));
}

TEST_F(ServiceLookUpTest, ManyHomesGetATable) {
  // The fifth look-up makes the table.
  EXPECT_EQ(askedOfFirstAmong(33), (std::vector<int>{1, 1, 1, 1, 1, 0}));
}

TEST_F(ServiceLookUpTest, HomesOfTheMomentAreSearched) {
  const auto former = greatHome("Cabin");
  const Records records = recordsOf(*former);
  setHomes({former});
  EXPECT_EQ(foundAsAlone(records), 40);
  const auto home = greatHome("Cabin");
  setHomes({home});
  EXPECT_EQ(lookUp_.service(records[5]), home->service("Lamp 5"));
  EXPECT_EQ(foundAsAlone(records), 40);
  setHomes({});
  EXPECT_EQ(foundAsAlone(records), 0);
}

TEST_F(ServiceLookUpTest, OtherRecordsFindNothing) {
  const auto home = greatHome("Cabin");
  setHomes({home});
  HomeObjectRecord record;
  EXPECT_FALSE(lookUp_.service(record));
  record.objectIdentifier = url(*home);
  EXPECT_FALSE(lookUp_.service(record));
  record.objectIdentifier = url(*home->accessories()[0]->room());
  EXPECT_FALSE(lookUp_.service(record));
}

}  // namespace
}  // namespace nidus
