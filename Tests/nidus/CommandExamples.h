#pragma once

#include <string>
#include <vector>

namespace nidus {

/// An order of the document of commands, run in its turn.
struct CommandExample {
  std::string text;               ///< What it shows, before the order.
  std::vector<std::string> line;  ///< The arguments after "nidus".
  std::string input = {};         ///< Its standard input.
};

/// A heading of the document with what stands below it.
struct CommandChapter {
  std::string title;
  std::string text;
  std::vector<CommandExample> examples;
};

/// The chapters of the document of commands. The orders run one after the other on the
/// demonstration home and on `workshopHome`.
[[nodiscard]] std::vector<CommandChapter> commandChapters();

/// A document of one home whose devices do not do what they are told.
[[nodiscard]] std::string workshopHome();

}  // namespace nidus
