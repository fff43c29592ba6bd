#include "Support/TestFolder.h"

#include <cstdlib>
#include <fstream>
#include <iterator>
#include <stdexcept>
#include <system_error>

namespace nidus {

TestFolder::TestFolder() {
  std::string name = (std::filesystem::temp_directory_path() / "nidus-test-XXXXXX").string();
  if (!mkdtemp(name.data())) throw std::runtime_error("no folder for the test: " + name);
  path_ = name;
}

TestFolder::~TestFolder() {
  std::error_code ignored;
  std::filesystem::remove_all(path_, ignored);
}

std::string TestFolder::write(const std::string& name, std::string_view content) const {
  std::ofstream(path_ / name, std::ios::binary) << content;
  return file(name);
}

std::string contentOfFile(const std::filesystem::path& file) {
  std::ifstream in(file, std::ios::binary);
  return {std::istreambuf_iterator<char>(in), std::istreambuf_iterator<char>()};
}

}  // namespace nidus
