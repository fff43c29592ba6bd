#include "nidus/ProgramTest.h"
#include "nidus/TerminalProcess.h"

namespace nidus {
namespace {

using ::testing::AllOf;
using ::testing::HasSubstr;
using ::testing::IsEmpty;
using ::testing::Not;

using HomeCommandTest = ProgramTest;

TEST_F(HomeCommandTest, ExportsWhatWasImported) {
  const ProgramEnd imported =
      run({"home", "import", folder_.write("a.json", documentOf({smallHome()}))});
  EXPECT_EQ(imported.exitStatus, 0) << imported.errors;
  EXPECT_EQ(imported.output, "imported 1 home, 1 room, 3 accessories, 3 services\n");
  const std::string first = exported();
  EXPECT_THAT(first, AllOf(HasSubstr("Cottage"), HasSubstr("requiresUnlock")));
  import(first);
  EXPECT_EQ(exported(), first);
}

TEST_F(HomeCommandTest, ExportsNoHomesFromANewFolder) {
  const ProgramEnd end = run({"home", "export"});
  EXPECT_EQ(end.exitStatus, 0) << end.errors;
  EXPECT_THAT(end.output, HasSubstr("nidus-home/1"));
}

TEST_F(HomeCommandTest, ReadsADocumentFromStandardInput) {
  EXPECT_EQ(run({"home", "import", "-"}, documentOf({smallHome()})).exitStatus, 0);
  EXPECT_THAT(exported(), HasSubstr("Cottage"));
}

TEST_F(HomeCommandTest, ReplacesAllHomesWithoutMerge) {
  import(documentOf({emptyHome("One", 1), emptyHome("Two", 2)}));
  import(documentOf({emptyHome("Three", 3)}));
  EXPECT_THAT(exported(), AllOf(HasSubstr("Three"), Not(HasSubstr("One")), Not(HasSubstr("Two"))));
}

TEST_F(HomeCommandTest, MergesByUUID) {
  import(documentOf({emptyHome("One", 1), emptyHome("Two", 2)}));
  const auto file =
      folder_.write("merge.json", documentOf({emptyHome("Deux", 2), emptyHome("Three", 3)}));
  EXPECT_EQ(run({"home", "import", file, "--merge"}).exitStatus, 0);
  EXPECT_THAT(exported(), AllOf(HasSubstr("One"), HasSubstr("Deux"), HasSubstr("Three"),
                                Not(HasSubstr("Two"))));
}

TEST_F(HomeCommandTest, ConfiguresHomesByImport) {
  importSmallHome();
  EXPECT_EQ(run({"perform"}, readCommandLine("Lamp")).exitStatus, 0);
  import(documentOf({}));
  EXPECT_EQ(run({"perform"}, readCommandLine("Lamp")).exitStatus, 1);
  EXPECT_THAT(run({"records"}).output, IsEmpty());
}

TEST_F(HomeCommandTest, ExportsIntoAFile) {
  importSmallHome();
  const auto file = folder_.write("out.json", "old");
  const ProgramEnd end = run({"home", "export", file});
  EXPECT_EQ(end.exitStatus, 0) << end.errors;
  EXPECT_THAT(end.output, IsEmpty());
  EXPECT_EQ(contentOfFile(file), exported());
}

TEST_F(HomeCommandTest, LeavesNothingBesideTheExport) {
  std::filesystem::create_directory(folder_.path() / "out");
  EXPECT_EQ(run({"home", "export", folder_.file("out/homes.json")}).exitStatus, 0);
  const std::filesystem::directory_iterator files(folder_.path() / "out");
  EXPECT_EQ(std::distance(begin(files), end(files)), 1);
}

TEST_F(HomeCommandTest, KeepsThePermissionsOfTheFile) {
  const auto file = folder_.write("out.json", "old");
  std::filesystem::permissions(file, std::filesystem::perms(0640));
  EXPECT_EQ(run({"home", "export", file}).exitStatus, 0);
  EXPECT_EQ(std::filesystem::status(file).permissions(), std::filesystem::perms(0640));
}

TEST_F(HomeCommandTest, FollowsALinkOnExport) {
  const auto file = folder_.write("out.json", "old");
  std::filesystem::create_symlink(file, folder_.path() / "link.json");
  EXPECT_EQ(run({"home", "export", folder_.file("link.json")}).exitStatus, 0);
  EXPECT_TRUE(std::filesystem::is_symlink(folder_.path() / "link.json"));
  EXPECT_EQ(contentOfFile(file), exported());
}

TEST_F(HomeCommandTest, FailsToExportWhereItCanNotWrite) {
  for (const std::string& file :
       {folder_.file("missing/out.json"), folder_.path().string(), std::string("/dev/full")}) {
    const ProgramEnd end = run({"home", "export", file});
    EXPECT_EQ(end.exitStatus, 4);
    EXPECT_THAT(end.errors, IsOneFailure(file + ": cannot be written"));
  }
}

TEST_F(HomeCommandTest, ShowsATree) {
  importSmallHome();
  const ProgramEnd end = run({"home", "show"});
  EXPECT_EQ(end.exitStatus, 0) << end.errors;
  EXPECT_EQ(end.output,
            "Cottage (primary)\n"
            "├─ Kitchen\n"
            "│  ├─ Lamp\n"
            "│  │  └─ Lamp [LIGHT] POWER on, BRIGHTNESS 40 %\n"
            "│  └─ Away (unreachable)\n"
            "│     └─ Away [LIGHT] POWER on, BRIGHTNESS 40 %\n"
            "├─ in no room\n"
            "│  └─ Door (requires an unlocked device)\n"
            "│     └─ Door [LOCK] POWER off\n"
            "├─ zones\n"
            "│  └─ Downstairs: Kitchen\n"
            "├─ groups\n"
            "│  └─ Corner: Lamp\n"
            "└─ scenes: Night\n");
}

TEST_F(HomeCommandTest, ColoursTheTreeOnATerminal) {
  importSmallHome();
  const std::string tree = runOnTerminal(start({"home", "show"}), 40).output;
  EXPECT_THAT(tree, HasSubstr("\x1b[1mCottage (primary)\x1b[0m\n"));
  EXPECT_THAT(tree, HasSubstr("\x1b[2m│  ├─ \x1b[0mLamp\n"));
  EXPECT_THAT(tree, HasSubstr("\x1b[31mAway (unreachable)\x1b[0m\n"));
  EXPECT_THAT(tree, HasSubstr("\x1b[2m│  │  └─ \x1b[0mLamp [LIGHT] POWER on,\n"
                              "\x1b[2m│  │     "
                              "  \x1b[0mBRIGHTNESS 40 %\n"));
}

TEST_F(HomeCommandTest, ShowsNewValues) {
  importSmallHome();
  EXPECT_EQ(run({"perform"}, setCommandLine("Lamp", false)).exitStatus, 0);
  EXPECT_THAT(run({"home", "show"}).output, HasSubstr("Lamp [LIGHT] POWER off"));
}

TEST_F(HomeCommandTest, SaysThatThereAreNoHomes) {
  const ProgramEnd end = run({"home", "show"});
  EXPECT_EQ(end.exitStatus, 0);
  EXPECT_THAT(end.output, HasSubstr("nidus home import FILE"));
}

TEST_F(HomeCommandTest, ChecksWithoutADataFolder) {
  const auto file = folder_.write("a.json", documentOf({smallHome()}));
  const ProgramEnd end = run({"home", "check", file});
  EXPECT_EQ(end.exitStatus, 0) << end.errors;
  EXPECT_THAT(end.output, HasSubstr("1 home, 1 room, 3 accessories"));
  EXPECT_FALSE(std::filesystem::exists(data()));
}

TEST_F(HomeCommandTest, ChecksTheDemonstrationHome) {
  const ProgramEnd end = run({"home", "check", NIDUS_RESOURCES "/demonstration-home.json"});
  EXPECT_EQ(end.exitStatus, 0) << end.errors;
}

struct BadDocument {
  const char* label;
  std::string text;
  const char* place;
};

std::vector<BadDocument> badDocuments() {
  const std::string head = R"({"format": "nidus-home/1", "homes": [)";
  return {
      {"empty", "", ""},
      {"no JSON", "homes", ""},
      {"cut off", head, ""},
      {"trailing text", documentOf({}) + "x", ""},
      {"list", "[]", ""},
      {"wrong format", R"({"format": "nidus-home/9", "homes": []})", "/format"},
      {"unknown key", R"({"format": "nidus-home/1", "homes": [], "house": 1})", "/house"},
      {"missing UUID", head + R"({"name": "a"}]})", "/homes/0"},
      {"malformed UUID", head + R"({"uuid": "1", "name": "a"}]})", "/homes/0/uuid"},
      {"duplicate key", R"({"format": "nidus-home/1", "format": "nidus-home/1", "homes": []})", ""},
      {"deep nesting", std::string(100000, '['), ""},
      {"invalid UTF-8",
       head + R"({"uuid": "AA00AA00-0000-4000-8000-000000000001", "name": ")" + "\xff\"}]}", ""},
      {"line break in a key", R"({"format": "nidus-home/1", "homes": [], "a\nb": 1})", "/a"},
  };
}

TEST_F(HomeCommandTest, LeavesTheHomesOnABadDocument) {
  importSmallHome();
  const std::string before = exported();
  for (const BadDocument& bad : badDocuments()) {
    SCOPED_TRACE(bad.label);
    const auto file = folder_.write("bad.json", bad.text);
    const ProgramEnd end = run({"home", "import", file});
    EXPECT_EQ(end.exitStatus, 2);
    EXPECT_THAT(end.output, IsEmpty());
    EXPECT_THAT(end.errors, IsOneFailure(file + ": " + bad.place));
  }
  EXPECT_EQ(exported(), before);
}

TEST_F(HomeCommandTest, ChecksBadDocumentsLikewise) {
  for (const BadDocument& bad : badDocuments()) {
    SCOPED_TRACE(bad.label);
    const auto file = folder_.write("bad.json", bad.text);
    const ProgramEnd end = run({"home", "check", file});
    EXPECT_EQ(end.exitStatus, 2);
    EXPECT_THAT(end.output, IsEmpty());
    EXPECT_THAT(end.errors, IsOneFailure(file + ": " + bad.place));
  }
}

TEST_F(HomeCommandTest, NamesAFileThatIsNotThere) {
  for (const char* command : {"import", "check"}) {
    const ProgramEnd end = run({"home", command, folder_.file("missing.json")});
    EXPECT_EQ(end.exitStatus, 2);
    EXPECT_THAT(end.errors, IsOneFailure(folder_.file("missing.json") + ": "));
  }
  EXPECT_FALSE(std::filesystem::exists(data()));
}

}  // namespace
}  // namespace nidus
