#include "nidus/Completion/Completion.h"

#include <gmock/gmock.h>

namespace nidus {
namespace {

using ::testing::ElementsAre;
using ::testing::IsEmpty;

/// Completes commands of a small program of its own, in a home of its own.
class CompletionTest : public ::testing::Test {
 protected:
  CompletionTest() {
    program_.option("--data", "DIR", data_, "");
    program_.candidates("--data", {{CandidateKind::files}});
    declareSet();
    CommandSyntax& home = program_.command("home", "", "");
    home.command("show", "", "").flag("-b,--brief", flag_, "");
    CommandSyntax& add = home.command("add", "", "");
    add.requiredArgument("KIND", text_, "");
    add.candidates("KIND", {Candidates(std::vector<std::string>{"room", "zone"})});
    program_.command("secret", "", "").hide();
  }

  [[nodiscard]] std::vector<std::string> complete(const std::vector<std::string>& words) const {
    return completionAt(completionPointOf(program_, words), names_, vocabulary_).words;
  }

  std::string data_;

 private:
  void declareSet() {
    CommandSyntax& set = program_.command("set", "", "");
    set.requiredArguments("WORDS", words_, "");
    set.candidates("WORDS", {{CandidateKind::attributes}, {CandidateKind::values}});
    set.option("--home", "NAME", text_, "");
    set.candidates("--home", {{CandidateKind::homes}});
    set.option("--room", "NAME", text_, "");
    set.candidates("--room", {{CandidateKind::rooms}});
    set.option("--type", "TYPE", text_, "");
    set.candidates("--type", {{CandidateKind::serviceTypes}});
    set.option("--entity", "TYPE", text_, "");
    set.candidates("--entity", {{CandidateKind::entityTypes}});
  }

  bool flag_ = false;
  std::string text_;
  std::vector<std::string> words_;
  CommandOutline program_;
  const std::vector<HomeName> names_ = {
      {CandidateKind::homes, "Beach House", "Beach House"},
      {CandidateKind::rooms, "Kitchen", "Beach House"},
      {CandidateKind::rooms, "Café Corner", "Beach House"},
      {CandidateKind::homes, "Lake Cabin", "Lake Cabin"},
      {CandidateKind::rooms, "Kitchen", "Lake Cabin"},
      {CandidateKind::rooms, "Loft", "Lake Cabin"},
      {CandidateKind::scenes, "Kitchen off", "Lake Cabin"},
  };
  const Vocabulary vocabulary_ = {
      {{"LIGHT", "t.light"}, {"LOCK", "t.lock"}},
      {{"POWER", "c.power", "c.power", "bool", nullptr, false, false, {}},
       {"MODE",
        "c.mode",
        "c.mode",
        "string",
        nullptr,
        false,
        false,
        {{NDValue::text("HEAT"), NDValue::integer(1)}}}},
      {}};
};

TEST_F(CompletionTest, OffersCommandsOfEachLevel) {
  EXPECT_THAT(complete({""}), ElementsAre("home", "set"));
  EXPECT_THAT(complete({"home", ""}), ElementsAre("add", "show"));
  EXPECT_THAT(complete({"home", "s"}), ElementsAre("show"));
}

TEST_F(CompletionTest, OffersOptionsOfAllLevels) {
  EXPECT_THAT(complete({"--"}), ElementsAre("--data", "--help", "--version"));
  EXPECT_THAT(complete({"home", "show", "-"}), ElementsAre("--brief", "--data", "--help", "-b"));
  EXPECT_THAT(complete({"set", "power", "--ro"}), ElementsAre("--room"));
}

TEST_F(CompletionTest, OffersWhatEachPlaceTakes) {
  EXPECT_THAT(complete({"set", ""}), ElementsAre("mode", "power"));
  EXPECT_THAT(complete({"set", "power", ""}), ElementsAre("off", "on"));
  EXPECT_THAT(complete({"set", "MODE", ""}), ElementsAre("heat"));
  EXPECT_THAT(complete({"set", "--type", "l"}), ElementsAre("light", "lock"));
  EXPECT_THAT(complete({"set", "--entity", "ro"}), ElementsAre("room"));
  EXPECT_THAT(complete({"home", "add", ""}), ElementsAre("room", "zone"));
  EXPECT_THAT(complete({"home", "add", "room", ""}), IsEmpty());
}

TEST_F(CompletionTest, OffersEachNameOnce) {
  EXPECT_THAT(complete({"set", "power", "--room", ""}),
              ElementsAre("Café Corner", "Kitchen", "Loft"));
}

TEST_F(CompletionTest, KeepsToTheHomeThatIsNamed) {
  EXPECT_THAT(complete({"set", "--home", "Lake Cabin", "--room", ""}),
              ElementsAre("Kitchen", "Loft"));
  EXPECT_THAT(complete({"set", "--home=Lake Cabin", "--home", ""}),
              ElementsAre("Beach House", "Lake Cabin"));
}

TEST_F(CompletionTest, CompletesBehindAnEqualsSign) {
  EXPECT_THAT(complete({"set", "--room=Ki"}), ElementsAre("--room=Kitchen"));
}

TEST_F(CompletionTest, PrefersTheLettersThatWereTyped) {
  EXPECT_THAT(complete({"set", "--room", "K"}), ElementsAre("Kitchen"));
  EXPECT_THAT(complete({"set", "--room", "cafe"}), ElementsAre("Café Corner"));
  EXPECT_THAT(complete({"set", "PO"}), ElementsAre("power"));
  EXPECT_THAT(complete({"set", "--room", "x"}), IsEmpty());
}

TEST_F(CompletionTest, TakesEverythingForArgumentsAfterTwoDashes) {
  EXPECT_THAT(complete({"set", "power", "--", ""}), ElementsAre("off", "on"));
  EXPECT_THAT(complete({"set", "--", "--"}), IsEmpty());
}

TEST_F(CompletionTest, RemembersTheValuesOfOptions) {
  static_cast<void>(complete({"--data", "/tmp/x", "set", ""}));
  EXPECT_EQ(data_, "/tmp/x");
}

TEST_F(CompletionTest, SaysWhereFilesStand) {
  CommandOutline program;
  std::string text;
  program.argument("FILE", text, "");
  program.candidates("FILE", {{CandidateKind::files}});
  const CompletionPoint point = completionPointOf(program, {""});
  EXPECT_FALSE(needsHome(point));
  EXPECT_TRUE(completionAt(point, {}, {}).isFile);
}

TEST(HomeNamesTest, NamesThingsOfAHome) {
  HomeData home;
  home.name = "Beach House";
  home.rooms = {{NDUUID(), "Kitchen"}};
  home.accessories.emplace_back();
  auto& services = home.accessories.front().services;
  services.resize(2);
  services.front().name = "Lamp";
  std::vector<std::string> names;
  for (const HomeName& name : namesIn(std::vector{home})) names.push_back(name.name);
  EXPECT_THAT(names, ElementsAre("Beach House", "Kitchen", "Lamp"));
}

TEST(HomeNamesTest, NamesEntitiesOfASync) {
  VAHAEntity room;
  room.setName("Kitchen");
  room.setEntityType("ROOM");
  room.setHome("Beach House");
  const auto name = nameOf(room);
  ASSERT_TRUE(name);
  EXPECT_EQ(name->kind, CandidateKind::rooms);
  EXPECT_EQ(name->name, "Kitchen");
  EXPECT_EQ(name->home, "Beach House");
  room.setEntityType("TRIGGER");
  EXPECT_FALSE(nameOf(room));
}

}  // namespace
}  // namespace nidus
