#include "HomePlatform/System/Locale.h"

#include <gtest/gtest.h>

#include <cstdlib>
#include <optional>
#include <string>

namespace nidus {
namespace {

TEST(LocaleTest, JudgesByTerritory) {
  struct Case {
    const char* name;
    bool isMetric;
  };
  const Case cases[] = {
      {"en_US", false},
      {"en_US.UTF-8", false},
      {"en_US@euro", false},
      {"en_US.UTF-8@x", false},
      {"en_LR", false},
      {"my_MM", false},
      {"es_US.UTF-8", false},
      {"en_GB", true},
      {"de_DE.UTF-8", true},
      {"en", true},
      {"C", true},
      {"POSIX", true},
      {"C.UTF-8", true},
      {"US", true},
      {"en_USA", true},
      {"en.UTF-8@_US", true},
      {"", true},
  };
  for (const auto& [name, isMetric] : cases) {
    SCOPED_TRACE(name);
    EXPECT_EQ(isMetricLocaleName(name), isMetric);
  }
}

/// Sets the variables for one test and puts back what was there.
class LocaleEnvironmentTest : public testing::Test {
 protected:
  static constexpr const char* kNames[] = {"LC_ALL", "LC_MEASUREMENT", "LANG"};

  LocaleEnvironmentTest() {
    for (std::size_t index = 0; index < 3; ++index) {
      if (const char* value = std::getenv(kNames[index])) before_[index] = value;
      ::unsetenv(kNames[index]);
    }
  }
  ~LocaleEnvironmentTest() override {
    for (std::size_t index = 0; index < 3; ++index) {
      ::unsetenv(kNames[index]);
      if (before_[index]) ::setenv(kNames[index], before_[index]->c_str(), 1);
    }
  }

 private:
  std::optional<std::string> before_[3];
};

TEST_F(LocaleEnvironmentTest, NothingSetIsMetric) { EXPECT_TRUE(isMetricEnvironment()); }

TEST_F(LocaleEnvironmentTest, FirstSetVariableDecides) {
  ::setenv("LANG", "en_US.UTF-8", 1);
  EXPECT_FALSE(isMetricEnvironment());
  ::setenv("LC_MEASUREMENT", "de_DE.UTF-8", 1);
  EXPECT_TRUE(isMetricEnvironment());
  ::setenv("LC_ALL", "en_US.UTF-8", 1);
  EXPECT_FALSE(isMetricEnvironment());
}

TEST_F(LocaleEnvironmentTest, EmptyVariableIsNotSet) {
  ::setenv("LANG", "en_US.UTF-8", 1);
  ::setenv("LC_ALL", "", 1);
  EXPECT_FALSE(isMetricEnvironment());
}

}  // namespace
}  // namespace nidus
