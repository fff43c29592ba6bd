#include "HomePlatform/Metadata/VocabularyWriter.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <sstream>
#include <string_view>

#include "HomePlatform/Metadata/VocabularyReader.h"

namespace nidus {

extern const std::string_view kVocabularyDocument;

namespace {

std::string textOf(const Vocabulary& vocabulary) {
  std::ostringstream out;
  writeVocabulary(out, vocabulary);
  return out.str();
}

TEST(VocabularyWriterTest, WritesWhatReadsBackTheSame) {
  const std::string text = textOf(builtInVocabulary());
  const auto again = mergeVocabulary({}, text, "again.json");
  ASSERT_TRUE(again);
  EXPECT_EQ(again->characteristics.size(), builtInVocabulary().characteristics.size());
  EXPECT_EQ(textOf(*again), text);
}

TEST(BuiltInVocabularyTest, HasWhatItsDocumentSays) {
  const auto read = mergeVocabulary({}, kVocabularyDocument, "vocabulary.json");
  ASSERT_TRUE(read) << read.failure().message;
  EXPECT_EQ(textOf(builtInVocabulary()), textOf(*read));
}

TEST(VocabularyWriterTest, WritesAllOfAnEntry) {
  const std::string entry =
      R"({"assistantName": "A", "read": "r", "write": "w", "valueType": "int", "unit": "u", )"
      R"("localized": true, "follows": true, "values": [{"assistant": "ON", "platform": 1.5}]})";
  const std::string document =
      "{\"format\": \"nidus-vocabulary/1\",\n  \"characteristics\": [\n    " + entry + "\n  ]}\n";
  const auto vocabulary = mergeVocabulary({}, document, "mine.json");
  ASSERT_TRUE(vocabulary);
  EXPECT_EQ(textOf(*vocabulary), document);
}

TEST(VocabularyWriterTest, WritesNoListOfNothing) {
  EXPECT_EQ(textOf({}), "{\"format\": \"nidus-vocabulary/1\"}\n");
}

}  // namespace
}  // namespace nidus
