#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <algorithm>
#include <ostream>

#include "Support/ElfFile.h"

namespace nidus {
namespace {

using testing::AllOf;
using testing::AnyOf;
using testing::Contains;
using testing::Each;
using testing::EndsWith;
using testing::HasSubstr;
using testing::IsEmpty;
using testing::Not;
using testing::StartsWith;

/// One of the binaries that an installation consists of.
struct Binary {
  const char* label;
  const char* file;
  bool isProgram;
};

void PrintTo(const Binary& binary, std::ostream* out) { *out << binary.file; }

class HardeningTest : public testing::TestWithParam<Binary> {
 protected:
  /// The flags of all entries with this tag together.
  [[nodiscard]] Elf64_Xword flags(Elf64_Sxword tag) const {
    Elf64_Xword flags = 0;
    for (const Elf64_Xword value : elf_.dynamicValues(tag)) flags |= value;
    return flags;
  }

  const ElfFile elf_{GetParam().file};
};

TEST_P(HardeningTest, LiesAtAnyAddress) {
  EXPECT_EQ(elf_.type(), ET_DYN);
  EXPECT_EQ((flags(DT_FLAGS_1) & DF_1_PIE) != 0, GetParam().isProgram);
  EXPECT_THAT(elf_.dynamicValues(DT_TEXTREL), IsEmpty());
  EXPECT_EQ(flags(DT_FLAGS) & DF_TEXTREL, 0U);
}

TEST_P(HardeningTest, IsLinkedBeforeItRunsAndThenReadOnly) {
  EXPECT_EQ(elf_.segments(PT_GNU_RELRO).size(), 1U);
  EXPECT_NE(flags(DT_FLAGS_1) & DF_1_NOW, 0U);
}

TEST_P(HardeningTest, HasNothingBothWritableAndExecutable) {
  const auto stacks = elf_.segments(PT_GNU_STACK);
  ASSERT_EQ(stacks.size(), 1U);
  EXPECT_EQ(stacks.front().p_flags & PF_X, 0U);
  for (const Elf64_Phdr& segment : elf_.segments()) {
    EXPECT_NE(segment.p_flags & (PF_W | PF_X), Elf64_Word{PF_W | PF_X});
  }
}

TEST_P(HardeningTest, FindsLibrariesBesideItself) {
  EXPECT_THAT(elf_.dynamicTexts(DT_RUNPATH), IsEmpty());  // LD_LIBRARY_PATH would come before it
  const auto paths = elf_.dynamicTexts(DT_RPATH);
  for (const std::string& path : paths) {
    EXPECT_THAT(path, AllOf(StartsWith("$ORIGIN"), Not(EndsWith(":")), Not(HasSubstr("::"))));
  }
  EXPECT_EQ(paths.empty(), std::string_view(GetParam().label) == "library");
}

/// What only some commands need, those load themselves.
TEST_P(HardeningTest, StartsWithoutRareLibraries) {
  const auto libraries = elf_.dynamicTexts(DT_NEEDED);
  EXPECT_THAT(libraries, Contains(StartsWith("libc.")));
  EXPECT_THAT(libraries, Each(Not(AnyOf(StartsWith("libedit"), StartsWith("libunistring")))));
}

TEST_P(HardeningTest, GuardsItsStack) {
  EXPECT_THAT(elf_.importedSymbols(), Contains("__stack_chk_fail"));
}

#ifdef NIDUS_IS_FORTIFIED
/// The library calls nothing that would have to be checked.
TEST_P(HardeningTest, CallsCheckedFunctions) {
  std::vector<std::string> checked = elf_.importedSymbols();
  std::erase_if(checked, [](const std::string& name) {
    return !name.starts_with("__") || !name.ends_with("_chk");
  });
  EXPECT_EQ(checked.empty(), std::string_view(GetParam().label) == "library");
  // Not vsnprintf: the standard library hands its address on where it writes a floating number.
  for (const char* unchecked : {"printf", "fprintf", "vfprintf", "sprintf", "vsprintf", "snprintf",
                                "strcpy", "strcat", "gets"}) {
    EXPECT_THAT(elf_.importedSymbols(), Not(Contains(unchecked)));
  }
}
#endif

#if defined(__GNUC__) && !defined(__clang__)
TEST_P(HardeningTest, HasOnlyUnitsThatWereBuiltSo) {
  std::vector<std::string> units = elf_.texts(".GCC.command.line");
  std::erase_if(units, [](const std::string& text) { return !text.starts_with("GNU C++"); });
  ASSERT_THAT(units, Not(IsEmpty()));
  for (const char* option : {" -fstack-protector-strong", " -fstack-clash-protection"}) {
    EXPECT_THAT(units, Each(HasSubstr(option)));
  }
#ifdef __x86_64__
  EXPECT_THAT(units, Each(HasSubstr(" -fcf-protection=full")));
#endif
}
#endif

INSTANTIATE_TEST_SUITE_P(Binaries, HardeningTest,
                         testing::Values(Binary{"program", NIDUS_PROGRAM, true},
                                         Binary{"module", NIDUS_MODULE_FILE, false},
                                         Binary{"library", NIDUS_PLATFORM_MODEL_FILE, false}),
                         [](const auto& instance) { return std::string(instance.param.label); });

}  // namespace
}  // namespace nidus
