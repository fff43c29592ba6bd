#include "Assistant/ObjectLookUp.h"

#include <stdexcept>
#include <string>
#include <vector>

#include "Assistant/ObjectURL.h"
#include "PlatformModel/Assistant/VAHAConstants.h"
#include "Support/PlatformTest.h"

namespace nidus {
namespace {

struct Parts {
  NDString kind;
  NDString id;
  NDString home;
  NDString accessory;

  /// Splits `text` on top of what the parts hold.
  Parts& split(const NDString& text) {
    splitIdentifier(NDURL::fromText(text), kind, id, home, accessory);
    return *this;
  }
  /// The parts on one line; "-" is null.
  [[nodiscard]] std::string text() const {
    std::string joined;
    for (const NDString& part : {kind, id, home, accessory}) {
      joined += (joined.empty() ? "" : " ") + (part ? part.str() : "-");
    }
    return joined;
  }
};

std::string split(const NDString& text) { return Parts().split(text).text(); }

TEST(SplitIdentifierTest, GivesThePartsThatAreThere) {
  struct Case {
    const char* label;
    const char* url;
    const char* parts;
  };
  const std::vector<Case> cases = {
      {"home", "x-corvane-nidus://local/home?id=U", "home U - -"},
      {"service", "x-corvane-nidus://local/service?id=12&accessory=A&home=H", "service 12 H A"},
      {"room", "x-corvane-nidus://local/room?id=U&home=H", "room U H -"},
      {"foreign scheme", "other://local/service?id=12&accessory=A&home=H", "service 12 H A"},
      {"no scheme", "/service?id=12", "service 12 - -"},
      {"action set", "x-corvane-nidus://local/x?id=X&ActionSet=Y", "x X - Y"},
      {"case of action set", "x-corvane-nidus://local/x?id=X&actionSet=Y", "x X - -"},
      {"accessory first", "x-corvane-nidus://local/x?ActionSet=Y&accessory=A", "x - - A"},
      {"first of two", "x-corvane-nidus://local/x?id=1&id=2", "x 1 - -"},
      {"other separators", "x-corvane-nidus://local/x?id:1?home:H", "x 1 H -"},
      {"empty value", "x-corvane-nidus://local/x?id=&home=H", "x  H -"},
      {"key within words", "x-corvane-nidus://local/x?idid=1&xid=2&idx=3&id=4", "x 4 - -"},
      {"key within the first word", "x-corvane-nidus://local/x?xid=2&id=3", "x 3 - -"},
      {"key before a hash", "x-corvane-nidus://local/x?id=1#home=2", "x 1 - -"},
      {"key as a value", "x-corvane-nidus://local/x?id=home&home=H", "x home home -"},
      {"unknown keys", "x-corvane-nidus://local/x?a=b", "x - - -"},
      {"empty query", "x-corvane-nidus://local/x?", "x - - -"},
      {"no query", "x-corvane-nidus://local/x", "x - - -"}};
  for (const Case& each : cases) {
    SCOPED_TRACE(each.label);
    EXPECT_EQ(split(each.url), each.parts);
  }
}

TEST(SplitIdentifierTest, LeavesOutputsWithoutKey) {
  Parts parts{"k", "i", "h", "a"};
  EXPECT_EQ(parts.split("x-corvane-nidus://local/home?b=c").text(), "home i h a");
}

TEST(SplitIdentifierTest, ForeignSchemeClearsOutputs) {
  Parts parts{"k", "i", "h", "a"};
  EXPECT_EQ(parts.split("other://local/home?id=1").text(), "home 1 - -");
}

TEST(SplitIdentifierTest, ShortPathIsARangeFault) {
  EXPECT_THROW((void)split("x-corvane-nidus://local/?id=1"), std::out_of_range);
  EXPECT_THROW((void)split("x-corvane-nidus://local?id=1"), std::out_of_range);
}

TEST(SplitIdentifierTest, KeyAtTheEndIsARangeFault) {
  for (const char* key : {"id", "home", "accessory", "ActionSet"}) {
    SCOPED_TRACE(key);
    const std::string url = std::string("x-corvane-nidus://local/x?a=") + key;
    EXPECT_THROW((void)split(url), std::out_of_range);
  }
}

/// Looks for objects of a home that the gatherer has heard of.
class ObjectLookUpTest : public PlatformTest {
 protected:
  ObjectLookUpTest()
      : home_(useHome(HomeBuilder("Cabin")
                          .room("Kitchen")
                          .accessory("Box")
                          .service("Lamp", "light", {power(true)})
                          .service("Fan", "fan", {power(true)})
                          .light("Lantern")
                          .scene("Good night"))),
        gather_(NDAssistantGather::init()) {
    platform().runUntilIdle();
  }

