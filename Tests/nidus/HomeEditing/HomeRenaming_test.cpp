#include "nidus/HomeEditing/HomeRenaming.h"

#include "nidus/HomeEditing/SampleHomes.h"

namespace nidus {
namespace {

struct RenameCase {
  ObjectWords words;
  const char* sentence;
};

TEST(RenameObjectTest, RenamesEachKind) {
  const RenameCase table[] = {
      {{ObjectKind::home, "Cottage", ""}, "renamed the home Cottage to New"},
      {{ObjectKind::room, "Study", ""}, "renamed the room Study of Beach House to New"},
      {{ObjectKind::zone, "Upstairs", ""}, "renamed the zone Upstairs of Beach House to New"},
      {{ObjectKind::accessory, "Floor lamp", ""},
       "renamed the accessory Floor lamp of Beach House to New"},
      {{ObjectKind::service, "Floor lamp/11", ""},
       "renamed the service Floor lamp/11 of Beach House to New"},
      {{ObjectKind::group, "Corner", ""}, "renamed the group Corner of Beach House to New"},
      {{ObjectKind::scene, "Night", ""}, "renamed the scene Night of Beach House to New"},
      {{ObjectKind::trigger, "Sunset", ""}, "renamed the trigger Sunset of Beach House to New"},
  };
  for (const RenameCase& test : table) {
    auto homes = sampleHomes();
    EXPECT_THAT(renameObject(homes, test.words, "New"), IsDone(test.sentence));
    const auto place = findObject(homes, {test.words.kind, "New", ""});
    ASSERT_TRUE(place) << place.failure().message;
    EXPECT_EQ(nameAt(homes, test.words.kind, *place), "New");
  }
}

TEST(RenameObjectTest, ChangesNothingElse) {
  auto homes = sampleHomes();
  ASSERT_TRUE(renameObject(homes, {ObjectKind::room, "Study", ""}, "Den"));
  ASSERT_TRUE(renameObject(homes, {ObjectKind::room, "Den", ""}, "Study"));
  EXPECT_EQ(textOf(homes), textOf(sampleHomes()));
}

TEST(RenameObjectTest, RefusesWithoutAChange) {
  auto homes = sampleHomes();
  EXPECT_THAT(renameObject(homes, {ObjectKind::room, "Attic", ""}, "Den"),
              IsBadInput("there is no room Attic"));
  EXPECT_THAT(renameObject(homes, {ObjectKind::room, "Study", ""}, ""), IsBadInput("empty"));
  EXPECT_THAT(renameObject(homes, {ObjectKind::room, "Study", ""}, "\xff"), IsBadInput("UTF-8"));
  EXPECT_EQ(textOf(homes), textOf(sampleHomes()));
}

}  // namespace
}  // namespace nidus
