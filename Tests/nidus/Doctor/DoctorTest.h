#pragma once

#include <gmock/gmock.h>

#include <string>
#include <utility>
#include <vector>

#include "nidus/Doctor/Checks.h"

namespace nidus {

/// A finding that needs attention: where it is, and what it says and advises as "message; remedy".
MATCHER_P2(NeedsAttention, place, text, "") {
  return arg.severity == Severity::attention &&
         ::testing::ExplainMatchResult(::testing::HasSubstr(place), arg.place, result_listener) &&
         ::testing::ExplainMatchResult(text, arg.message + "; " + arg.remedy, result_listener);
}

/// The same of a note.
MATCHER_P2(IsNote, place, text, "") {
  return arg.severity == Severity::note &&
         ::testing::ExplainMatchResult(::testing::HasSubstr(place), arg.place, result_listener) &&
         ::testing::ExplainMatchResult(text, arg.message + "; " + arg.remedy, result_listener);
}

/// Shows a finding in the output of a test.
void PrintTo(const Finding& finding, std::ostream* out);

/// Runs one check on what a test has put together: an installation in which all is well, with no
/// homes, to begin with.
class DoctorCheckTest : public ::testing::Test {
 protected:
  using Check = void (*)(const Examination&, Findings&);

  DoctorCheckTest();
  [[nodiscard]] Findings findingsOf(Check check) const;
  /// The homes of a document's "homes", in JSON.
  void setHomes(const std::string& homes);
  /// Adds entries to the words in use: the text of a vocabulary file.
  void addWords(const std::string& vocabulary);

  Examination examination_;
};

}  // namespace nidus
