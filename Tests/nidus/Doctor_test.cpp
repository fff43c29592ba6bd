#include <sys/stat.h>

#include "nidus/ProgramTest.h"
#include "nidus/TerminalProcess.h"

namespace nidus {
namespace {

using ::testing::AllOf;
using ::testing::EndsWith;
using ::testing::HasSubstr;
using ::testing::IsEmpty;
using ::testing::Not;

/// A home in which all is well.
constexpr const char* kSoundHome = R"({"uuid": "AA00AA00-0000-4000-8000-000000000001",
  "name": "Cottage", "primary": true,
  "rooms": [{"uuid": "BB00BB00-0000-4000-8000-000000000001", "name": "Kitchen"}],
  "accessories": [{"uuid": "DD00DD00-0000-4000-8000-000000000001", "name": "Lamp",
    "room": "BB00BB00-0000-4000-8000-000000000001",
    "services": [{"instanceID": 8, "name": "Lamp",
      "serviceType": "com.corvane.nidus.service.light",
      "characteristics": [{"instanceID": 9,
        "characteristicType": "com.corvane.nidus.characteristic.power",
        "properties": ["readable", "writable"], "value": true,
        "metadata": {"format": "bool"}}]}]}]})";

class DoctorTest : public ProgramTest {
 protected:
  void SetUp() override {
    std::filesystem::create_directory(data());
    import(documentOf({kSoundHome}));
  }
  /// Runs the doctor, who must find something.
  [[nodiscard]] std::string report() const {
    const ProgramEnd end = run({"doctor"});
    EXPECT_EQ(end.exitStatus, 1) << end.output;
    EXPECT_THAT(end.errors, IsEmpty());
    return end.output;
  }
};

TEST_F(DoctorTest, FindsASoundHomeWell) {
  const ProgramEnd end = run({"doctor"});
  EXPECT_EQ(end.exitStatus, 0);
  EXPECT_THAT(end.errors, IsEmpty());
  EXPECT_THAT(end.output, AllOf(HasSubstr("ok         data folder\nok         database\n"),
                                Not(HasSubstr("attention")), EndsWith("\nAll is well.\n")));
}

TEST_F(DoctorTest, MakesNothing) {
  std::filesystem::remove_all(data());
  EXPECT_THAT(report(), HasSubstr(data() + "/home.db: there are no homes yet; "));
  EXPECT_FALSE(std::filesystem::exists(data()));
  std::filesystem::create_directory(data());
  EXPECT_THAT(report(), HasSubstr(data() + "/home.db: there are no homes yet; "));
  EXPECT_TRUE(std::filesystem::is_empty(data()));
}

TEST_F(DoctorTest, ListsWhatIsNotThereYet) {
  std::filesystem::remove_all(data());
  EXPECT_THAT(report(), AllOf(HasSubstr("note       data folder\n  note       " + data() + ": "),
                              HasSubstr("note       database\n  note       " + data() + "/home"),
                              EndsWith("\n1 thing needs attention, with 2 notes.\n")));
}

TEST_F(DoctorTest, SaysOnceThatThereCanBeNoFolder) {
  const std::string file = folder_.write("file", "");
  for (const std::string& folder : {file, file + "/below", std::string("/proc/nidus")}) {
    const ProgramEnd end = runProgram(ProgramStart{{"--data", folder, "doctor"}});
    EXPECT_EQ(end.exitStatus, 1);
    EXPECT_THAT(
        end.output,
        AllOf(::testing::StartsWith("attention  data folder\n  attention  " + folder + ": "),
              Not(HasSubstr("nidus home add")), EndsWith("\n1 thing needs attention.\n")));
  }
}

TEST_F(DoctorTest, LeavesTheFolderAsItWas) {
  ASSERT_EQ(run({"doctor"}).exitStatus, 0);
  std::vector<std::string> names;
  for (const auto& entry : std::filesystem::directory_iterator(data())) {
    names.push_back(entry.path().filename().string());
  }
  EXPECT_THAT(names, ::testing::UnorderedElementsAre("home.db", "preferences.json"));
}

