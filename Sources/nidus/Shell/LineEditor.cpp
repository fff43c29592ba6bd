#include "nidus/Shell/LineEditor.h"

#include <histedit.h>

#include <algorithm>
#include <clocale>
#include <cstddef>
#include <cstdio>
#include <utility>

#include "nidus/StandardStreams.h"
#include "nidus/SystemLibrary.h"
#include "nidus/Terminal/Terminal.h"
#include "nidus/Terminal/TextColumns.h"

namespace nidus {
namespace {

constexpr int kLinesToGoBack = 1000;

/// The functions of the library, which only a person's shell needs.
struct EditLibrary {
  const SystemLibrary library{NIDUS_EDIT_NAME};
  decltype(&el_init) init = library.function<decltype(el_init)>("el_init");
  decltype(&el_end) end = library.function<decltype(el_end)>("el_end");
  decltype(&el_set) set = library.function<decltype(el_set)>("el_set");
  decltype(&el_wset) wideSet = library.function<decltype(el_wset)>("el_wset");
  decltype(&el_get) get = library.function<decltype(el_get)>("el_get");
  decltype(&el_gets) gets = library.function<decltype(el_gets)>("el_gets");
  decltype(&el_line) line = library.function<decltype(el_line)>("el_line");
  decltype(&el_deletestr) erase = library.function<decltype(el_deletestr)>("el_deletestr");
  decltype(&el_insertstr) insert = library.function<decltype(el_insertstr)>("el_insertstr");
  decltype(&history_init) historyInit = library.function<decltype(history_init)>("history_init");
  decltype(&history_end) historyEnd = library.function<decltype(history_end)>("history_end");
  decltype(&::history) history = library.function<decltype(::history)>("history");
};

const EditLibrary& editLibrary() {
  static const EditLibrary kLibrary;
  return kLibrary;
}

EditLine* makeEditor() {
  // Names are UTF-8 whatever the user's locale; the library reads characters, not bytes.
  std::setlocale(LC_CTYPE, "C.UTF-8");
  return editLibrary().init("nidus", stdin, stdout, stderr);
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
        history_(edit_.historyInit(), edit_.historyEnd),
        editor_(makeEditor(), edit_.end) {
    HistEvent event{};
    edit_.history(history_.get(), &event, H_SETSIZE, kLinesToGoBack);
    edit_.history(history_.get(), &event, H_SETUNIQUE, 1);
    set(EL_CLIENTDATA, this);
    // A terminal that changes its size is drawn anew; one that goes away is left as it was.
    set(EL_SIGNAL, 1);
    set(EL_PROMPT, &Terminal::prompt);
    set(EL_EDITOR, "emacs");
    set(EL_HIST, edit_.history, history_.get());
    // The library keeps wide texts as they are; of others it keeps copies that it never frees.
    edit_.wideSet(editor_.get(), EL_ADDFN, L"nidus-complete", L"Complete the word",
                  &Terminal::complete);
    edit_.wideSet(editor_.get(), EL_ADDFN, L"nidus-discard", L"Throw the line away",
                  &Terminal::discard);
    set(EL_BIND, "^I", "nidus-complete", nullptr);
    set(EL_BIND, "^R", "em-inc-search-prev", nullptr);
    // Only while a line is edited: during an order the key still interrupts.
    set(EL_SETTY, "-d", "-isig", nullptr);
    set(EL_BIND, "^C", "nidus-discard", nullptr);
  }

  void remember(const std::string& line) {
    HistEvent event{};
    edit_.history(history_.get(), &event, H_ENTER, line.c_str());
  }

  std::optional<std::string> readLine() {
    isDiscarded_ = false;
    // Before the prompt invites a key that the terminal would still take for a signal or an end.
    set(EL_PREP_TERM, 1);
    int size = 0;
    const char* read = edit_.gets(editor_.get(), &size);
    if (isDiscarded_) return "";
    if (!read || size <= 0) return std::nullopt;
    std::string line(read, static_cast<std::size_t>(size));
    while (!line.empty() && (line.back() == '\n' || line.back() == '\r')) line.pop_back();
    return line;
  }

 private:
  template <typename... Arguments>
  void set(int operation, Arguments... arguments) {
    edit_.set(editor_.get(), operation, arguments...);
  }

  static Terminal& of(EditLine* editor) {
    void* data = nullptr;
    editLibrary().get(editor, EL_CLIENTDATA, &data);
    return *static_cast<Terminal*>(data);
  }

  static char* prompt(EditLine* editor) { return of(editor).prompt_.data(); }

  static unsigned char complete(EditLine* editor, int) {
    const LineInfo* typed = editLibrary().line(editor);
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
    editLibrary().erase(editor, charactersIn(replaced));
    editLibrary().insert(editor, completion.text.c_str());
    return CC_REFRESH;
  }

  static unsigned char discard(EditLine* editor, int) {
    of(editor).isDiscarded_ = true;
    static_cast<void>(writeOutput("^C\n"));
    return CC_NEWLINE;
  }

  const EditLibrary& edit_ = editLibrary();
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
