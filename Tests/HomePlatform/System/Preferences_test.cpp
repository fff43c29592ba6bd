#include "HomePlatform/System/Preferences.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>
#include <sys/stat.h>

#include "Support/TestFolder.h"

namespace nidus {
namespace {

using testing::HasSubstr;
using testing::StartsWith;

constexpr const char* kFile = "preferences.json";

class PreferencesTest : public testing::Test {
 protected:
  void open(std::string_view text) {
    folder_.write(kFile, text);
    open();
  }
  void open() {
    auto opened = Preferences::open(
        folder_.path(), [this](const Failure& failure) { failures_.push_back(failure.message); });
    ASSERT_TRUE(opened) << opened.failure().message;
    preferences_ = *opened;
  }
  [[nodiscard]] NDPreferences::BooleanReading boolean(const char* key) {
    return preferences_->booleanForKey_domain_container(key, Preferences::kDomain,
                                                        preferences_->containerPath());
  }
  [[nodiscard]] std::string content() const { return contentOfFile(folder_.path() / kFile); }

  const TestFolder folder_;
  std::vector<std::string> failures_;
  std::shared_ptr<Preferences> preferences_;
};

TEST_F(PreferencesTest, MissingFileHoldsNothing) {
  open();
  EXPECT_FALSE(boolean("kHomesConfigured").keyExistsAndIsValid);
  EXPECT_EQ(preferences_->integerForKey("NidusLogLevel"), 0);
  EXPECT_FALSE(preferences_->valueForKey("InternalBuild"));
}

TEST_F(PreferencesTest, ReadsBooleansStrictly) {
  open(R"({"yes": true, "no": false, "one": 1, "text": "true", "none": null, "list": [true]})");
  EXPECT_TRUE(boolean("yes").value && boolean("yes").keyExistsAndIsValid);
  EXPECT_TRUE(!boolean("no").value && boolean("no").keyExistsAndIsValid);
  for (const char* key : {"one", "text", "none", "list", "missing"}) {
    SCOPED_TRACE(key);
    EXPECT_FALSE(boolean(key).keyExistsAndIsValid);
    EXPECT_FALSE(boolean(key).value);
  }
}

TEST_F(PreferencesTest, ReadsIntegersStrictly) {
  open(R"({"five": 5, "below": -1, "float": 5.0, "text": "5", "yes": true})");
  EXPECT_EQ(preferences_->integerForKey("five"), 5);
  EXPECT_EQ(preferences_->integerForKey("below"), -1);
  for (const char* key : {"float", "text", "yes", "missing"}) {
    SCOPED_TRACE(key);
    EXPECT_EQ(preferences_->integerForKey(key), 0);
  }
}

TEST_F(PreferencesTest, KnowsItsDomainAndContainerAlone) {
  open(R"({"yes": true})");
  const NDString path = folder_.path().string();
  const auto read = [this](const NDString& domain, const NDString& container) {
    return preferences_->booleanForKey_domain_container("yes", domain, container).value;
  };
  EXPECT_TRUE(read("com.corvane.nidusd", path));
  EXPECT_FALSE(read("com.corvane.other", path));
  EXPECT_FALSE(read("com.corvane.nidusd", "/elsewhere"));
}

TEST_F(PreferencesTest, BoxesWhatStandsThere) {
  open(R"({"yes": true, "five": 5, "half": 0.5, "text": "a", "list": []})");
  EXPECT_TRUE(preferences_->valueForKey("yes")->isBoolean());
  EXPECT_TRUE(preferences_->valueForKey("five")->isInteger());
  EXPECT_TRUE(preferences_->valueForKey("half")->isFloating());
  EXPECT_TRUE(preferences_->valueForKey("text")->isText());
  EXPECT_FALSE(preferences_->valueForKey("list"));
}

TEST_F(PreferencesTest, GivesAllValues) {
  open(R"({"yes": true, "list": [1]})");
  const auto values = preferences_->values();
  EXPECT_EQ(values.size(), 2U);
  EXPECT_EQ(values.at("yes"), JsonValue{true});
  EXPECT_EQ(values.at("list"), JsonValue{JsonValue::Array{JsonValue{std::int64_t{1}}}});
}

TEST_F(PreferencesTest, RefusesDamagedFileAtOpen) {
  for (const char* text : {"", "[]", "{\"a\": }", "{} {}", "{\"a\": 1, \"a\": 2}"}) {
    SCOPED_TRACE(text);
    const std::string path = folder_.write(kFile, text);
    const auto opened = Preferences::open(folder_.path(), [](const Failure&) {});
    ASSERT_FALSE(opened);
    EXPECT_THAT(opened.failure().message, StartsWith(path + ": "));
  }
}

TEST_F(PreferencesTest, RefusesAFolderInPlaceOfTheFile) {
  std::filesystem::create_directory(folder_.path() / kFile);
  const auto opened = Preferences::open(folder_.path(), [](const Failure&) {});
  ASSERT_FALSE(opened);
  EXPECT_THAT(opened.failure().message, HasSubstr("a folder is where the preferences"));
}

TEST_F(PreferencesTest, SynchronizeTakesInChanges) {
  open(R"({"level": 3})");
  folder_.write(kFile, R"({"level": 4})");
  EXPECT_EQ(preferences_->integerForKey("level"), 3);
  preferences_->synchronize();
  EXPECT_EQ(preferences_->integerForKey("level"), 4);
}

TEST_F(PreferencesTest, BooleanReadSeesChangedFile) {
  open(R"({})");
  folder_.write(kFile, R"({"yes": true})");
  EXPECT_TRUE(boolean("yes").value);
}

TEST_F(PreferencesTest, RemovedFileHoldsNothing) {
  open(R"({"level": 3})");
  std::filesystem::remove(folder_.path() / kFile);
  preferences_->synchronize();
  EXPECT_EQ(preferences_->integerForKey("level"), 0);
}

TEST_F(PreferencesTest, DamagedFileKeepsLastGoodValues) {
  open(R"({"level": 3, "yes": true})");
  folder_.write(kFile, "damaged");
  preferences_->synchronize();
  preferences_->synchronize();
  EXPECT_TRUE(boolean("yes").value);
  EXPECT_EQ(preferences_->integerForKey("level"), 3);
  ASSERT_EQ(failures_.size(), 1U);
  EXPECT_THAT(failures_[0], HasSubstr(kFile));
}

TEST_F(PreferencesTest, ChangeKeepsOtherKeysInOrder) {
  open(R"({"z": [1, {"a": null}], "b": 0.1, "c": true})");
  EXPECT_FALSE(preferences_->change({{"b", JsonValue{std::int64_t{2}}}, {"n", JsonValue{true}}}));
  EXPECT_EQ(parseJson(content()), parseJson(R"({"z": [1, {"a": null}], "b": 2, "c": true,
                                                "n": true})"));
}

TEST_F(PreferencesTest, SeesRemovalRightAfterChange) {
  open(R"({})");
  EXPECT_FALSE(preferences_->change({{"yes", JsonValue{true}}}));
  std::filesystem::remove(folder_.path() / kFile);
  EXPECT_FALSE(boolean("yes").keyExistsAndIsValid);
}

TEST_F(PreferencesTest, ChangeStartsFromTheFile) {
  open(R"({})");
  folder_.write(kFile, R"({"other": 1})");
  EXPECT_FALSE(preferences_->change({{"own", JsonValue{std::int64_t{2}}}}));
  EXPECT_EQ(preferences_->integerForKey("other"), 1);
  EXPECT_EQ(preferences_->integerForKey("own"), 2);
}

TEST_F(PreferencesTest, NullRemovesKey) {
  open(R"({"level": 3, "other": 1})");
  EXPECT_FALSE(preferences_->change({{"level", JsonValue{}}, {"missing", JsonValue{}}}));
  EXPECT_EQ(parseJson(content()), parseJson(R"({"other": 1})"));
}

TEST_F(PreferencesTest, ChangeRefusesDamagedFile) {
  open(R"({})");
  folder_.write(kFile, "damaged");
  EXPECT_TRUE(preferences_->change({{"own", JsonValue{true}}}));
  EXPECT_EQ(content(), "damaged");
}

TEST_F(PreferencesTest, WrittenFileIsForOwnerAlone) {
  open();
  EXPECT_FALSE(preferences_->change({{"own", JsonValue{true}}}));
  struct stat status = {};
  ASSERT_EQ(::stat((folder_.path() / kFile).c_str(), &status), 0);
  EXPECT_EQ(status.st_mode & 0777U, 0600U);
}

TEST_F(PreferencesTest, LeavesNoOtherFileBehind) {
  open();
  EXPECT_FALSE(preferences_->change({{"own", JsonValue{true}}}));
  const std::filesystem::directory_iterator files(folder_.path());
  EXPECT_EQ(std::distance(begin(files), end(files)), 1);
}

TEST_F(PreferencesTest, TakesEachChangeOnce) {
  open(R"({"level": 3})");
  EXPECT_FALSE(preferences_->takeChange());
  folder_.write(kFile, R"({"level": 4})");
  preferences_->synchronize();
  EXPECT_TRUE(preferences_->takeChange());
  EXPECT_FALSE(preferences_->takeChange());
}

TEST(PreferencesInMemoryTest, ChangesTouchNoFile) {
  const auto preferences = Preferences::inMemory({{"level", JsonValue{std::int64_t{3}}}}, "memory");
  EXPECT_FALSE(preferences->change({{"level", JsonValue{}}, {"on", JsonValue{true}}}));
  preferences->synchronize();
  EXPECT_EQ(preferences->integerForKey("level"), 0);
  EXPECT_TRUE(
      preferences->booleanForKey_domain_container("on", Preferences::kDomain, "memory").value);
}

}  // namespace
}  // namespace nidus
