#pragma once

#include <string>
#include <string_view>

#include "HomePlatform/Result.h"
#include "nidus/ExitStatus.h"

namespace nidus {

/// Writes `text` to standard output, past any buffer, so that a reader has it when this returns.
/// A failure, as the platform's, says what standard output answered.
[[nodiscard]] Status writeOutput(std::string_view text);

/// Writes all of `text` to an open file; false, with the reason in `errno`, when that fails.
[[nodiscard]] bool writeWhole(int file, std::string_view text);

/// Writes `text` to standard output; success, or the status of the failure, which is reported.
ExitStatus printText(std::string_view text);

/// Writes one line about `failure` to standard error and gives the exit status that it stands for.
ExitStatus report(const Failure& failure);

/// Writes one line to standard error.
void reportLine(std::string_view message);

/// While it lives, the lines on standard error say where the input they are about stands, such as
/// "line 3: ". One at a time; the lines may come from any thread.
class ReportPlace {
 public:
  explicit ReportPlace(std::string place);
  ~ReportPlace();
  ReportPlace(const ReportPlace&) = delete;
  ReportPlace& operator=(const ReportPlace&) = delete;
};

}  // namespace nidus
