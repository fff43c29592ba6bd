#include "Architecture/IncludeRules.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <filesystem>
#include <fstream>

namespace nidus {
namespace {

using testing::ElementsAre;
using testing::IsEmpty;
using testing::SizeIs;

bool isAnything(std::string_view /*path*/) { return true; }

std::vector<std::string> violationsOf(const std::string& path, const std::string& line) {
  return includeViolations({path, {line}}, isAnything);
}

TEST(IncludeRulesTest, NamesFileLineAndReason) {
  const SourceFile file = {"PlatformModel/System/NDString.h",
                           {"#pragma once", "", "#include \"HomePlatform/Result.h\""}};
  EXPECT_THAT(includeViolations(file, isAnything),
              ElementsAre("PlatformModel/System/NDString.h:3: "
                          "PlatformModel must not include HomePlatform"));
}

TEST(IncludeRulesTest, ReportsEachLine) {
  const SourceFile file = {"Logging/A.cpp",
                           {"#include \"nidus/A.h\"", "int a;", "#include \"Assistant/A.h\""}};
  EXPECT_THAT(includeViolations(file, isAnything), SizeIs(2));
}

struct Edge {
  const char* from;
  const char* to;
  bool isAllowed;
};

constexpr Edge kEdges[] = {
    {"PlatformModel", "PlatformModel", true},
    {"PlatformModel", "Logging", false},
    {"PlatformModel", "Assistant", false},
    {"Logging", "PlatformModel", true},
    {"Logging", "Assistant", false},
    {"Assistant", "Logging", true},
    {"Assistant", "PlatformModel", true},
    {"Assistant", "HomePlatform", false},
    {"Assistant", "AssistantHost", false},
    {"HomePlatform", "PlatformModel", true},
    {"HomePlatform", "Assistant", false},
    {"HomePlatform", "Logging", false},
    {"HomePlatform", "AssistantHost", false},
    {"AssistantHost", "HomePlatform", true},
    {"AssistantHost", "PlatformModel", true},
    {"AssistantHost", "Assistant", false},
    {"AssistantHost", "nidus", false},
    {"nidus", "AssistantHost", true},
    {"nidus", "HomePlatform", true},
    {"nidus", "PlatformModel", true},
    {"nidus", "Assistant", false},
    {"nidus", "Logging", false},
};

TEST(IncludeRulesTest, ArrowsPointDownwardsOnly) {
  for (const Edge& edge : kEdges) {
    const std::string from = edge.from;
    const std::string to = edge.to;
    const auto found = violationsOf(from + "/A.cpp", "#include \"" + to + "/B.h\"");
    EXPECT_EQ(found.empty(), edge.isAllowed) << from << " -> " << to;
  }
}

TEST(IncludeRulesTest, SeesEveryWayToWriteOne) {
  for (const char* line :
       {"#include <Assistant/A.h>", "#include\"Assistant/A.h\"", "  #  include \"Assistant/A.h\"",
        "#include \"Assistant/A.h\"  // for a reason"}) {
    EXPECT_THAT(violationsOf("nidus/A.cpp", line), SizeIs(1)) << line;
  }
}

TEST(IncludeRulesTest, OverlooksWhatIsNoInclude) {
  for (const char* line : {"// #include \"Assistant/A.h\"", "const char* a = \"#include <CLI/A>\";",
                           "#define include \"Assistant/A.h\"", ""}) {
    EXPECT_THAT(violationsOf("nidus/A.cpp", line), IsEmpty()) << line;
  }
}

TEST(IncludeRulesTest, LibrariesStayInTheirAdapters) {
  EXPECT_THAT(violationsOf("HomePlatform/Store/A.cpp", "#include <sqlite3.h>"), IsEmpty());
  EXPECT_THAT(violationsOf("HomePlatform/Json/A.cpp", "#include <nlohmann/json.hpp>"), IsEmpty());
  EXPECT_THAT(violationsOf("nidus/A.cpp", "#include <CLI/CLI.hpp>"), IsEmpty());
  EXPECT_THAT(violationsOf("HomePlatform/Objects/A.cpp", "#include <sqlite3.h>"),
              ElementsAre("HomePlatform/Objects/A.cpp:1: "
                          "headers of SQLite belong into HomePlatform/Store/"));
  EXPECT_THAT(violationsOf("nidus/A.cpp", "#include <nlohmann/json.hpp>"), SizeIs(1));
  EXPECT_THAT(violationsOf("AssistantHost/A.cpp", "#include \"CLI/App.hpp\""), SizeIs(1));
}

TEST(IncludeRulesTest, HeadersShowNoLibrary) {
  EXPECT_THAT(violationsOf("HomePlatform/Json/A.h", "#include <nlohmann/json_fwd.hpp>"),
              ElementsAre("HomePlatform/Json/A.h:1: "
                          "headers of nlohmann-json belong into source files"));
  EXPECT_THAT(violationsOf("HomePlatform/Store/A.h", "#include \"sqlite3.h\""), SizeIs(1));
  EXPECT_THAT(violationsOf("nidus/A.h", "#include <CLI/CLI.hpp>"), SizeIs(1));
}

TEST(IncludeRulesTest, PluginUsesStandardLibraryAlone) {
  EXPECT_THAT(violationsOf("Assistant/A.cpp", "#include <vector>"), IsEmpty());
  EXPECT_THAT(violationsOf("Assistant/A.cpp", "#include <unistd.h>"), SizeIs(1));
  EXPECT_THAT(violationsOf("Logging/A.h", "#include <syslog.h>"), SizeIs(1));
  EXPECT_THAT(violationsOf("HomePlatform/A.cpp", "#include <unistd.h>"), IsEmpty());
}

TEST(IncludeRulesTest, ProjectHeadersMustExist) {
  const auto isNothing = [](std::string_view) { return false; };
  const SourceFile file = {"nidus/A.cpp", {"#include \"nidus/Missing.h\"", "#include <vector>"}};
  EXPECT_THAT(includeViolations(file, isNothing),
              ElementsAre("nidus/A.cpp:1: there is no nidus/Missing.h"));
}

TEST(IncludeRulesTest, PathsBeginBelowSources) {
  EXPECT_THAT(violationsOf("nidus/A.cpp", "#include \"A.h\""), SizeIs(1));
  EXPECT_THAT(violationsOf("nidus/A.cpp", "#include \"../nidus/A.h\""), SizeIs(1));
}

TEST(IncludeRulesTest, EveryFolderHasItsLayer) {
  EXPECT_THAT(violationsOf("Helpers/A.cpp", "#include <vector>"),
              ElementsAre("Helpers/A.cpp:1: the folder Helpers has no layer"));
}

namespace fs = std::filesystem;

SourceFile readSourceFile(const fs::path& path) {
  SourceFile file{path.lexically_relative(NIDUS_SOURCES).generic_string(), {}};
  std::ifstream stream(path);
  for (std::string line; std::getline(stream, line);) file.lines.push_back(line);
  return file;
}

TEST(SourcesTest, KeepToTheLayers) {
  const auto exists = [](std::string_view path) {
    return fs::exists(fs::path(NIDUS_SOURCES) / path);
  };
  std::size_t files = 0;
  std::vector<std::string> found;
  for (const auto& entry : fs::recursive_directory_iterator(NIDUS_SOURCES)) {
    const std::string extension = entry.path().extension();
    if (extension != ".cpp" && extension != ".h") continue;
    const auto violations = includeViolations(readSourceFile(entry.path()), exists);
    found.insert(found.end(), violations.begin(), violations.end());
    ++files;
  }
  EXPECT_GT(files, 100U);
  EXPECT_THAT(found, IsEmpty());
}

}  // namespace
}  // namespace nidus
