#pragma once

#include <gtest/gtest.h>

#include <memory>
#include <string>
#include <vector>

#include "HomePlatform/Metadata/VocabularyReader.h"
#include "PlatformModel/Assistant/VAHAConstants.h"
#include "nidus/Answers/Answer.h"

namespace nidus {

/// One object's part of a reply.
struct ResultSpec {
  std::string name;
  std::string outcome = std::string(VAHAActionOutcomeSUCCESSValue);
  NDDictionary value = {};
  std::string room = "Kitchen";
  std::string home = "Cabin";
  std::string type = "LIGHT";
};

/// Values in dictionary form.
[[nodiscard]] NDDictionary booleanForm(bool value);
[[nodiscard]] NDDictionary integerForm(std::int64_t value, const char* units = nullptr);
[[nodiscard]] NDDictionary floatForm(float value, const char* units = nullptr);

/// A reply that succeeds when there are results, and finds nothing otherwise.
[[nodiscard]] NDDictionary replyOf(const std::vector<ResultSpec>& results);
[[nodiscard]] NDDictionary emptyReply(std::string_view outcome);

/// An order for one command, which carries `value`, or for three when it asks for limits.
[[nodiscard]] Order orderOf(Order::Kind kind, const std::string& attribute = "POWER",
                            VAHAValueRef value = nullptr);

/// Texts of answers, as in a pipe.
class AnswerTest : public ::testing::Test {
 protected:
  [[nodiscard]] std::string answer(const Order& order, const std::vector<Replies>& replies,
                                   const TerminalStyle& style = {}) const {
    return answerText(order, replies, vocabulary_, style);
  }
  /// The last line of the answer to a command with this reply.
  [[nodiscard]] std::string sentence(const Order& order, const NDDictionary& reply) const;

 private:
  const Vocabulary vocabulary_ = builtInVocabulary();
};

}  // namespace nidus
