#pragma once

#include <cstddef>
#include <istream>
#include <string>

#include "HomePlatform/Json/JsonLimits.h"

namespace nidus {

/// Reads a text line by line, none of them before it is asked for and none longer than a limit, so
/// that input without line ends cannot fill the memory. The stream must outlive it.
///
///     InputLines lines(std::cin);
///     while (lines.next()) perform(lines.line(), lines.number());
///     if (lines.isTooLong()) …
class InputLines {
 public:
  explicit InputLines(std::istream& in, std::size_t mostBytes = kCommandLimits.documentBytes)
      : in_(in), mostBytes_(mostBytes) {}

  /// Goes to the next line; false at the end of the text, after an error of the stream, and at a
  /// line that is too long, with which the reading is over.
  bool next();
  /// The present line without its end.
  [[nodiscard]] const std::string& line() const { return line_; }
  /// Counts from 1.
  [[nodiscard]] std::size_t number() const { return number_; }
  [[nodiscard]] bool isTooLong() const { return line_.size() > mostBytes_; }
  /// What is wrong with a line that is too long, as the end of a message.
  [[nodiscard]] std::string tooLongText() const;

 private:
  std::istream& in_;
  const std::size_t mostBytes_;
  std::string line_;
  std::size_t number_ = 0;
};

}  // namespace nidus
