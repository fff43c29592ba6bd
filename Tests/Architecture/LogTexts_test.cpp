#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <filesystem>
#include <fstream>
#include <iterator>
#include <set>

namespace nidus {
namespace {

using Texts = std::set<std::string>;

/// Puts the texts in quotes of a statement into `texts`.
void collectTexts(const std::string& statement, Texts& texts) {
  std::size_t end = 0;
  for (auto begin = statement.find('"'); begin != std::string::npos;
       begin = statement.find('"', end + 1)) {
    end = statement.find('"', begin + 1);
    ASSERT_NE(end, std::string::npos) << statement;
    texts.insert(statement.substr(begin + 1, end - begin - 1));
  }
}

/// What the statements that begin with `call` say, in all sources of the plug-in.
Texts textsOf(const std::string& call) {
  Texts texts;
  for (const auto& entry :
       std::filesystem::directory_iterator(std::filesystem::path(NIDUS_SOURCES) / "Assistant")) {
    std::ifstream stream(entry.path());
    const std::string source(std::istreambuf_iterator<char>(stream), {});
    for (auto at = source.find(call); at != std::string::npos; at = source.find(call, at + 1)) {
      collectTexts(source.substr(at, source.find(';', at) - at), texts);
    }
  }
  return texts;
}

constexpr const char kUpdate[] =
    "-[NDAssistantCommand handleUpdateActionTypes:serviceType:forObjects:completionHandler:]";

/// Whoever runs a home is promised that the log tells no more of it than these messages do.
TEST(LogTextsTest, AreThePromisedOnes) {
  EXPECT_EQ(
      textsOf("WLOLog("),
      (Texts{"%s ### Vela passed an incorrect action (%@) to a %@ value type.",
             "%s ### Vela sent an unsupported action type: %@",
             "-[NDAssistantCommand handleCommandWithCompletionHandler:]", kUpdate,
             "ActionSet action value %@ not true",
             "Attribute specified in search filter with entityType not SERVICE(%@)",
             "Filtered object %@ not a service", "Incoming Action: %@",
             "Incoming Action: %@/attribute=%@/value=%@", "Incoming Filter: %@",
             "Invalid action.attribute %@ for actionSet",
             "Multiple homes with same name but no primary home",
             "No homes configured - short-circuiting", "Update boundary error %@ for service %@/%@",
             "adjustGet: Characteristic %@ value %@  locale-adjusted to %@",
             "adjustSet: Attribute %@ value %@  locale-adjusted to %@"}));
  EXPECT_EQ(textsOf("logAtInfo("),
            (Texts{"No homes configured - short-circuiting sync", "Timed out waiting for nidusd",
                   "nidusd did not respond"}));
}

}  // namespace
}  // namespace nidus
