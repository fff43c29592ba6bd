#include "Support/ElfFile.h"

#include <algorithm>
#include <cstring>
#include <stdexcept>

#include "Support/TestFolder.h"

namespace nidus {

ElfFile::ElfFile(const std::string& path) : content_(contentOfFile(path)) {
  header_ = recordAt<Elf64_Ehdr>(0);
  if (std::memcmp(header_.e_ident, ELFMAG, SELFMAG) != 0 ||
      header_.e_ident[EI_CLASS] != ELFCLASS64) {
    throw std::runtime_error("not a 64-bit ELF file: " + path);
  }
}

std::vector<Elf64_Phdr> ElfFile::segments() const {
  std::vector<Elf64_Phdr> segments;
  for (std::size_t index = 0; index < header_.e_phnum; ++index) {
    segments.push_back(recordAt<Elf64_Phdr>(header_.e_phoff + index * header_.e_phentsize));
  }
  return segments;
}

std::vector<Elf64_Phdr> ElfFile::segments(Elf64_Word type) const {
  std::vector<Elf64_Phdr> found = segments();
  std::erase_if(found, [type](const Elf64_Phdr& segment) { return segment.p_type != type; });
  return found;
}

std::vector<Elf64_Xword> ElfFile::dynamicValues(Elf64_Sxword tag) const {
  const auto dynamic = sectionOfType(SHT_DYNAMIC);
  if (!dynamic) throw std::runtime_error("the file has no dynamic section");
  std::vector<Elf64_Xword> values;
  for (const auto& entry : recordsOf<Elf64_Dyn>(*dynamic)) {
    if (entry.d_tag == tag) values.push_back(entry.d_un.d_val);
  }
  return values;
}

std::vector<std::string> ElfFile::dynamicTexts(Elf64_Sxword tag) const {
  std::vector<std::string> texts;
  for (const Elf64_Xword place : dynamicValues(tag)) {
    texts.push_back(textAt(section(sectionOfType(SHT_DYNAMIC)->sh_link).sh_offset + place));
  }
  return texts;
}

std::vector<std::string> ElfFile::exportedSymbols() const { return dynamicSymbols(true); }

std::vector<std::string> ElfFile::importedSymbols() const { return dynamicSymbols(false); }

std::vector<std::string> ElfFile::texts(std::string_view name) const {
  std::vector<std::string> texts;
  const std::size_t names = section(header_.e_shstrndx).sh_offset;
  for (std::size_t index = 0; index < header_.e_shnum; ++index) {
    const Elf64_Shdr found = section(index);
    if (textAt(names + found.sh_name) != name) continue;
    for (std::size_t place = 0; place < found.sh_size; place += texts.back().size() + 1) {
      texts.push_back(textAt(found.sh_offset + place));
    }
  }
  return texts;
}

template <class Record>
Record ElfFile::recordAt(std::size_t offset) const {
  if (offset > content_.size() || content_.size() - offset < sizeof(Record)) {
    throw std::runtime_error("the file is cut short");
  }
  Record record;
  std::memcpy(&record, content_.data() + offset, sizeof(Record));
  return record;
}

template <class Record>
std::vector<Record> ElfFile::recordsOf(const Elf64_Shdr& section) const {
  std::vector<Record> records;
  for (std::size_t place = 0; place < section.sh_size; place += sizeof(Record)) {
    records.push_back(recordAt<Record>(section.sh_offset + place));
  }
  return records;
}

std::string ElfFile::textAt(std::size_t offset) const {
  const std::size_t end = content_.find('\0', offset);
  if (end == std::string::npos) throw std::runtime_error("the file is cut short");
  return content_.substr(offset, end - offset);
}

Elf64_Shdr ElfFile::section(std::size_t index) const {
  return recordAt<Elf64_Shdr>(header_.e_shoff + index * header_.e_shentsize);
}

std::optional<Elf64_Shdr> ElfFile::sectionOfType(Elf64_Word type) const {
  for (std::size_t index = 0; index < header_.e_shnum; ++index) {
    if (section(index).sh_type == type) return section(index);
  }
  return std::nullopt;
}

std::vector<std::string> ElfFile::dynamicSymbols(bool isDefined) const {
  const auto table = sectionOfType(SHT_DYNSYM);
  if (!table) throw std::runtime_error("the file has no dynamic symbols");
  const std::size_t texts = section(table->sh_link).sh_offset;
  std::vector<std::string> names;
  for (const auto& symbol : recordsOf<Elf64_Sym>(*table)) {
    if (ELF64_ST_BIND(symbol.st_info) == STB_LOCAL) continue;
    if ((symbol.st_shndx != SHN_UNDEF) == isDefined)
      names.push_back(textAt(texts + symbol.st_name));
  }
  std::sort(names.begin(), names.end());
  return names;
}

}  // namespace nidus
