#include "nidus/TerminalProcess.h"

#include <gmock/gmock.h>

#include <csignal>

#include "Support/TestFolder.h"

namespace nidus {
namespace {

ProgramStart shell(const std::string& script) {
  return {.arguments = {"-c", script}, .program = "/bin/sh"};
}

TEST(TerminalProcessTest, GivesTheProgramATerminal) {
  const ProgramEnd end =
      runOnTerminal(shell("test -t 0 && test -t 1 && stty size && echo $TERM"), 61);
  EXPECT_EQ(end.exitStatus, 0);
  EXPECT_EQ(end.output, "24 61\nxterm-256color\n");
}

TEST(TerminalProcessTest, WaitsForEachTextInItsTurn) {
  TerminalProcess terminal(shell("echo ask; read answer; echo got $answer"));
  ASSERT_TRUE(terminal.waitFor("ask"));
  terminal.write("yes\n");
  ASSERT_TRUE(terminal.waitFor("got yes"));
  EXPECT_FALSE(terminal.waitFor("ask"));
  EXPECT_EQ(terminal.finish().output, "ask\nyes\ngot yes\n");
}

TEST(TerminalProcessTest, EndsAProgramThatNobodyFinishes) {
  const TestFolder folder;
  {
    const TerminalProcess terminal(
        shell("echo ready; read answer; echo later > " + folder.file("trace")));
  }
  EXPECT_FALSE(std::filesystem::exists(folder.file("trace")));
}

TEST(TerminalProcessTest, InterruptsTheProgram) {
  TerminalProcess terminal(shell("echo ready; read answer"));
  ASSERT_TRUE(terminal.waitFor("ready"));
  terminal.interrupt();
  EXPECT_EQ(terminal.finish().signal, SIGINT);
}

TEST(TerminalProcessTest, LetsAFileTakeTheOutput) {
  const TestFolder folder;
  ProgramStart start = shell("echo plain; echo trouble >&2");
  start.outputFile = folder.file("output");
  EXPECT_EQ(runOnTerminal(start).output, "trouble\n");
  EXPECT_EQ(contentOfFile(start.outputFile), "plain\n");
}

}  // namespace
}  // namespace nidus
