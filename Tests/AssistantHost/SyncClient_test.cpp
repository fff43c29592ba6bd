#include "AssistantHost/SyncClient.h"

#include <gtest/gtest.h>

#include "AssistantHost/FakeModule.h"

namespace nidus {
namespace {

/// Serves two entities, "A" and "B", with the anchors "1" and "end".
class FakeSyncHandler final : public AFSyncHandler {
 public:
  void beginSyncWithAnchor_validity_forKey_beginInfo(
      const NDString& anchor, const NDString& validity, const NDString& key,
      std::shared_ptr<AFSyncBeginInfo> beginInfo) override {
    begun = {anchor, validity, key};
    beginInfo->resetWithValidity("end");
    lateInfo = std::move(beginInfo);
  }
  void getChangeAfterAnchor_changeInfo(const NDString& anchor,
                                       AFSyncChangeInfo& changeInfo) override {
    if (!anchor) return answer("A", "1", changeInfo);
    if (anchor == "1") return answer("B", "end", changeInfo);
    changeInfo.setObject(nullptr);
    changeInfo.setPostAnchor(anchor);
  }
  void syncDidEnd() override { ++ended; }

  std::vector<NDString> begun;
  std::shared_ptr<AFSyncBeginInfo> lateInfo;
  int ended = 0;

 private:
  static void answer(const char* name, const char* anchor, AFSyncChangeInfo& changeInfo) {
    auto entity = VAHAEntity::entity();
    entity->setName(name);
    changeInfo.setObject(entity);
    changeInfo.setPostAnchor(anchor);
  }
};

class SyncClientTest : public ::testing::Test {
 protected:
  SyncClientTest() { module_.syncHandler = handler_; }

  FakeModule module_;
  const std::shared_ptr<FakeSyncHandler> handler_ = std::make_shared<FakeSyncHandler>();
};

TEST_F(SyncClientTest, FailsWithoutAHandler) {
  module_.syncHandler = nullptr;
  const auto client = SyncClient::make(module_.module());
  ASSERT_FALSE(client);
  EXPECT_EQ(client.failure().message, "no platform is registered");
}

TEST_F(SyncClientTest, PassesOnWhatItBeginsWith) {
  const auto client = SyncClient::make(module_.module());
  (*client)->begin("key", "anchor", "validity");
  EXPECT_EQ(handler_->begun, (std::vector<NDString>{"anchor", "validity", "key"}));
  (*client)->begin("key");
  EXPECT_EQ(handler_->begun, (std::vector<NDString>{nullptr, nullptr, "key"}));
}

TEST_F(SyncClientTest, CollectsResetsLateOnesToo) {
  const auto client = SyncClient::make(module_.module());
  EXPECT_TRUE((*client)->resets().empty());
  (*client)->begin("key");
  handler_->lateInfo->resetWithValidity(nullptr);
  EXPECT_EQ((*client)->resets(), (std::vector<NDString>{"end", nullptr}));
}

TEST_F(SyncClientTest, PullsUpToTheEndMarker) {
  const auto client = SyncClient::make(module_.module());
  const auto changes = (*client)->allChanges();
  ASSERT_EQ(changes.size(), 3U);
  EXPECT_FALSE(changes[0].after);
  EXPECT_EQ(changes[0].object->name(), "A");
  EXPECT_EQ(changes[1].after, "1");
  EXPECT_EQ(changes[1].postAnchor, "end");
  EXPECT_FALSE(changes[2].object);
  EXPECT_EQ(changes[2].postAnchor, "end");
}

TEST_F(SyncClientTest, AsksAfterAnyAnchor) {
  const auto client = SyncClient::make(module_.module());
  const SyncChange change = (*client)->changeAfter("17");
  EXPECT_EQ(change.after, "17");
  EXPECT_FALSE(change.object);
  EXPECT_EQ(change.postAnchor, "17");
}

TEST_F(SyncClientTest, EndsTheSync) {
  const auto client = SyncClient::make(module_.module());
  (*client)->end();
  EXPECT_EQ(handler_->ended, 1);
}

TEST(EntityValueTest, WritesNullForNoEntity) {
  EXPECT_EQ(entityValue(nullptr), NDDictionaryValue());
  auto entity = VAHAEntity::entity();
  entity->setName("A");
  EXPECT_EQ(entityValue(entity), NDDictionaryValue(entity->dictionary()));
}

}  // namespace
}  // namespace nidus
