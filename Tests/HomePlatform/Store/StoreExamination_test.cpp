#include "HomePlatform/Store/StoreExamination.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <filesystem>
#include <string>

#include "HomePlatform/Store/Database.h"
#include "HomePlatform/Store/HomeStore.h"
#include "HomePlatform/Store/Schema.h"
#include "HomePlatform/Support/RandomHome.h"
#include "Support/TestFolder.h"

namespace nidus {
namespace {

using testing::AllOf;
using testing::HasSubstr;
using testing::IsEmpty;
using testing::SizeIs;
using testing::StartsWith;

constexpr std::chrono::milliseconds kPatience{1};

class StoreExaminationTest : public testing::Test {
 protected:
  void SetUp() override {
    const auto store = HomeStore::open(path());
    ASSERT_TRUE(store);
    HomeData home;
    home.name = "Cottage";
    home.rooms.push_back({NDUUID::random(), "Kitchen"});
    ASSERT_EQ((*store)->replaceHomes({home}), std::nullopt);
  }
  [[nodiscard]] std::filesystem::path path() const { return folder_.path() / "home.db"; }
  [[nodiscard]] StoreExamination examine() const { return examineStore(path(), kPatience); }
  void change(const std::string& statements) const {
    Database(path().string(), kPatience).run(statements);
  }
  /// What is wrong with the database, which must be one thing.
  [[nodiscard]] std::string problem() const {
    const StoreExamination found = examine();
    EXPECT_THAT(found.failures, SizeIs(1));
    return found.failures.empty() ? std::string() : found.failures.front().message;
  }

  const TestFolder folder_;
};

TEST_F(StoreExaminationTest, FindsNothingInASoundOne) {
  const StoreExamination found = examine();
  EXPECT_THAT(found.failures, IsEmpty());
  ASSERT_TRUE(found.homes);
  ASSERT_THAT(*found.homes, SizeIs(1));
  EXPECT_EQ(found.homes->front().name, "Cottage");
}

TEST_F(StoreExaminationTest, ReadsAnEmptyFileAsNoHomes) {
  folder_.write("home.db", "");
  const StoreExamination found = examine();
  EXPECT_THAT(found.failures, IsEmpty());
  ASSERT_TRUE(found.homes);
  EXPECT_THAT(*found.homes, IsEmpty());
  EXPECT_EQ(contentOfFile(path()), "");
}

TEST_F(StoreExaminationTest, LeavesTheFileAsItWas) {
  const std::string before = contentOfFile(path());
  static_cast<void>(examine());
  EXPECT_EQ(contentOfFile(path()), before);
}

TEST_F(StoreExaminationTest, MakesNoFile) {
  std::filesystem::remove(path());
  EXPECT_THAT(problem(), StartsWith(path().string() + ": "));
  EXPECT_FALSE(std::filesystem::exists(path()));
}

TEST_F(StoreExaminationTest, FindsReferencesThatLeadNowhere) {
  change("PRAGMA foreign_keys = OFF; UPDATE room SET home = 77");
  EXPECT_THAT(problem(), HasSubstr("(references of the table room that lead nowhere: 1)"));
}

TEST_F(StoreExaminationTest, FindsDamagedPages) {
  std::string content = contentOfFile(path());
  const std::size_t end = content.size();
  content.replace(end - 4096, 4096, 4096, '\xff');
  folder_.write("home.db", content);
  EXPECT_THAT(problem(),
              AllOf(HasSubstr("damaged (Page "), HasSubstr("; there is no good backup of it")));
}

TEST_F(StoreExaminationTest, FindsMissingTables) {
  change("DROP TABLE scene_action");
  EXPECT_THAT(problem(), HasSubstr("its tables are not those of this program"));
  EXPECT_FALSE(examine().homes);
}

TEST_F(StoreExaminationTest, RefusesAFileOfAnotherKind) {
  folder_.write("home.db", std::string(8192, 'x'));
  EXPECT_THAT(problem(), HasSubstr("no database"));
}

TEST_F(StoreExaminationTest, RefusesADatabaseOfAnotherProgram) {
  change("PRAGMA application_id = 5");
  EXPECT_THAT(problem(), HasSubstr("another program"));
}

TEST_F(StoreExaminationTest, RefusesANewerVersion) {
  change("PRAGMA user_version = 1000");
  EXPECT_THAT(problem(), HasSubstr("newer version"));
}

}  // namespace
}  // namespace nidus
