#pragma once

#include <string>

// Of the parser of arguments.
namespace CLI {  // NOLINT(readability-identifier-naming)
class App;
class ParseError;
}  // namespace CLI

namespace nidus {

/// What is wrong with the arguments that `program` could not read, such as "there is no command
/// gett". A word that nothing is declared for comes before what is missing because of it.
struct UsageError {
  std::string reason = {};
  std::string meant = {};  ///< What the person most likely meant instead, such as "get"; may be "".
  std::string command =
      {};  ///< The command that the arguments led to, such as " home add"; may be "".
};

[[nodiscard]] UsageError usageErrorOf(const CLI::App& program, const CLI::ParseError& error);

}  // namespace nidus
