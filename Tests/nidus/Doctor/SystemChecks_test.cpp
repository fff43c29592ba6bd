#include <sys/stat.h>

#include <filesystem>

#include "Support/TestFolder.h"
#include "nidus/Doctor/DoctorTest.h"

namespace nidus {
namespace {

using ::testing::AllOf;
using ::testing::ElementsAre;
using ::testing::HasSubstr;
using ::testing::IsEmpty;

class DataFolderCheckTest : public DoctorCheckTest {
 protected:
  void SetUp() override { examination_.folder = folder_.path(); }
  const TestFolder folder_;
};

TEST_F(DataFolderCheckTest, FindsNothingInAFolderOfOnesOwn) {
  folder_.write("home.db", "");
  folder_.write("preferences.json", "{}");
  EXPECT_THAT(findingsOf(checkDataFolder), IsEmpty());
}

TEST_F(DataFolderCheckTest, FindsAFolderThatOthersMayChange) {
  ::chmod(folder_.path().c_str(), 0777);
  EXPECT_THAT(findingsOf(checkDataFolder),
              ElementsAre(NeedsAttention(folder_.path().string(),
                                         HasSubstr("chmod go-w " + folder_.path().string()))));
}

TEST_F(DataFolderCheckTest, FindsAFolderThatOthersMayRead) {
  for (const mode_t mode : {0750U, 0701U}) {
    ::chmod(folder_.path().c_str(), mode);
    EXPECT_THAT(findingsOf(checkDataFolder),
                ElementsAre(NeedsAttention(folder_.path().string(),
                                           HasSubstr("chmod go-rwx " + folder_.path().string()))));
  }
}

TEST_F(DataFolderCheckTest, FindsAPlaceThatOthersMayExchange) {
  examination_.folder = folder_.path() / "data";
  std::filesystem::create_directory(examination_.folder);
  ::chmod(examination_.folder.c_str(), 0700);
  ::chmod(folder_.path().c_str(), 0770);
  EXPECT_THAT(findingsOf(checkDataFolder),
              ElementsAre(NeedsAttention(folder_.path().string(), HasSubstr("chmod go-w"))));
}

TEST_F(DataFolderCheckTest, FindsFilesThatOthersMayChange) {
  ::chmod(folder_.write("home.db", "").c_str(), 0620);
  ::chmod(folder_.write("vocabulary.json", "").c_str(), 0602);
  EXPECT_THAT(findingsOf(checkDataFolder),
              ElementsAre(NeedsAttention("home.db", HasSubstr("chmod go-w")),
                          NeedsAttention("vocabulary.json", HasSubstr("chmod go-w"))));
}

TEST_F(DataFolderCheckTest, TellsWhyThereCanBeNone) {
  examination_.folderFailure = Failure{Failure::Kind::platform, "/data: is no folder; move it"};
  EXPECT_THAT(findingsOf(checkDataFolder),
              ElementsAre(NeedsAttention("/data", "is no folder; move it")));
}

TEST_F(DataFolderCheckTest, NotesThatThereIsNoneYet) {
  examination_.folder = folder_.path() / "none";
  EXPECT_THAT(findingsOf(checkDataFolder), ElementsAre(IsNote("/none", HasSubstr("none yet"))));
}

TEST_F(DataFolderCheckTest, FindsFilesThatLeadInCircles) {
  std::filesystem::create_symlink("home.db", folder_.path() / "home.db");
  EXPECT_THAT(findingsOf(checkDataFolder),
              ElementsAre(NeedsAttention("home.db", HasSubstr("cannot be looked at"))));
}

using DatabaseCheckTest = DoctorCheckTest;

TEST_F(DatabaseCheckTest, FindsNothingInASoundOne) {
  EXPECT_THAT(findingsOf(checkDatabase), IsEmpty());
}

TEST_F(DatabaseCheckTest, NotesThatThereIsNoneYet) {
  examination_.hasDatabase = false;
  EXPECT_THAT(findingsOf(checkDatabase),
              ElementsAre(IsNote("/data/home.db", HasSubstr("none yet"))));
}

TEST_F(DatabaseCheckTest, TellsPlaceDamageAndRemedyApart) {
  examination_.databaseFailures = {
      {Failure::Kind::platform, "/data/home.db: it is damaged (page 4; page 5); restore it"}};
  const Findings findings = findingsOf(checkDatabase);
  ASSERT_THAT(findings, ::testing::SizeIs(1));
  EXPECT_EQ(findings.front().place, "/data/home.db");
  EXPECT_EQ(findings.front().message, "it is damaged (page 4; page 5)");
  EXPECT_EQ(findings.front().remedy, "restore it");
}

using ModuleCheckTest = DoctorCheckTest;

TEST_F(ModuleCheckTest, FindsNothingWhenItFits) { EXPECT_THAT(findingsOf(checkModule), IsEmpty()); }

TEST_F(ModuleCheckTest, FindsAModuleThatDoesNotFit) {
  examination_.moduleFailure = Failure{Failure::Kind::platform, "m.so: offers nothing; reinstall"};
  EXPECT_THAT(findingsOf(checkModule),
              ElementsAre(NeedsAttention("m.so", "offers nothing; reinstall")));
}

using VocabularyCheckTest = DoctorCheckTest;

TEST_F(VocabularyCheckTest, FindsNothingInTheBuiltInOne) {
  EXPECT_THAT(findingsOf(checkVocabulary), IsEmpty());
}

TEST_F(VocabularyCheckTest, FindsAFileThatCannotBeRead) {
  examination_.vocabularyFailure =
      Failure{Failure::Kind::badInput, "/data/vocabulary.json: /words: unknown key; correct it"};
  EXPECT_THAT(findingsOf(checkVocabulary),
              ElementsAre(NeedsAttention("vocabulary.json", HasSubstr("/words: unknown key"))));
}

TEST_F(VocabularyCheckTest, FindsTypesAndUnitsThatNobodyKnows) {
  addWords(R"({"format": "nidus-vocabulary/1", "characteristics": [
    {"assistantName": "GLOW", "read": "glow", "valueType": "boolean"},
    {"assistantName": "SHINE", "read": "shine", "valueType": "int", "unit": "glim"}]})");
  EXPECT_THAT(findingsOf(checkVocabulary),
              ElementsAre(NeedsAttention("GLOW", HasSubstr("\"boolean\"")),
                          NeedsAttention("SHINE", HasSubstr("\"glim\""))));
}

