#include <filesystem>

#include "nidus/ProgramTest.h"

namespace nidus {
namespace {

using ::testing::AllOf;
using ::testing::ContainsRegex;
using ::testing::HasSubstr;
using ::testing::StartsWith;

/// A data folder with a home "Third", and backups of the homes "First" and "Second".
class HomeRestoreTest : public ProgramTest {
 protected:
  void SetUp() override {
    for (const char* name : {"First", "Second", "Third"}) import(documentOf({emptyHome(name, 1)}));
  }
  /// Restores with these arguments, which must work, and gives what is said.
  [[nodiscard]] std::string restore(std::vector<std::string> arguments = {}) const {
    arguments.insert(arguments.begin(), {"home", "restore"});
    const ProgramEnd end = run(std::move(arguments));
    EXPECT_EQ(end.exitStatus, 0) << end.errors;
    EXPECT_EQ(end.errors, "");
    return end.output;
  }
  void damage() const { folder_.write("data/home.db", std::string(8192, 'x')); }
};

TEST_F(HomeRestoreTest, TakesTheNewestOrTheNamedOne) {
  EXPECT_EQ(restore(),
            "restored home-backup-000002.db: 1 home, 0 rooms, 0 accessories, 0 services\n");
  EXPECT_THAT(exported(), HasSubstr("Second"));
  EXPECT_THAT(restore({"1"}), StartsWith("restored home-backup-000001.db: "));
  EXPECT_THAT(exported(), HasSubstr("First"));
  EXPECT_THAT(restore({"home-backup-000003.db"}), StartsWith("restored home-backup-000003.db: "));
  EXPECT_THAT(exported(), HasSubstr("Third"));
}

TEST_F(HomeRestoreTest, ListsWhatThereIs) {
  folder_.write("data/home-backup-000001.db", "half of it");
  const std::string day = "20[0-9][0-9]-[0-9][0-9]-[0-9][0-9] [0-9][0-9]:[0-9][0-9]:[0-9][0-9]";
  EXPECT_THAT(restore({"--list"}),
              AllOf(StartsWith("BACKUP"), ContainsRegex("\nhome-backup-000002.db +" + day +
                                                        " +1 +0 +good\n"
                                                        "home-backup-000001.db +" +
                                                        day + " +damaged\n")));
  EXPECT_THAT(exported(), HasSubstr("Third"));
}

TEST_F(HomeRestoreTest, SaysWhenThereIsNone) {
  std::filesystem::remove_all(data());
  EXPECT_EQ(restore({"--list"}), "there are no backups of the homes yet\n");
  const ProgramEnd end = run({"home", "restore"});
  EXPECT_EQ(end.exitStatus, 4);
  EXPECT_THAT(end.errors, IsOneFailure(data() + ": there is no good backup of the homes; "));
}

TEST_F(HomeRestoreTest, RefusesAnUnknownOne) {
  const ProgramEnd end = run({"home", "restore", "77"});
  EXPECT_EQ(end.exitStatus, 2);
  EXPECT_THAT(end.errors, IsOneFailure("there is no backup 77; nidus home restore --list"));
}

TEST_F(HomeRestoreTest, MendsWhatTheMessageTellsOf) {
  damage();
  const ProgramEnd end = run({"home", "show"});
  EXPECT_EQ(end.exitStatus, 4);
  EXPECT_THAT(end.errors, HasSubstr("; nidus home restore brings back home-backup-000002.db, "));
  EXPECT_THAT(restore(), HasSubstr("; the damaged database is kept as home-damaged-000001.db\n"));
  EXPECT_THAT(exported(), HasSubstr("Second"));
}

TEST_F(HomeRestoreTest, WorksInTheShell) {
  const ProgramEnd end = run({"shell"}, "home show\nhome restore\nhome show\n");
  EXPECT_EQ(end.exitStatus, 0) << end.errors;
  EXPECT_THAT(end.output, ContainsRegex("Third(.|\n)*restored home-backup-000002(.|\n)*Second"));
}

TEST_F(HomeRestoreTest, CompletesBackupsOfADamagedDatabase) {
  damage();
  EXPECT_EQ(run({"complete", "--", "--data", data(), "home", "restore", "home"}).output,
            "home-backup-000001.db\nhome-backup-000002.db\n");
}

TEST_F(HomeRestoreTest, DoctorTellsOfTheBackups) {
  folder_.write("data/home-backup-000001.db", "half of it");
  const std::string output = run({"doctor"}).output;
  EXPECT_THAT(output, HasSubstr("attention  " + data() +
                                "/home-backup-000001.db: the backup is "
                                "damaged and cannot be restored; rm "));
  EXPECT_THAT(output, HasSubstr("note       " + data() +
                                "/home-backup-000002.db: it is a good "
                                "backup of the homes; nidus home restore --list"));
  damage();
  EXPECT_THAT(run({"doctor"}).output,
              HasSubstr("nidus home restore brings back home-backup-000002.db, its newest"));
}

}  // namespace
}  // namespace nidus
