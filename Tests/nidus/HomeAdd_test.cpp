#include "nidus/HomeEditing/SampleHomes.h"
#include "nidus/ProgramTest.h"
#include "nidus/TerminalProcess.h"

namespace nidus {
namespace {

using ::testing::AllOf;
using ::testing::HasSubstr;
using ::testing::IsEmpty;
using ::testing::StartsWith;

/// `nidus home add` on a data folder that is new.
class HomeAddTest : public ProgramTest {
 protected:
  void add(std::vector<std::string> words, const std::string& description) const {
    words.insert(words.begin(), {"home", "add"});
    const ProgramEnd end = run(words);
    EXPECT_EQ(end.exitStatus, 0) << end.errors;
    EXPECT_THAT(end.output, StartsWith("added " + description + " ("));
  }
};

TEST_F(HomeAddTest, BuildsAHomeFromNothing) {
  add({"home", "Beach House", "--primary"}, "the home Beach House");
  add({"room", "Study"}, "the room Study of Beach House");
  add({"room", "Hall"}, "the room Hall of Beach House");
  add({"zone", "All", "--room", "Study", "--room", "Hall"}, "the zone All of Beach House");
  add({"accessory", "Floor lamp", "--room", "Study"}, "the accessory Floor lamp of Beach House");
  add({"service", "Lamp", "--accessory", "Floor lamp", "--type", "light", "--attribute", "power",
       "--attribute", "brightness"},
      "the service Floor lamp/Lamp of Beach House");
  add({"group", "Corner", "--service", "Lamp"}, "the group Corner of Beach House");
  add({"scene", "Dusk", "--set", "Lamp brightness 20%", "--set", "Lamp power on"},
      "the scene Dusk of Beach House");
  add({"trigger", "Noon"}, "the trigger Noon of Beach House");
  EXPECT_EQ(run({"home", "show"}).output,
            "Beach House (primary)\n"
            "├─ Study\n"
            "│  └─ Floor lamp\n"
            "│     └─ Lamp [LIGHT] POWER off, BRIGHTNESS 0 %\n"
            "├─ Hall\n"
            "├─ zones\n"
            "│  └─ All: Study, Hall\n"
            "├─ groups\n"
            "│  └─ Corner: Lamp\n"
            "├─ scenes: Dusk\n"
            "└─ triggers: Noon\n");
  EXPECT_EQ(run({"run", "Dusk"}).exitStatus, 0);
  EXPECT_THAT(run({"home", "show"}).output, HasSubstr("POWER on, BRIGHTNESS 20 %"));
}

TEST_F(HomeAddTest, WritesADocumentThatCanBeImported) {
  add({"home", "Beach House"}, "the home Beach House");
  add({"accessory", "Box"}, "the accessory Box of Beach House");
  add({"service", "All", "--accessory", "Box", "--type", "outlet", "--as", "light", "--attribute",
       "temperature", "--attribute", "locked", "--attribute", "hue"},
      "the service Box/All of Beach House");
  const std::string before = exported();
  import(before);
  EXPECT_EQ(exported(), before);
}

TEST_F(HomeAddTest, TakesAnOptionsValueAlone) {
  add({"home", "Beach House"}, "the home Beach House");
  add({"room", "Study"}, "the room Study of Beach House");
  add({"zone", "--room", "Study", "All"}, "the zone All of Beach House");
}

TEST_F(HomeAddTest, ReadsTemperaturesByTheLocale) {
  add({"home", "Flat"}, "the home Flat");
  add({"accessory", "Box"}, "the accessory Box of Flat");
  add({"service", "Heat", "--accessory", "Box", "--type", "heater", "--attribute", "temperature"},
      "the service Box/Heat of Flat");
  ProgramStart american = start({"home", "add", "scene", "Warm", "--set", "Heat temperature 68"});
  american.environment = {{"LC_ALL", "en_US.UTF-8"}};
  EXPECT_EQ(runProgram(american).exitStatus, 0);
  EXPECT_THAT(exported(), HasSubstr("\"characteristic\": 2, \"value\": 20.0"));
}

TEST_F(HomeAddTest, RefusesWithoutAChange) {
  import(sampleDocument());
  const std::string before = exported();
  const std::pair<std::vector<std::string>, const char*> table[] = {
      {{"room", "Attic"}, "say which with --home"},
      {{"room", "", "--home", "Cottage"}, "empty"},
      {{"room"}, "--help"},
      {{"home", "Flat", "--home", "Cottage"}, "--help"},
      {{"zone", "Z", "--room", "Studdy"}, "did you mean Study?"},
      {{"service", "S", "--type", "light"}, "--accessory is missing"},
      {{"service", "S", "--accessory", "Floor lamp"}, "--type is missing"},
      {{"service", "S", "--accessory", "Floor lamp", "--type", "lihgt"}, "did you mean LIGHT?"},
      {{"scene", "S", "--set", "Lamp power on"}, "2 services named Lamp"},
      {{"scene", "S", "--set", "Ceiling lamp/8 brightness 101"}, "from 0 to 100"},
  };
  for (auto [words, reason] : table) {
    words.insert(words.begin(), {"home", "add"});
    const ProgramEnd end = run(words);
    SCOPED_TRACE(::testing::PrintToString(words));
    EXPECT_EQ(end.exitStatus, 2);
    EXPECT_THAT(end.output, IsEmpty());
    EXPECT_THAT(end.errors, AllOf(IsOneFailure(""), HasSubstr(reason)));
  }
  EXPECT_EQ(exported(), before);
}

TEST_F(HomeAddTest, SaysTheSameOnATerminal) {
  const ProgramEnd end = runOnTerminal(start({"home", "add", "home", "Flat"}));
  EXPECT_EQ(end.exitStatus, 0);
  EXPECT_THAT(end.output, ::testing::MatchesRegex("added the home Flat \\([0-9A-F-]+\\)\n"));
}

}  // namespace
}  // namespace nidus
