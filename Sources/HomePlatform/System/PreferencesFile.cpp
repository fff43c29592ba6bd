#include "HomePlatform/System/PreferencesFile.h"

#include <fcntl.h>
#include <sys/stat.h>

#include <cerrno>
#include <cstdio>
#include <fstream>
#include <iterator>
#include <system_error>

#include "HomePlatform/Json/JsonText.h"
#include "HomePlatform/System/DocumentFile.h"
#include "HomePlatform/System/FileDescriptor.h"
#include "HomePlatform/System/FilePlacing.h"

namespace nidus {
namespace {

Failure fileFailure(const std::filesystem::path& path, const std::string& what, int error) {
  return {Failure::Kind::platform, path.string() + ": " + what + ": " +
                                       std::generic_category().message(error) +
                                       "; mend the permissions or the disk and try again"};
}

Failure contentFailure(const std::filesystem::path& path, const JsonError& error) {
  Failure failure = failureOf(error, path.string());
  failure.message += "; correct the file or remove it";
  return failure;
}

Result<PreferencesContent> parse(const std::filesystem::path& path, std::string text) {
  try {
    JsonValue document = parseJson(text, kPreferencesLimits);
    auto* values = std::get_if<JsonValue::Object>(&document.content);
    if (!values) throw JsonError{"", "expected an object of preferences"};
    return PreferencesContent{std::move(*values), std::move(text)};
  } catch (const JsonError& error) {
    return contentFailure(path, error);
  }
}

std::string textOf(const JsonValue::Object& values) {
  std::string text = "{";
  for (const JsonValue::Member& member : values) {
    text += &member == &values.front() ? "\n  " : ",\n  ";
    appendJsonText(text, member.first);
    text += ": ";
    appendJson(text, member.second);
  }
  return text + "\n}\n";
}

bool writeAll(int file, std::string_view text) {
  while (!text.empty()) {
    const ssize_t written = ::write(file, text.data(), text.size());
    if (written < 0 && errno == EINTR) continue;
    if (written < 0) return false;
    text.remove_prefix(static_cast<std::size_t>(written));
  }
  return true;
}

/// Writes `text` beside the file and puts it in its place; 0 or the error.
int replaceFile(const std::filesystem::path& path, std::string_view text) {
  std::string temporary = path.string() + ".XXXXXX";
  const FileDescriptor file(::mkostemp(temporary.data(), O_CLOEXEC));  // owner-only from the start
  if (!file) return errno;
  const int error = writeAll(file.get(), text) ? putInPlace(temporary, path) : errno;
  if (error != 0) ::unlink(temporary.c_str());
  return error;
}

}  // namespace

Result<PreferencesContent> PreferencesFile::read() const {
  if (const std::string kind = noDocumentBut(path_); !kind.empty()) {
    return Failure{
        Failure::Kind::platform,
        path_.string() + ": " + kind + " is where the preferences have to be; move it away"};
  }
  errno = 0;
  std::ifstream file(path_, std::ios::binary);
  if (!file) {
    const int error = errno;
    if (error == ENOENT) return PreferencesContent();
    return fileFailure(path_, "the preferences cannot be read", error);
  }
  std::string text;
  char block[4096];
  while (file.read(block, sizeof block) || file.gcount() > 0) {
    text.append(block, static_cast<std::size_t>(file.gcount()));
    if (text.size() > kPreferencesLimits.documentBytes) break;  // the parser says so
  }
  if (file.bad()) return fileFailure(path_, "the preferences cannot be read", EIO);
  return parse(path_, std::move(text));
}

Result<PreferencesContent> PreferencesFile::write(JsonValue::Object values) const {
  std::string text = textOf(values);
  if (const int error = replaceFile(path_, text)) {
    return fileFailure(path_, "the preferences cannot be written", error);
  }
  return PreferencesContent{std::move(values), std::move(text)};
}

std::string PreferencesFile::stamp() const {
  struct stat status = {};
  if (::stat(path_.c_str(), &status) != 0) return {};
  std::string stamp;
  for (const auto part :
       {static_cast<std::int64_t>(status.st_ino), static_cast<std::int64_t>(status.st_size),
        static_cast<std::int64_t>(status.st_mtim.tv_sec), std::int64_t{status.st_mtim.tv_nsec},
        static_cast<std::int64_t>(status.st_ctim.tv_sec), std::int64_t{status.st_ctim.tv_nsec}}) {
    stamp += std::to_string(part) + ' ';
  }
  return stamp;
}

}  // namespace nidus
