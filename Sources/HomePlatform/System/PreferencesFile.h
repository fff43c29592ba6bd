#pragma once

#include <filesystem>
#include <string>

#include "HomePlatform/Json/JsonValue.h"
#include "HomePlatform/Result.h"

namespace nidus {

/// What a preferences file holds.
struct PreferencesContent {
  JsonValue::Object values;  ///< In the order of the file, any JSON value for each key.
  std::string text;          ///< The file itself; empty when it is missing.
};

/// The preferences as a file that a person can edit: one JSON object.
///
/// Not synchronised; several objects may stand for one file. A file that is missing holds no
/// preferences.
class PreferencesFile {
 public:
  explicit PreferencesFile(std::filesystem::path path) : path_(std::move(path)) {}

  /// Reads the file. Fails, with the place, when it is not one JSON object.
  [[nodiscard]] Result<PreferencesContent> read() const;

  /// Puts a file with `values` in its place, readable by its owner alone: whoever reads it sees the
  /// old one or the new one. Gives what was written.
  [[nodiscard]] Result<PreferencesContent> write(JsonValue::Object values) const;

  /// A text that differs when the file has been changed, as far as the file system can tell.
  [[nodiscard]] std::string stamp() const;

 private:
  const std::filesystem::path path_;
};

}  // namespace nidus
