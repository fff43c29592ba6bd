#pragma once

#include <filesystem>
#include <string>
#include <string_view>

namespace nidus {

/// A folder for the files of one test, removed with all that is in it.
class TestFolder {
 public:
  TestFolder();
  ~TestFolder();
  TestFolder(const TestFolder&) = delete;
  TestFolder& operator=(const TestFolder&) = delete;

  [[nodiscard]] const std::filesystem::path& path() const { return path_; }
  /// The path of a file in the folder, as text.
  [[nodiscard]] std::string file(const std::string& name) const { return (path_ / name).string(); }
  /// Makes or replaces a file and gives its path.
  std::string write(const std::string& name, std::string_view content) const;

 private:
  std::filesystem::path path_;
};

/// The content of a file; empty when it can not be read.
[[nodiscard]] std::string contentOfFile(const std::filesystem::path& file);

}  // namespace nidus
