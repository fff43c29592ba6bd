#include "nidus/Shell/HistoryFile.h"

#include <fcntl.h>
#include <sys/stat.h>

#include <cerrno>
#include <cstddef>
#include <fstream>
#include <system_error>

#include "AssistantHost/InputLines.h"
#include "HomePlatform/System/DocumentFile.h"
#include "HomePlatform/System/FileDescriptor.h"
#include "HomePlatform/System/PrivateFiles.h"
#include "nidus/FileReplacement.h"
#include "nidus/Settings.h"
#include "nidus/StandardStreams.h"

namespace nidus {
namespace {

void keepLast(std::vector<std::string>& lines) {
  if (lines.size() <= HistoryFile::kLines) return;
  lines.erase(lines.begin(), lines.end() - static_cast<std::ptrdiff_t>(HistoryFile::kLines));
}

}  // namespace

std::vector<std::string> HistoryFile::lines() const {
  std::vector<std::string> lines;
  if (!noDocumentBut(file_).empty()) return lines;
  std::ifstream in(file_);
  InputLines input(in);
  while (input.next()) {
    if (lines.size() == 2 * kLines) keepLast(lines);
    lines.push_back(input.line());
  }
  keepLast(lines);
  if (input.number() > 2 * kLines) {
    std::string text;
    for (const std::string& line : lines) text += line + '\n';
    // A history that could not be cut is as good as before.
    static_cast<void>(replaceFile(file_, text));
  }
  return lines;
}

Status HistoryFile::add(const std::string& line) const {
  // What cannot be made here shows when the file is opened.
  static_cast<void>(makePrivateFolder(file_.parent_path()));
  constexpr int kFlags = O_WRONLY | O_APPEND | O_CREAT | O_CLOEXEC | O_NONBLOCK;  // for pipes
  const FileDescriptor file(::open(file_.c_str(), kFlags, S_IRUSR | S_IWUSR));
  if (file && writeWhole(file.get(), line + '\n')) return std::nullopt;
  return Failure{Failure::Kind::platform, file_.string() + ": the history cannot be written (" +
                                              std::generic_category().message(errno) +
                                              "); mend its permissions"};
}

std::optional<std::filesystem::path> historyPath() {
  const auto folder = userFolder("XDG_STATE_HOME", ".local/state");
  if (folder.empty()) return std::nullopt;
  return folder / "history";
}

}  // namespace nidus
