#include "nidus/Commands/HomeInput.h"

#include <array>
#include <cstdint>
#include <filesystem>
#include <iostream>
#include <iterator>
#include <streambuf>
#include <system_error>

#include "AssistantHost/InputFile.h"
#include "HomePlatform/Store/HomeDocument.h"
#include "nidus/Terminal/Progress.h"

namespace nidus {
namespace {

std::string counted(std::size_t count, const std::string& one, const std::string& many) {
  return std::to_string(count) + ' ' + (count == 1 ? one : many);
}

/// Passes on what it reads from another buffer and tells how far it is.
class CountingBuffer final : public std::streambuf {
 public:
  CountingBuffer(std::streambuf& source, Progress& progress)
      : source_(source), progress_(progress) {}

 protected:
  int_type underflow() override {
    const std::streamsize size = source_.sgetn(block_.data(), std::ssize(block_));
    if (size <= 0) return traits_type::eof();
    readBytes_ += static_cast<std::size_t>(size);
    progress_.reach(readBytes_);
    setg(block_.data(), block_.data(), block_.data() + size);
    return traits_type::to_int_type(block_.front());
  }

 private:
  std::streambuf& source_;
  Progress& progress_;
  std::array<char, 65536> block_ = {};
  std::size_t readBytes_ = 0;
};

/// How to show the reading of a file; of one whose size nobody knows nothing is shown.
Work readingOf(const std::string& file) {
  constexpr std::size_t kMegabyte = 1'000'000;
  std::error_code error;
  const std::uintmax_t bytes = std::filesystem::file_size(file, error);
  const std::size_t size = error ? 0 : bytes;
  return {"Reading", size, std::to_string(size / kMegabyte) + " MB", kMegabyte};
}

}  // namespace

Result<std::vector<HomeData>> readHomes(const std::string& file) {
  if (file == "-") return readHomeDocument(std::cin, "standard input");
  auto in = openInput(file);
  if (!in) return in.failure();
  Progress progress(readingOf(file));
  CountingBuffer buffer(*in->rdbuf(), progress);
  std::istream counted(&buffer);
  return readHomeDocument(counted, file);
}

std::size_t accessoriesOf(const std::vector<HomeData>& homes) {
  std::size_t accessories = 0;
  for (const HomeData& home : homes) accessories += home.accessories.size();
  return accessories;
}

std::string accessoriesText(std::size_t accessories) {
  return counted(accessories, "accessory", "accessories");
}

std::string sizeOf(const std::vector<HomeData>& homes) {
  std::size_t rooms = 0;
  std::size_t services = 0;
  for (const HomeData& home : homes) {
    rooms += home.rooms.size();
    for (const AccessoryData& accessory : home.accessories) services += accessory.services.size();
  }
  return counted(homes.size(), "home", "homes") + ", " + counted(rooms, "room", "rooms") + ", " +
         accessoriesText(accessoriesOf(homes)) + ", " + counted(services, "service", "services");
}

}  // namespace nidus
