#include "nidus/Shell/LineEditor.h"

#include <histedit.h>

#include <algorithm>
#include <clocale>
#include <cstddef>
#include <cstdio>
#include <utility>

#include "nidus/StandardStreams.h"
#include "nidus/Terminal/Terminal.h"
#include "nidus/Terminal/TextColumns.h"

namespace nidus {
namespace {

constexpr int kLinesToGoBack = 1000;

EditLine* makeEditor() {
  // Names are UTF-8 whatever the user's locale; the library reads characters, not bytes.
  std::setlocale(LC_CTYPE, "C.UTF-8");
  return el_init("nidus", stdin, stdout, stderr);
}

/// How many characters `text`, UTF-8, has.
int charactersIn(std::string_view text) {
  return static_cast<int>(std::count_if(text.begin(), text.end(), [](char c) {
    return (static_cast<unsigned char>(c) & 0xc0U) != 0x80U;
  }));
}

}  // namespace

/// The library's side: its functions find their way back through the client data.
class LineEditor::Terminal {
 public:
  Terminal(std::string prompt, Completer completer)
      : prompt_(std::move(prompt)),
        completer_(std::move(completer)),
        history_(history_init(), history_end),
        editor_(makeEditor(), el_end) {
    HistEvent event{};
    history(history_.get(), &event, H_SETSIZE, kLinesToGoBack);
    history(history_.get(), &event, H_SETUNIQUE, 1);
    set(EL_CLIENTDATA, this);
    // A terminal that changes its size is drawn anew; one that goes away is left as it was.
    set(EL_SIGNAL, 1);
    set(EL_PROMPT, &Terminal::prompt);
    set(EL_EDITOR, "emacs");
    set(EL_HIST, &::history, history_.get());
    // The library keeps wide texts as they are; of others it keeps copies that it never frees.
    el_wset(editor_.get(), EL_ADDFN, L"nidus-complete", L"Complete the word", &Terminal::complete);
    el_wset(editor_.get(), EL_ADDFN, L"nidus-discard", L"Throw the line away", &Terminal::discard);
    set(EL_BIND, "^I", "nidus-complete", nullptr);
    set(EL_BIND, "^R", "em-inc-search-prev", nullptr);
    // Only while a line is edited: during an order the key still interrupts.
    set(EL_SETTY, "-d", "-isig", nullptr);
    set(EL_BIND, "^C", "nidus-discard", nullptr);
  }

  void remember(const std::string& line) {
    HistEvent event{};
    history(history_.get(), &event, H_ENTER, line.c_str());
  }

  std::optional<std::string> readLine() {
    isDiscarded_ = false;
    // Before the prompt invites a key that the terminal would still take for a signal or an end.
    set(EL_PREP_TERM, 1);
    int size = 0;
    const char* read = el_gets(editor_.get(), &size);
    if (isDiscarded_) return "";
    if (!read || size <= 0) return std::nullopt;
    std::string line(read, static_cast<std::size_t>(size));
    while (!line.empty() && (line.back() == '\n' || line.back() == '\r')) line.pop_back();
    return line;
  }

 private:
  template <typename... Arguments>
  void set(int operation, Arguments... arguments) {
    el_set(editor_.get(), operation, arguments...);
  }

  static Terminal& of(EditLine* editor) {
    void* data = nullptr;
    el_get(editor, EL_CLIENTDATA, &data);
    return *static_cast<Terminal*>(data);
  }

  static char* prompt(EditLine* editor) { return of(editor).prompt_.data(); }

  static unsigned char complete(EditLine* editor, int) {
    const LineInfo* typed = el_line(editor);
    const std::string_view line(typed->buffer,
                                static_cast<std::size_t>(typed->cursor - typed->buffer));
    const LineCompletion completion = of(editor).completer_(line);
    if (!completion.choices.empty()) {
      static_cast<void>(
          writeOutput('\n' + inColumns(completion.choices, standardOutputStyle().columns)));
      return CC_REDISPLAY;
    }
    if (completion.text.empty()) return CC_REFRESH_BEEP;
    const std::string_view replaced = line.substr(line.size() - completion.replaced);
    el_deletestr(editor, charactersIn(replaced));
    el_insertstr(editor, completion.text.c_str());
    return CC_REFRESH;
  }

  static unsigned char discard(EditLine* editor, int) {
    of(editor).isDiscarded_ = true;
    static_cast<void>(writeOutput("^C\n"));
    return CC_NEWLINE;
  }

  std::string prompt_;
  const Completer completer_;
  bool isDiscarded_ = false;
  const std::unique_ptr<History, decltype(&history_end)> history_;
  const std::unique_ptr<EditLine, decltype(&el_end)> editor_;
};

LineEditor::LineEditor(std::string prompt, Completer completer)
    : terminal_(std::make_unique<Terminal>(std::move(prompt), std::move(completer))) {}

LineEditor::~LineEditor() = default;

void LineEditor::remember(const std::string& line) { terminal_->remember(line); }

std::optional<std::string> LineEditor::readLine() { return terminal_->readLine(); }

}  // namespace nidus
