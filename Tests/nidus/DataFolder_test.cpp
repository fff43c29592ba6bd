#include <sqlite3.h>
#include <sys/stat.h>

#include "Support/FileModes.h"
#include "nidus/ProgramTest.h"

namespace nidus {
namespace {

using ::testing::EndsWith;
using ::testing::IsEmpty;
using ::testing::IsSupersetOf;

/// A connection of the test's own to a database.
class Connection {
 public:
  explicit Connection(const std::string& file) { sqlite3_open(file.c_str(), &connection_); }
  ~Connection() { sqlite3_close(connection_); }
  Connection(const Connection&) = delete;
  Connection& operator=(const Connection&) = delete;
  void run(const char* statement) {
    ASSERT_EQ(sqlite3_exec(connection_, statement, nullptr, nullptr, nullptr), SQLITE_OK);
  }

 private:
  sqlite3* connection_ = nullptr;
};

class DataFolderTest : public ProgramTest {
 protected:
  /// Where the database is when only these variables are set.
  void expectDatabase(const std::map<std::string, std::optional<std::string>>& environment,
                      const std::string& file) {
    ProgramStart exporting{{"home", "export"}};
    exporting.environment = {{"NIDUS_DATA", {}}, {"XDG_DATA_HOME", {}}, {"HOME", {}}};
    for (const auto& [name, value] : environment) exporting.environment[name] = value;
    const ProgramEnd end = runProgram(exporting);
    EXPECT_EQ(end.exitStatus, 0) << end.errors;
    EXPECT_TRUE(std::filesystem::exists(folder_.path() / file));
  }
  [[nodiscard]] std::string database() const { return data() + "/home.db"; }
  /// What each command that needs the database says.
  void expectPlatformFailure(const std::string& start) {
    for (const char* command : {"perform", "sync", "records"}) {
      const ProgramEnd end = run({command}, "{}\n");
      EXPECT_EQ(end.exitStatus, 4) << command;
      EXPECT_THAT(end.output, IsEmpty());
      EXPECT_THAT(end.errors, IsOneFailure(start));
    }
    EXPECT_EQ(run({"home", "show"}).exitStatus, 4);
    EXPECT_EQ(run({"home", "export"}).exitStatus, 4);
  }
};

TEST_F(DataFolderTest, IsTheGivenOne) {
  EXPECT_EQ(run({"home", "export"}).exitStatus, 0);
  EXPECT_TRUE(std::filesystem::exists(database()));
}

TEST_F(DataFolderTest, IsThatOfTheEnvironment) {
  expectDatabase({{"NIDUS_DATA", folder_.file("own")}, {"XDG_DATA_HOME", folder_.file("xdg")}},
                 "own/home.db");
}

TEST_F(DataFolderTest, FollowsTheUsersDataFolder) {
  expectDatabase({{"XDG_DATA_HOME", folder_.file("xdg")}, {"HOME", folder_.file("home")}},
                 "xdg/nidus/home.db");
}

TEST_F(DataFolderTest, IgnoresARelativeDataFolder) {
  expectDatabase({{"XDG_DATA_HOME", "xdg"}, {"HOME", folder_.file("home")}},
                 "home/.local/share/nidus/home.db");
}

TEST_F(DataFolderTest, MustBeKnown) {
  ProgramStart exporting{{"home", "export"}};
  exporting.environment = {{"NIDUS_DATA", ""}, {"XDG_DATA_HOME", {}}, {"HOME", {}}};
  const ProgramEnd end = runProgram(exporting);
  EXPECT_EQ(end.exitStatus, 2);
  EXPECT_THAT(end.errors, IsOneFailure("no data folder is known"));
}

TEST_F(DataFolderTest, IsItsOwnersAloneWhateverTheMask) {
  for (const mode_t mask : {0000U, 0077U}) {
    SCOPED_TRACE(mask);
    const FileCreationMask set(mask);
    std::filesystem::remove_all(data());
    importSmallHome();
    ProgramProcess process(start({"perform"}));
    process.write(setCommandLine("Lamp", true) + "\n");
    ASSERT_TRUE(process.readLine());
    std::vector<std::string> names;
    for (const auto& entry : std::filesystem::directory_iterator(data())) {
      names.push_back(entry.path().filename().string());
      EXPECT_EQ(permissionsOf(entry.path()), 0600U) << entry.path();
    }
    EXPECT_THAT(names, IsSupersetOf({"home.db", "home.db-shm", "home.db-wal", "preferences.json"}));
    EXPECT_EQ(permissionsOf(data()), 0700U);
  }
}

TEST_F(DataFolderTest, MakesTheFoldersAboveForTheirOwnerToo) {
  const FileCreationMask set(0000);
  ASSERT_EQ(runProgram({{"--data", folder_.file("a/b/data"), "home", "export"}}).exitStatus, 0);
  for (const char* name : {"a", "a/b", "a/b/data"}) {
    EXPECT_EQ(permissionsOf(folder_.path() / name), 0700U) << name;
  }
}

TEST_F(DataFolderTest, MustNotBeOthersToChange) {
  importSmallHome();
  for (const char* name : {"data", "data/home.db", "data/preferences.json"}) {
    const std::string place = folder_.file(name);
    const auto before = permissionsOf(place);
    ::chmod(place.c_str(), before | 0020U);
    expectPlatformFailure(place + ": others may change it");
    EXPECT_THAT(run({"get", "power"}).errors, EndsWith("; chmod go-w " + place + "\n"));
    ::chmod(place.c_str(), before);
  }
  EXPECT_EQ(run({"home", "export"}).exitStatus, 0);
}

TEST_F(DataFolderTest, FailsBelowAFile) {
  folder_.write("data", "a file");
  expectPlatformFailure(data());
}

TEST_F(DataFolderTest, FailsWithADamagedDatabase) {
  std::filesystem::create_directory(data());
  folder_.write("data/home.db", std::string(8192, 'x'));
  expectPlatformFailure(database() + ": ");
  EXPECT_EQ(contentOfFile(database()), std::string(8192, 'x'));
}

TEST_F(DataFolderTest, FailsWithANewerDatabase) {
  importSmallHome();
  Connection(database()).run("PRAGMA user_version = 1000");
  expectPlatformFailure(database() + ": ");
}

TEST_F(DataFolderTest, MayFailWhileTheProgramRuns) {
  importSmallHome();
  ProgramProcess process(start({"perform"}));
  process.write(readCommandLine("Lamp") + "\n");
  ASSERT_TRUE(process.readLine());
  Connection(database()).run("DROP TABLE characteristic");
  process.write(readCommandLine("Lamp") + "\n");
  ASSERT_TRUE(process.readLine());
  const ProgramEnd end = process.finish();
  EXPECT_EQ(end.exitStatus, 4);
  EXPECT_THAT(end.errors, IsOneFailure(database() + ": "));
}

TEST_F(DataFolderTest, RefusesABadVocabulary) {
  importSmallHome();
  folder_.write("data/vocabulary.json", R"({"format": "nidus-vocabulary/1", "words": []})");
  const ProgramEnd end = run({"records"});
  EXPECT_NE(end.exitStatus, 0);
  EXPECT_THAT(end.errors, IsOneFailure(data() + "/vocabulary.json: /words: "));
}

}  // namespace
}  // namespace nidus
