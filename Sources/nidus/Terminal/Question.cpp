#include "nidus/Terminal/Question.h"

#include <unistd.h>

#include <cctype>
#include <cerrno>
#include <csignal>
#include <optional>
#include <string_view>

#include "HomePlatform/System/OneLine.h"
#include "nidus/StandardStreams.h"

namespace nidus {
namespace {

// For a handler, which sees nothing else.
struct sigaction interruptBefore = {};
std::string_view wordsAtTheEnd;

void endLineAndInterrupt(int signal) {
  static_cast<void>(writeWhole(STDERR_FILENO, "\n"));
  if (interruptBefore.sa_handler == SIG_DFL) {
    static_cast<void>(writeWhole(STDERR_FILENO, wordsAtTheEnd));
  }
  sigaction(signal, &interruptBefore, nullptr);
  raise(signal);
}

/// While it lives, an interrupt ends the line of the question, and says the last words if it ends
/// the program, before it does what it did before.
class LineEndOnInterrupt {
 public:
  explicit LineEndOnInterrupt(std::string_view lastWords) {
    wordsAtTheEnd = lastWords;
    struct sigaction ending = {};
    ending.sa_handler = endLineAndInterrupt;
    sigaction(SIGINT, nullptr, &interruptBefore);
    if (interruptBefore.sa_handler != SIG_IGN) sigaction(SIGINT, &ending, nullptr);
  }
  LineEndOnInterrupt(const LineEndOnInterrupt&) = delete;
  LineEndOnInterrupt& operator=(const LineEndOnInterrupt&) = delete;
  ~LineEndOnInterrupt() { sigaction(SIGINT, &interruptBefore, nullptr); }
};

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

bool ask(const std::string& question, EmptyAnswer empty, const std::string& lastWords) {
  const std::string choice = empty == EmptyAnswer::yes ? " [Y/n] " : " [y/N] ";
  const std::string lastLine = lastWords.empty() ? "" : "nidus: " + lastWords + '\n';
  const LineEndOnInterrupt lineEnd(lastLine);
  if (!writeWhole(STDERR_FILENO, onOneLine(question) + choice)) return false;
  const auto answer = readAnswer();
  if (!answer) {
    static_cast<void>(writeWhole(STDERR_FILENO, "\n"));
    return false;
  }
  return answer->empty() ? empty == EmptyAnswer::yes : *answer == "y" || *answer == "yes";
}

}  // namespace nidus
