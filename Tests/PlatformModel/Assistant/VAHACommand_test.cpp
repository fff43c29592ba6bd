#include "PlatformModel/Assistant/VAHACommand.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

namespace nidus {
namespace {

using testing::ElementsAre;
using testing::IsEmpty;

std::vector<std::string> keys(const NDDictionary& dictionary) {
  std::vector<std::string> found;
  for (const auto& entry : dictionary) found.push_back(entry.first);
  return found;
}

NDDictionaryValue text(const char* characters) { return NDDictionaryValue(NDString(characters)); }

std::shared_ptr<VAHAEntity> fullEntity() {
  auto entity = VAHAEntity::entity();
  entity->setZone("Downstairs");
  entity->setHome("Cabin");
  entity->setRoom("Hall");
  entity->setServiceType("LIGHT");
  entity->setEntityType("SERVICE");
  entity->setIdentifier(NDURL::fromText("a:b"));
  entity->setName("Lamp");
  return entity;
}

TEST(VAHAEntityTest, EmptyEntityHasEmptyForm) {
  EXPECT_TRUE(VAHAEntity::entity()->dictionary().empty());
}

TEST(VAHAEntityTest, FormHasFixedOrder) {
  const NDDictionary form = fullEntity()->dictionary();
  EXPECT_THAT(keys(form), ElementsAre("name", "identifier", "entityType", "serviceType", "room",
                                      "home", "zone"));
  EXPECT_EQ(*form.find("name"), text("Lamp"));
  EXPECT_EQ(*form.find("identifier"), text("a:b"));
  EXPECT_EQ(*form.find("entityType"), text("SERVICE"));
  EXPECT_EQ(*form.find("serviceType"), text("LIGHT"));
  EXPECT_EQ(*form.find("room"), text("Hall"));
  EXPECT_EQ(*form.find("home"), text("Cabin"));
  EXPECT_EQ(*form.find("zone"), text("Downstairs"));
}

TEST(VAHAActionResultTest, EmptyResultHasEmptyForm) {
  EXPECT_TRUE(VAHAActionResult().dictionary().empty());
}

TEST(VAHAActionResultTest, FormHasFixedOrder) {
  const auto value = VAHABooleanValue::booleanValue();
  VAHAActionResult result;
  result.setEntity(fullEntity());
  result.setResultValue(value);
  result.setResultAttribute("POWER");
  result.setOutcome("SUCCESS");
  const NDDictionary form = result.dictionary();
  EXPECT_THAT(keys(form), ElementsAre("outcome", "resultAttribute", "resultValue", "entity"));
  EXPECT_EQ(*form.find("outcome"), text("SUCCESS"));
  EXPECT_EQ(*form.find("resultAttribute"), text("POWER"));
  EXPECT_EQ(*form.find("resultValue"), NDDictionaryValue(value->dictionary()));
  EXPECT_EQ(*form.find("entity"), NDDictionaryValue(fullEntity()->dictionary()));
}

TEST(VAHACommandCompletedTest, EmptyReplyHasEmptyList) {
  const NDDictionary form = VAHACommandCompleted::commandCompleted()->dictionary();
  EXPECT_THAT(keys(form), ElementsAre("actionResults"));
  EXPECT_EQ(*form.find("actionResults"), NDDictionaryValue(NDDictionaryList()));
}

TEST(VAHACommandCompletedTest, FormHoldsResultsInOrder) {
  const auto first = std::make_shared<VAHAActionResult>();
  first->setOutcome("SUCCESS");
  const auto second = std::make_shared<VAHAActionResult>();
  second->setOutcome("FAILURE");
  const auto reply = VAHACommandCompleted::commandCompleted();
  reply->setActionResults({first, second});
  reply->setCommandOutcome("COMMAND_SUCCESS");
  const NDDictionary form = reply->dictionary();
  EXPECT_THAT(keys(form), ElementsAre("commandOutcome", "actionResults"));
  EXPECT_EQ(*form.find("commandOutcome"), text("COMMAND_SUCCESS"));
  const NDDictionaryList results = {NDDictionaryValue(first->dictionary()),
                                    NDDictionaryValue(second->dictionary())};
  EXPECT_EQ(*form.find("actionResults"), NDDictionaryValue(results));
}

TEST(VAHACommandTest, StartsWithoutFilterAndActions) {
  const VAHACommand command;
  EXPECT_EQ(command.filter(), nullptr);
  EXPECT_THAT(command.actions(), IsEmpty());
}

TEST(VAHACommandTest, KeepsFilterAndActions) {
  const auto filter = std::make_shared<VAHASearchCriteriaFilter>();
  const auto action = std::make_shared<VAHAAction>();
  action->setActionType("SET");
  action->setAttribute("POWER");
  action->setValue(VAHABooleanValue::booleanValue());
  VAHACommand command;
  command.setFilter(filter);
  command.setActions({action});
  EXPECT_EQ(command.filter(), filter);
  EXPECT_THAT(command.actions(), ElementsAre(action));
  EXPECT_EQ(action->actionType(), "SET");
  EXPECT_EQ(action->attribute(), "POWER");
}

}  // namespace
}  // namespace nidus
