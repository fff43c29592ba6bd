#pragma once

#include <sys/resource.h>

#include <cstddef>

namespace nidus {

/// While it lives, this process can open `spare` more files, sockets and the like and no others.
/// Used while no other thread opens any.
class FileShortage {
 public:
  explicit FileShortage(std::size_t spare = 0);
  ~FileShortage();
  FileShortage(const FileShortage&) = delete;
  FileShortage& operator=(const FileShortage&) = delete;

 private:
  rlimit usual_{};
};

}  // namespace nidus
