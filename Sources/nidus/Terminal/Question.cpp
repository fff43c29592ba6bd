#include "nidus/Terminal/Question.h"

#include <unistd.h>

#include <cctype>
#include <cerrno>
#include <optional>

#include "nidus/StandardStreams.h"

namespace nidus {
namespace {

/// The letters of the next line of standard input, in lower case; none at its end. Reads no further
/// than the line, as an editor or a second question may come after it.
std::optional<std::string> readAnswer() {
  std::string answer;
  for (char c = '\0'; c != '\n';) {
    const ssize_t count = read(STDIN_FILENO, &c, 1);
    if (count < 0 && errno == EINTR) continue;
    if (count <= 0) return std::nullopt;
    const auto byte = static_cast<unsigned char>(c);
    if (std::isspace(byte) == 0) answer += static_cast<char>(std::tolower(byte));
  }
  return answer;
}

}  // namespace

bool canAsk() { return isatty(STDIN_FILENO) == 1 && isatty(STDERR_FILENO) == 1; }

bool ask(const std::string& question, EmptyAnswer empty) {
  const std::string choice = empty == EmptyAnswer::yes ? " [Y/n] " : " [y/N] ";
  if (!writeWhole(STDERR_FILENO, onOneLine(question) + choice)) return false;
  const auto answer = readAnswer();
  if (!answer) return false;
  return answer->empty() ? empty == EmptyAnswer::yes : *answer == "y" || *answer == "yes";
}

}  // namespace nidus
