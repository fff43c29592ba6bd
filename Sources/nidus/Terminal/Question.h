#pragma once

#include <string>

namespace nidus {

/// Whether somebody is there to be asked: standard input and standard error are a terminal.
[[nodiscard]] bool canAsk();

/// What a question takes an empty answer for.
enum class EmptyAnswer { no, yes };

/// Asks on standard error and waits for one line of standard input. "y" and "yes" in either case
/// are a yes, nothing but white space is what `empty` says, all else and the end of the input are a
/// no. An interrupt that ends the program meanwhile leaves `lastWords`, if there are any, as a line
/// on standard error.
[[nodiscard]] bool ask(const std::string& question, EmptyAnswer empty = EmptyAnswer::no,
                       const std::string& lastWords = "");

}  // namespace nidus
