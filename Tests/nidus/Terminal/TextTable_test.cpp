#include "nidus/Terminal/TextTable.h"

#include <gtest/gtest.h>

#include <sstream>

namespace nidus {
namespace {

constexpr TerminalStyle kPipe;

TerminalStyle terminalOf(std::size_t columns) { return {false, columns}; }

TEST(TextTableTest, AlignsColumnsByCells) {
  TextTable table({"OBJECT", "ROOM", "OUTCOME"});
  table.addRow({"Café Lamp", "日本語", "ok"});
  table.addRow({"Cafe\u0301 Lamp", "Den", "ok"});
  EXPECT_EQ(table.text(kPipe),
            "OBJECT     ROOM    OUTCOME\n"
            "Café Lamp  日本語  ok\n"
            "Cafe\u0301 Lamp  Den     ok\n");
}

TEST(TextTableTest, LeavesOutColumnsThatAreEmpty) {
  TextTable table({"OBJECT", "ROOM", "OUTCOME"});
  table.addRow({"Night", "", "ok"});
  EXPECT_EQ(table.text(kPipe), "OBJECT  OUTCOME\nNight   ok\n");
}

TEST(TextTableTest, LeavesNoBlanksAtTheEnd) {
  TextTable table({"OBJECT", "ROOM", "VALUE"});
  table.addRow({"Lamp", "Kitchen", "on"});
  table.addRow({"Horn", "", ""});
  EXPECT_EQ(table.text(kPipe), "OBJECT  ROOM     VALUE\nLamp    Kitchen  on\nHorn\n");
}

TEST(TextTableTest, IsNothingWithoutRows) {
  EXPECT_EQ(TextTable({"OBJECT"}).text(kPipe), "");
  EXPECT_TRUE(TextTable({"OBJECT"}).empty());
}

TEST(TextTableTest, ShortensTheWidestOnANarrowTerminal) {
  TextTable table({"OBJECT", "OUTCOME"});
  table.addRow({"A lamp of a very long name", "ok"});
  EXPECT_EQ(table.text(terminalOf(20)), "OBJECT       OUTCOME\nA lamp of…   ok\n");
  EXPECT_EQ(table.text(terminalOf(35)),
            "OBJECT                      OUTCOME\nA lamp of a very long name  ok\n");
}

TEST(TextTableTest, KeepsWithinEachWidthOfATerminal) {
  TextTable table({"OBJECT", "ROOM", "HOME", "VALUE"});
  table.addRow({"日本語日本語日本語", "Living Room", "Beach House", "21.5 °C"});
  for (std::size_t columns = 30; columns < 60; ++columns) {
    std::istringstream lines(table.text(terminalOf(columns)));
    for (std::string line; std::getline(lines, line);) EXPECT_LE(cellsOf(line), columns) << line;
  }
}

TEST(TextTableTest, LeavesSomethingOfEachColumn) {
  TextTable table({"OBJECT", "ROOM"});
  table.addRow({"Ceiling Light", "Living Room"});
  EXPECT_EQ(table.text(terminalOf(3)), "OBJECT  ROOM\nCeili…  Livin…\n");
}

TEST(TextTableTest, ShortensTheLastColumnLast) {
  TextTable table({"OBJECT", "OUTCOME"});
  table.addRow({"Ceiling", "unreachable"});
  EXPECT_EQ(table.text(terminalOf(19)), "OBJECT  OUTCOME\nCeili…  unreachable\n");
  EXPECT_EQ(table.text(terminalOf(16)), "OBJECT  OUTCOME\nCeili…  unreach…\n");
}

TEST(TextTableTest, NeverShortensInAPipe) {
  TextTable table({"OBJECT"});
  table.addRow({std::string(500, 'x')});
  EXPECT_EQ(table.text(kPipe), "OBJECT\n" + std::string(500, 'x') + "\n");
}

TEST(TextTableTest, ColoursWithoutChangingTheWidths) {
  TextTable table({"OBJECT", "OUTCOME"});
  table.addRow({{"Lamp", Colour::bad}, {"ok", Colour::good}});
  EXPECT_EQ(table.text({true, 80}),
            "\x1b[1mOBJECT\x1b[0m  \x1b[1mOUTCOME\x1b[0m\n"
            "\x1b[31mLamp\x1b[0m    \x1b[32mok\x1b[0m\n");
}

}  // namespace
}  // namespace nidus
