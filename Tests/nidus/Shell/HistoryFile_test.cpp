#include "nidus/Shell/HistoryFile.h"

#include <gmock/gmock.h>

#include "Support/FileModes.h"
#include "Support/TestFolder.h"

namespace nidus {
namespace {

using ::testing::ElementsAre;
using ::testing::HasSubstr;
using ::testing::IsEmpty;
using ::testing::SizeIs;

TEST(HistoryFileTest, KeepsLinesInOrder) {
  const TestFolder folder;
  const HistoryFile history(folder.file("state/nidus/history"));
  EXPECT_THAT(history.lines(), IsEmpty());
  EXPECT_FALSE(history.add("home show"));
  EXPECT_FALSE(history.add("run 'Soirée'"));
  EXPECT_THAT(history.lines(), ElementsAre("home show", "run 'Soirée'"));
}

TEST(HistoryFileTest, IsForItsOwnerAlone) {
  const TestFolder folder;
  const FileCreationMask mask(0000);
  const std::filesystem::path file = folder.file("state/nidus/history");
  EXPECT_FALSE(HistoryFile(file).add("home show"));
  EXPECT_EQ(permissionsOf(file), 0600U);
  EXPECT_EQ(permissionsOf(file.parent_path()), 0700U);
  EXPECT_EQ(permissionsOf(file.parent_path().parent_path()), 0700U);
}

TEST(HistoryFileTest, CutsALongFile) {
  const TestFolder folder;
  std::string text;
  for (std::size_t i = 0; i <= 2 * HistoryFile::kLines; ++i) text += std::to_string(i) + '\n';
  const std::string file = folder.write("history", text);
  EXPECT_THAT(HistoryFile(file).lines(), SizeIs(HistoryFile::kLines));
  EXPECT_EQ(HistoryFile(file).lines().back(), std::to_string(2 * HistoryFile::kLines));
  EXPECT_LT(std::filesystem::file_size(file), text.size());
}

TEST(HistoryFileTest, NamesAFileThatCannotBeWritten) {
  const TestFolder folder;
  const HistoryFile history(folder.write("file", "") + "/history");
  const Status failure = history.add("home show");
  ASSERT_TRUE(failure);
  EXPECT_THAT(failure->message, HasSubstr("/history: the history cannot be written ("));
}

}  // namespace
}  // namespace nidus