  static HomeObjectRecord recordWith(NDURL identifier) {
    HomeObjectRecord record;
    record.objectIdentifier = std::move(identifier);
    return record;
  }
  /// A record with a service identifier of the parts.
  static HomeObjectRecord serviceRecord(const std::string& id, const std::string& accessory,
                                        const std::string& home) {
    return recordWith(NDURL::fromText("x-corvane-nidus://local/service?id=" + id +
                                      "&accessory=" + accessory + "&home=" + home));
  }
  [[nodiscard]] std::string homeID() const { return home_->uuid().UUIDString().str(); }
  [[nodiscard]] std::string boxID() const {
    return home_->accessory("Box")->uuid().UUIDString().str();
  }
  [[nodiscard]] std::shared_ptr<NDService> service(const HomeObjectRecord& record) const {
    return serviceFromObject(record, gather_);
  }
  [[nodiscard]] std::shared_ptr<NDActionSet> actionSet(const HomeObjectRecord& record) const {
    return actionSetFromObject(record, gather_);
  }

  const std::shared_ptr<TestHome> home_;
  const std::shared_ptr<NDAssistantGather> gather_;
};

TEST_F(ObjectLookUpTest, ServicesAreFoundAgain) {
  for (const char* name : {"Lamp", "Fan", "Lantern"}) {
    EXPECT_EQ(service(recordWith(url(*home_->service(name)))), home_->service(name));
  }
}

TEST_F(ObjectLookUpTest, ActionSetIsFoundAgain) {
  const auto scene = home_->scene("Good night");
  EXPECT_EQ(actionSet(recordWith(url(*scene))), scene);
}

TEST_F(ObjectLookUpTest, RecordsOfOtherKindsAreNoServices) {
  EXPECT_FALSE(service(recordWith(url(*home_))));
  EXPECT_FALSE(service(recordWith(url(*home_->room("Kitchen")))));
  EXPECT_FALSE(service(recordWith(url(*home_->scene("Good night")))));
}

TEST_F(ObjectLookUpTest, RecordsOfOtherKindsAreNoActionSets) {
  EXPECT_FALSE(actionSet(recordWith(url(*home_))));
  EXPECT_FALSE(actionSet(recordWith(url(*home_->room("Kitchen")))));
  EXPECT_FALSE(actionSet(recordWith(url(*home_->service("Lamp")))));
}

TEST_F(ObjectLookUpTest, KindOfTheIdentifierDoesNotMatter) {
  const std::string id = home_->scene("Good night")->uuid().UUIDString().str();
  const auto record =
      recordWith(NDURL::fromText("x-corvane-nidus://local/room?id=" + id + "&home=" + homeID()));
  EXPECT_EQ(actionSet(record), home_->scene("Good night"));
}

TEST_F(ObjectLookUpTest, UnknownPartsFindNothing) {
  const std::string unknown = "00000000-0000-0000-0000-000000000001";
  EXPECT_EQ(service(serviceRecord("1", boxID(), homeID())), home_->service("Lamp"));
  EXPECT_FALSE(service(serviceRecord("9", boxID(), homeID())));
  EXPECT_FALSE(service(serviceRecord("1", unknown, homeID())));
  EXPECT_FALSE(service(serviceRecord("1", boxID(), unknown)));
}

TEST_F(ObjectLookUpTest, MalformedPartsFindNothing) {
  for (const char* id : {"one", "1x", "", "99999999999999999999"}) {
    SCOPED_TRACE(id);
    EXPECT_FALSE(service(serviceRecord(id, boxID(), homeID())));
  }
  EXPECT_FALSE(service(serviceRecord("1", "box", homeID())));
  EXPECT_FALSE(service(serviceRecord("1", boxID(), "home")));
}

TEST_F(ObjectLookUpTest, MissingIdentifierFindsNothing) {
  EXPECT_FALSE(service({}));
  EXPECT_FALSE(actionSet({}));
}

TEST_F(ObjectLookUpTest, MissingGathererFindsNothing) {
  EXPECT_FALSE(serviceFromObject(recordWith(url(*home_->service("Lamp"))), nullptr));
  EXPECT_FALSE(actionSetFromObject(recordWith(url(*home_->scene("Good night"))), nullptr));
}

TEST_F(ObjectLookUpTest, RemovedHomeIsNotFound) {
  platform().lastManager()->setHomes({});
  EXPECT_FALSE(service(recordWith(url(*home_->service("Lamp")))));
  EXPECT_FALSE(actionSet(recordWith(url(*home_->scene("Good night")))));
  EXPECT_TRUE(log().empty());
}

}  // namespace
}  // namespace nidus
