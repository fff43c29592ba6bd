#pragma once

#include <elf.h>

#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace nidus {

/// A program or shared library as it lies on the disk, a 64-bit ELF file of this machine. What is
/// cut short or no such file makes each operation throw `std::runtime_error`.
class ElfFile {
 public:
  explicit ElfFile(const std::string& path);

  /// As of the header, such as ET_DYN.
  [[nodiscard]] Elf64_Half type() const { return header_.e_type; }
  /// All segments, or those of one type.
  [[nodiscard]] std::vector<Elf64_Phdr> segments() const;
  [[nodiscard]] std::vector<Elf64_Phdr> segments(Elf64_Word type) const;
  /// The values of all entries of the dynamic section with this tag, such as DT_FLAGS.
  [[nodiscard]] std::vector<Elf64_Xword> dynamicValues(Elf64_Sxword tag) const;
  /// The same for entries that are texts, such as DT_RPATH.
  [[nodiscard]] std::vector<std::string> dynamicTexts(Elf64_Sxword tag) const;
  /// The names of the symbols that the file defines for others, sorted.
  [[nodiscard]] std::vector<std::string> exportedSymbols() const;
  /// The names of the symbols that the file wants of others, sorted.
  [[nodiscard]] std::vector<std::string> importedSymbols() const;
  /// The texts of a section that holds such; none when there is no section of that name.
  [[nodiscard]] std::vector<std::string> texts(std::string_view section) const;

 private:
  template <class Record>
  [[nodiscard]] Record recordAt(std::size_t offset) const;
  template <class Record>
  [[nodiscard]] std::vector<Record> recordsOf(const Elf64_Shdr& section) const;
  [[nodiscard]] std::string textAt(std::size_t offset) const;
  [[nodiscard]] Elf64_Shdr section(std::size_t index) const;
  [[nodiscard]] std::optional<Elf64_Shdr> sectionOfType(Elf64_Word type) const;
  [[nodiscard]] std::vector<std::string> dynamicSymbols(bool isDefined) const;

  std::string content_;
  Elf64_Ehdr header_ = {};
};

}  // namespace nidus