TEST_F(DoctorTest, LooksAtTheRestBesideADamagedDatabase) {
  folder_.write("data/home.db", std::string(8192, 'x'));
  folder_.write("data/vocabulary.json", "{");
  folder_.write("data/preferences.json", "[]");
  EXPECT_THAT(report(), AllOf(HasSubstr("home.db: the file is damaged or no database"),
                              HasSubstr("vocabulary.json: "),
                              HasSubstr("preferences.json: expected an object"),
                              EndsWith("\n3 things need attention.\n")));
}

TEST_F(DoctorTest, FindsAFolderThatOthersMayChange) {
  ::chmod(data().c_str(), 0777);
  EXPECT_THAT(report(), AllOf(HasSubstr("attention  data folder\n  attention  " + data() + ": "),
                              HasSubstr("; chmod go-w " + data() + "\n"),
                              EndsWith("\n1 thing needs attention.\n")));
}

TEST_F(DoctorTest, EndsWellWithNotesAlone) {
  folder_.write("data/preferences.json", R"({"kHomesConfigured": true, "x": 1})");
  const ProgramEnd end = run({"doctor"});
  EXPECT_EQ(end.exitStatus, 0);
  EXPECT_THAT(end.output, AllOf(HasSubstr("note       preferences\n  note       "),
                                EndsWith("\nAll is well, with 1 note.\n")));
}

TEST_F(DoctorTest, TellsProgramsTheSame) {
  const ProgramEnd well = run({"doctor", "--json"});
  EXPECT_EQ(well.exitStatus, 0);
  EXPECT_THAT(well.output, AllOf(HasSubstr(R"({"isWell": true, "areas": ["data folder", )"),
                                 EndsWith("\"findings\": []}\n")));
  folder_.write("data/preferences.json", "[]");
  const ProgramEnd ill = run({"doctor", "--json"});
  EXPECT_EQ(ill.exitStatus, 1);
  EXPECT_THAT(ill.output, HasSubstr(R"([{"area": "preferences", "severity": "attention", )"));
}

TEST_F(DoctorTest, IsHonestAboutTheDemonstrationHome) {
  ASSERT_EQ(run({"home", "import", NIDUS_RESOURCES "/demonstration-home.json"}).exitStatus, 0);
  EXPECT_THAT(report(),
              AllOf(HasSubstr("Maple House / Kitchen and Lake Cabin / Kitchen share their name"),
                    HasSubstr("Terrace Lights / (no name): it has no name"),
                    HasSubstr("Blind Bridge: the assistant cannot address it"),
                    HasSubstr("Maple House / Downstairs: an order for this zone does not reach"),
                    HasSubstr("Garage / Garage Light: the accessory cannot be reached"),
                    EndsWith("\n6 things need attention, with 2 notes.\n")));
}

TEST_F(DoctorTest, AdvisesCommandsThatMend) {
  import(documentOf({smallHome()}));
  const std::string away = "DD00DD00-0000-4000-8000-000000000002";
  const std::string night = "FF00FF00-0000-4000-8000-000000000001";
  ASSERT_THAT(report(), AllOf(HasSubstr("nidus home remove accessory " + away + "\n"),
                              HasSubstr("nidus home remove scene " + night + "\n")));
  ASSERT_EQ(run({"home", "remove", "accessory", away, "--yes"}).exitStatus, 0);
  ASSERT_EQ(run({"home", "remove", "scene", night, "--yes"}).exitStatus, 0);
  EXPECT_EQ(run({"doctor"}).exitStatus, 0);
}

TEST_F(DoctorTest, MarksAreasOnATerminal) {
  const ProgramEnd well = runOnTerminal(start({"doctor"}));
  EXPECT_EQ(well.exitStatus, 0);
  EXPECT_THAT(well.output, AllOf(HasSubstr("✓"), HasSubstr("\x1b["), Not(HasSubstr("ok  "))));
  folder_.write("data/preferences.json", "[]");
  const ProgramEnd ill = runOnTerminal(start({"doctor"}));
  EXPECT_EQ(ill.exitStatus, 1);
  EXPECT_THAT(ill.output, HasSubstr("✗"));
}

TEST_F(DoctorTest, FailsWhereItCannotReport) {
  ProgramStart full = start({"doctor"});
  full.outputFile = "/dev/full";
  EXPECT_EQ(runProgram(full).exitStatus, 4);
}

}  // namespace
}  // namespace nidus
