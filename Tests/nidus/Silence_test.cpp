#include "nidus/ProgramTest.h"

namespace nidus {
namespace {

using ::testing::HasSubstr;
using ::testing::Not;

/// Two values that occur nowhere else: a number in its range, and one that nothing may be set to.
constexpr const char* kValue = "73.125";
constexpr const char* kOddValue = "918273.5";

std::string characteristic(const std::string& number, const std::string& kind,
                           const std::string& value) {
  return R"({"instanceID": )" + number +
         R"(, "characteristicType": "com.corvane.nidus.characteristic.)" + kind +
         R"(", "properties": ["readable", "writable"], "value": )" + value +
         R"(, "metadata": {"format": "float", "minimumValue": 0, "maximumValue": 100}})";
}

/// A home whose values are these.
std::string markedHome() {
  return R"({"uuid": "AA00AA00-0000-4000-8000-000000000001", "name": "Cottage", "primary": true,
      "accessories": [{"uuid": "DD00DD00-0000-4000-8000-000000000001", "name": "Lamp",
        "services": [{"instanceID": 8, "name": "Lamp",
          "serviceType": "com.corvane.nidus.service.light", "characteristics": [)" +
         characteristic("9", "brightness", kValue) + "," + characteristic("10", "hue", kOddValue) +
         "]}]}]}";
}

/// All that the program says beside its answers, with every message of the log.
class SilenceTest : public ProgramTest {
 protected:
  void SetUp() override {
    import(documentOf({markedHome()}));
    for (const char* key : {"NidusLogLevel", "NidusDeveloperLogLevel"}) {
      ASSERT_EQ(run({"preferences", "set", key, "7"}).exitStatus, 0);
    }
    ASSERT_EQ(run({"preferences", "set", "InternalBuild", "true"}).exitStatus, 0);
  }
  void expectSilence(const std::vector<std::string>& arguments, const std::string& input = "") {
    const ProgramEnd end = run(arguments, input);
    EXPECT_EQ(end.signal, 0);
    EXPECT_THAT(end.errors, Not(HasSubstr(kValue))) << arguments.front();
    EXPECT_THAT(end.errors, Not(HasSubstr(kOddValue))) << arguments.front();
  }
};

TEST_F(SilenceTest, KeepsValuesThatWereAskedFor) {
  const ProgramEnd end = run({"get", "brightness"});
  EXPECT_THAT(end.output, HasSubstr("73 %"));
  EXPECT_THAT(end.errors, HasSubstr("Incoming Action: GET"));
  for (const char* attribute : {"brightness", "hue"}) {
    expectSilence({"get", attribute});
    expectSilence({"limits", attribute});
    expectSilence({"explain", "get", attribute});
  }
}

TEST_F(SilenceTest, KeepsValuesThatAreChanged) {
  for (const char* attribute : {"brightness", "hue"}) {
    expectSilence({"toggle", attribute});
    expectSilence({"set", attribute, "maximum"});
    expectSilence({"set", attribute, "999999999"});
    expectSilence({"set", attribute, "4"});
  }
}

TEST_F(SilenceTest, KeepsValuesThatAreShown) {
  for (const char* command : {"records", "sync", "doctor"}) expectSilence({command});
  expectSilence({"home", "show"});
  expectSilence({"home", "export"});
  expectSilence({"home", "rename", "Lamp", "Light"});
  expectSilence({"shell"}, "get brightness\nget hue\nexplain get hue\n");
}

TEST_F(SilenceTest, KeepsValuesThatAreRefused) {
  std::string document = documentOf({markedHome()});
  const std::string sound = std::string(R"("value": )") + kValue;
  document.replace(document.find(sound), sound.size(), std::string(R"("value": ")") + kValue + '"');
  const std::string file = folder_.write("refused.json", document);
  EXPECT_THAT(run({"home", "import", file}).errors,
              HasSubstr("/characteristics/0/value: expected"));
  expectSilence({"home", "import", file});
}

}  // namespace
}  // namespace nidus
