#include "nidus/ProgramTest.h"

namespace nidus {
namespace {

using ::testing::AllOf;
using ::testing::HasSubstr;
using ::testing::IsEmpty;
using ::testing::Not;
using ::testing::StartsWith;

class VocabularyTest : public ProgramTest {};

TEST_F(VocabularyTest, ListsAllWords) {
  const ProgramEnd end = run({"vocabulary"});
  EXPECT_EQ(end.exitStatus, 0);
  EXPECT_THAT(end.output, AllOf(HasSubstr("BRIGHTNESS"), HasSubstr("THERMOSTAT")));
  EXPECT_THAT(end.errors, IsEmpty());
}

TEST_F(VocabularyTest, ShowsOneWord) {
  const ProgramEnd end = run({"vocabulary", "brightness"});
  EXPECT_EQ(end.exitStatus, 0);
  EXPECT_THAT(end.output, StartsWith("BRIGHTNESS - an attribute\n"));
  EXPECT_THAT(end.output, Not(HasSubstr("POWER")));
}

TEST_F(VocabularyTest, KnowsWordsOfTheUser) {
  const TestFolder folder;
  folder.write("vocabulary.json", R"({"format": "nidus-vocabulary/1",
      "services": [{"assistantName": "SAUNA", "serviceType": "my.sauna"}]})");
  const ProgramEnd end = runProgram({{"--data", folder.path().string(), "vocabulary", "sauna"}});
  EXPECT_EQ(end.exitStatus, 0);
  EXPECT_THAT(end.output, HasSubstr("my.sauna"));
}

TEST_F(VocabularyTest, WritesADocumentThatIsTaken) {
  const ProgramEnd end = run({"vocabulary", "--json"});
  EXPECT_EQ(end.exitStatus, 0);
  const TestFolder folder;
  folder.write("vocabulary.json", end.output);
  const ProgramEnd again = runProgram({{"--data", folder.path().string(), "vocabulary", "--json"}});
  EXPECT_EQ(again.exitStatus, 0) << again.errors;
  EXPECT_EQ(again.output, end.output);
}

TEST_F(VocabularyTest, RefusesAWordThatThereIsNot) {
  const ProgramEnd end = run({"vocabulary", "xyzzy", "--json"});
  EXPECT_EQ(end.exitStatus, 2);
  EXPECT_THAT(end.output, IsEmpty());
  EXPECT_THAT(end.errors, IsOneFailure("xyzzy: no word of the vocabulary contains this"));
}

TEST_F(VocabularyTest, SuggestsANearMiss) {
  EXPECT_THAT(run({"vocabulary", "brigtness"}).errors, HasSubstr("did you mean BRIGHTNESS?"));
  EXPECT_THAT(run({"vocabulary", "thermosat"}).errors, HasSubstr("did you mean THERMOSTAT?"));
}

}  // namespace
}  // namespace nidus