using PreferencesCheckTest = DoctorCheckTest;

TEST_F(PreferencesCheckTest, FindsNothingInUsualOnes) {
  examination_.preferences = {{"kHomesConfigured", JsonValue{true}},
                              {"NidusLogLevel", JsonValue{std::int64_t{7}}},
                              {"NidusDeveloperLogLevel", JsonValue{std::int64_t{6}}},
                              {"InternalBuild", JsonValue{false}}};
  EXPECT_THAT(findingsOf(checkPreferences), IsEmpty());
}

TEST_F(PreferencesCheckTest, FindsAFileThatCannotBeRead) {
  examination_.preferencesFailure = Failure{Failure::Kind::platform, "/data/p.json: bad; correct"};
  EXPECT_THAT(findingsOf(checkPreferences), ElementsAre(NeedsAttention("p.json", "bad; correct")));
}

TEST_F(PreferencesCheckTest, FindsValuesOfTheWrongType) {
  examination_.preferences = {{"kHomesConfigured", JsonValue{std::string("yes")}},
                              {"NidusLogLevel", JsonValue{7.5F}}};
  EXPECT_THAT(findingsOf(checkPreferences),
              ElementsAre(NeedsAttention("kHomesConfigured",
                                         HasSubstr("nidus preferences set kHomesConfigured VALUE")),
                          NeedsAttention("NidusLogLevel", HasSubstr("counts as missing"))));
}

TEST_F(PreferencesCheckTest, NotesKeysThatNothingUses) {
  examination_.preferences = {{"Odd one", JsonValue{true}}};
  EXPECT_THAT(findingsOf(checkPreferences),
              ElementsAre(IsNote("Odd one", HasSubstr("nidus preferences unset 'Odd one'"))));
}

class HomesCheckTest : public DoctorCheckTest {
 protected:
  static std::string home(const std::string& name, const std::string& digit, bool isPrimary) {
    return R"({"uuid": "AA00AA00-0000-4000-8000-00000000000)" + digit + R"(", "name": ")" + name +
           R"(", "primary": )" + (isPrimary ? "true" : "false") + "}";
  }
};

TEST_F(HomesCheckTest, FindsNothingWithOnePrimaryHome) {
  setHomes("[" + home("Cottage", "1", true) + "," + home("Flat", "2", false) + "]");
  EXPECT_THAT(findingsOf(checkHomes), IsEmpty());
}

TEST_F(HomesCheckTest, MissesHomes) {
  setHomes("[]");
  EXPECT_THAT(findingsOf(checkHomes),
              ElementsAre(NeedsAttention("/data/home.db", AllOf(HasSubstr("no homes yet"),
                                                                HasSubstr("nidus home import")))));
  examination_.homes.reset();
  EXPECT_THAT(findingsOf(checkHomes),
              ElementsAre(NeedsAttention("/data/home.db", HasSubstr("no homes yet"))));
}

TEST_F(HomesCheckTest, FindsHomesThatTheAssistantDoesNotSee) {
  setHomes("[" + home("Cottage", "1", true) + "]");
  for (const JsonValue::Object& preferences :
       {JsonValue::Object{}, {{"kHomesConfigured", JsonValue{false}}}}) {
    examination_.preferences = preferences;
    EXPECT_THAT(findingsOf(checkHomes),
                ElementsAre(NeedsAttention("/data/preferences.json",
                                           HasSubstr("set kHomesConfigured true"))));
  }
}

TEST_F(HomesCheckTest, FindsHomesWithoutAPrimaryOne) {
  setHomes("[" + home("Cottage", "1", false) + "," + home("Flat", "2", false) + "]");
  EXPECT_THAT(findingsOf(checkHomes),
              ElementsAre(NeedsAttention("homes", HasSubstr("mark one as primary"))));
}

TEST_F(HomesCheckTest, NotesFurtherPrimaryHomes) {
  setHomes("[" + home("Cottage", "1", true) + "," + home("Flat", "2", true) + "]");
  EXPECT_THAT(findingsOf(checkHomes), ElementsAre(IsNote("homes", HasSubstr("first, Cottage"))));
}

}  // namespace
}  // namespace nidus
