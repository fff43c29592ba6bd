#include "Module/ExportedSymbols.h"

#include <elf.h>

#include <algorithm>
#include <cstring>
#include <stdexcept>

#include "Support/TestFolder.h"

namespace nidus {
namespace {

/// A copy of the record at `offset` of a file's content.
template <class Record>
Record recordAt(const std::string& content, std::size_t offset) {
  if (offset > content.size() || content.size() - offset < sizeof(Record)) {
    throw std::runtime_error("the file is cut short");
  }
  Record record;
  std::memcpy(&record, content.data() + offset, sizeof(Record));
  return record;
}

Elf64_Ehdr headerOf(const std::string& content) {
  const auto header = recordAt<Elf64_Ehdr>(content, 0);
  if (std::memcmp(header.e_ident, ELFMAG, SELFMAG) != 0 || header.e_ident[EI_CLASS] != ELFCLASS64) {
    throw std::runtime_error("not a 64-bit ELF file");
  }
  return header;
}

Elf64_Shdr sectionAt(const std::string& content, std::size_t index) {
  const Elf64_Ehdr header = headerOf(content);
  return recordAt<Elf64_Shdr>(content, header.e_shoff + index * header.e_shentsize);
}

Elf64_Shdr dynamicSymbolTable(const std::string& content) {
  const std::size_t count = headerOf(content).e_shnum;
  for (std::size_t index = 0; index < count; ++index) {
    const Elf64_Shdr section = sectionAt(content, index);
    if (section.sh_type == SHT_DYNSYM) return section;
  }
  throw std::runtime_error("the file has no dynamic symbols");
}

bool isExported(const Elf64_Sym& symbol) {
  return symbol.st_shndx != SHN_UNDEF && ELF64_ST_BIND(symbol.st_info) != STB_LOCAL;
}

}  // namespace

std::vector<std::string> exportedSymbols(const std::string& file) {
  const std::string content = contentOfFile(file);
  const Elf64_Shdr table = dynamicSymbolTable(content);
  const std::size_t texts = sectionAt(content, table.sh_link).sh_offset;
  std::vector<std::string> names;
  for (std::size_t place = 0; place < table.sh_size; place += sizeof(Elf64_Sym)) {
    const auto symbol = recordAt<Elf64_Sym>(content, table.sh_offset + place);
    if (isExported(symbol)) names.emplace_back(content.c_str() + texts + symbol.st_name);
  }
  std::sort(names.begin(), names.end());
  return names;
}

}  // namespace nidus
