#include "nidus/ProgramTest.h"

namespace nidus {
namespace {

using ::testing::AllOf;
using ::testing::HasSubstr;
using ::testing::IsEmpty;
using ::testing::StartsWith;

class PreferencesCommandTest : public ProgramTest {
 protected:
  [[nodiscard]] std::string fileText() const {
    return contentOfFile(folder_.path() / "data" / "preferences.json");
  }
  void writeFile(std::string_view text) const {
    std::filesystem::create_directory(folder_.path() / "data");
    folder_.write("data/preferences.json", text);
  }
};

TEST_F(PreferencesCommandTest, ListsAllWithTheirEffects) {
  const ProgramEnd end = run({"preferences", "list"});
  EXPECT_EQ(end.exitStatus, 0);
  EXPECT_THAT(
      end.output,
      AllOf(HasSubstr("kHomesConfigured: not set\n"), HasSubstr("NidusLogLevel: not set\n"),
            HasSubstr("NidusDeveloperLogLevel: not set\n"), HasSubstr("InternalBuild: not set\n"),
            HasSubstr("Now: the log level is 4 (warning), the default of a customer")));
  EXPECT_THAT(end.errors, IsEmpty());
}

TEST_F(PreferencesCommandTest, ListsAsJson) {
  writeFile(R"({"NidusLogLevel": 7, "Colour": "red"})");
  const ProgramEnd end = run({"preferences", "list", "--json"});
  EXPECT_EQ(end.exitStatus, 0);
  EXPECT_THAT(end.output, StartsWith(R"({"preferences": [{"key": "kHomesConfigured", )"));
  EXPECT_THAT(end.output, HasSubstr(R"({"key": "NidusLogLevel", "value": 7, )"));
  EXPECT_THAT(end.output, HasSubstr(R"({"key": "Colour", "value": "red", )"));
  EXPECT_THAT(end.output, HasSubstr(R"("logThreshold": {"level": 7, "rule": "NidusLogLevel", )"));
}

TEST_F(PreferencesCommandTest, GetsOne) {
  importSmallHome();
  const ProgramEnd end = run({"preferences", "get", "kHomesConfigured"});
  EXPECT_EQ(end.exitStatus, 0);
  EXPECT_THAT(end.output, StartsWith("kHomesConfigured: true\n"));
  EXPECT_THAT(end.output, HasSubstr("  Now: commands and syncs look for the homes.\n"));
  EXPECT_THAT(run({"preferences", "get", "InternalBuild", "--json"}).output,
              StartsWith(R"({"key": "InternalBuild", "value": null, )"));
}

TEST_F(PreferencesCommandTest, TellsThatEditsSetWhetherToLook) {
  ASSERT_EQ(run({"home", "add", "home", "Cabin"}).exitStatus, 0);
  EXPECT_THAT(run({"preferences", "get", "kHomesConfigured"}).output,
              AllOf(StartsWith("kHomesConfigured: true\n"),
                    HasSubstr("each import and each edit of homes sets it.\n")));
}

TEST_F(PreferencesCommandTest, SetsAndTellsTheEffect) {
  const ProgramEnd end = run({"preferences", "set", "NidusLogLevel", "debug"});
  EXPECT_EQ(end.exitStatus, 0);
  EXPECT_THAT(end.output, StartsWith("NidusLogLevel: 7\n"));
  EXPECT_THAT(end.output, HasSubstr("the log level is 7 (debug) by NidusLogLevel"));
  EXPECT_EQ(fileText(), "{\n  \"NidusLogLevel\": 7\n}\n");
}

TEST_F(PreferencesCommandTest, UnsetsOne) {
  writeFile(R"({"NidusLogLevel": 7, "Colour": "red"})");
  EXPECT_EQ(run({"preferences", "unset", "NidusLogLevel"}).exitStatus, 0);
  EXPECT_EQ(fileText(), "{\n  \"Colour\": \"red\"\n}\n");
  const ProgramEnd end = run({"preferences", "unset", "Colour"});
  EXPECT_EQ(end.exitStatus, 0);
  EXPECT_EQ(end.output, "Colour: not set\n");
  EXPECT_EQ(fileText(), "{\n}\n");
}

TEST_F(PreferencesCommandTest, SetLevelMakesCommandsLog) {
  importSmallHome();
  ASSERT_EQ(run({"preferences", "set", "NidusLogLevel", "6"}).exitStatus, 0);
  EXPECT_THAT(run({"perform"}, readCommandLine("Lamp")).errors, HasSubstr("Incoming Filter"));
}

TEST_F(PreferencesCommandTest, RefusesWhatWouldNotBeValid) {
  const ProgramEnd end = run({"preferences", "set", "NidusLogLevel", "loud"});
  EXPECT_EQ(end.exitStatus, 2);
  EXPECT_THAT(end.output, IsEmpty());
  EXPECT_THAT(end.errors, IsOneFailure("NidusLogLevel: \"loud\" would not be valid; give "));
  EXPECT_THAT(fileText(), IsEmpty());
}

TEST_F(PreferencesCommandTest, RefusesUnknownKeys) {
  const std::vector<std::vector<std::string>> table = {
      {"preferences", "get", "NidusLogLvl"},
      {"preferences", "set", "NidusLogLvl", "7"},
      {"preferences", "unset", "NidusLogLvl"},
  };
  for (const std::vector<std::string>& arguments : table) {
    const ProgramEnd end = run(arguments);
    SCOPED_TRACE(arguments[1]);
    EXPECT_EQ(end.exitStatus, 2);
    EXPECT_THAT(end.errors, IsOneFailure("NidusLogLvl: there is no such preference; did you mean "
                                         "NidusLogLevel?"));
  }
}

TEST_F(PreferencesCommandTest, TellsOfADamagedFile) {
  writeFile("[]");
  const ProgramEnd end = run({"preferences", "list"});
  EXPECT_EQ(end.exitStatus, 2);
  EXPECT_THAT(end.errors, HasSubstr("preferences.json"));
}

}  // namespace
}  // namespace nidus
