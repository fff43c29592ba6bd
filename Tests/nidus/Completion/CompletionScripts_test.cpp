#include <filesystem>
#include <utility>

#include "nidus/ProgramTest.h"
#include "nidus/TerminalProcess.h"

namespace nidus {
namespace {

/// Asks shells to complete commands in the demonstration home.
class CompletionScriptTest : public ProgramTest {
 protected:
  void SetUp() override {
    ASSERT_EQ(run({"home", "import", NIDUS_RESOURCES "/demonstration-home.json"}).exitStatus, 0);
  }

  /// A shell in which "nidus" is the program on the data folder of the test.
  [[nodiscard]] ProgramStart shell(const std::string& name,
                                   std::vector<std::string> arguments) const {
    const std::string folder = std::filesystem::path(NIDUS_PROGRAM).parent_path().string();
    return {.arguments = std::move(arguments),
            .environment = {{"NIDUS_DATA", data()},
                            {"PATH", folder + ":/usr/bin:/bin"},
                            {"LC_ALL", "C.UTF-8"},
                            {"HOME", folder_.path().string()},
                            {"PS1", "ready> "}},
            .program = "/usr/bin/" + name};
  }
};

TEST_F(CompletionScriptTest, CompletesInBash) {
  const std::pair<const char*, const char*> table[] = {
      {"nidus get power --room Caf\t", R"(Café\ Corner )"},
      {"nidus get power --room \"Caf\t", R"("Café Corner" )"},
      {"nidus get power --room 'Caf\t", "'Café Corner' "},
      {"nidus get power --room=Caf\t", R"(--room=Café\ Corner )"},
      {"nidus voc\t", "vocabulary "},
  };
  TerminalProcess bash(shell("bash", {"--norc", "--noprofile", "-i"}));
  ASSERT_TRUE(bash.waitFor("ready> "));
  bash.write("source <(nidus completion bash)\n");
  for (const auto& [keys, completed] : table) {
    SCOPED_TRACE(keys);
    ASSERT_TRUE(bash.waitFor("ready> "));
    bash.write(std::string(keys));
    ASSERT_TRUE(bash.waitFor(completed));
    bash.write("\x15\n");
  }
  ASSERT_TRUE(bash.waitFor("ready> "));
  bash.write("exit\n");
  EXPECT_EQ(bash.finish().exitStatus, 0);
}

TEST_F(CompletionScriptTest, CompletesInZsh) {
  TerminalProcess zsh(shell("zsh", {"-f", "-i"}));
  ASSERT_TRUE(zsh.waitFor("ready> "));
  zsh.write("autoload -Uz compinit; compinit -D -u; source <(nidus completion zsh); echo do''ne\n");
  ASSERT_TRUE(zsh.waitFor("done"));
  ASSERT_TRUE(zsh.waitFor("ready> "));
  zsh.write("nidus get power --room Caf\t");
  ASSERT_TRUE(zsh.waitFor(R"(Café\ Corner)"));
  zsh.write(
      "\x15"
      "exit\n");
  EXPECT_EQ(zsh.finish().exitStatus, 0);
}

TEST_F(CompletionScriptTest, CompletesInFish) {
  const std::pair<const char*, const char*> table[] = {
      {"nidus get power --room Caf", "Café Corner"},
      {"nidus get power --room \"Caf", "Café Corner"},
      {"nidus get brigh", "brightness"},
      {"nidus home sh", "show"},
  };
  for (const auto& [line, completed] : table) {
    SCOPED_TRACE(line);
    const std::string commands =
        "nidus completion fish | source; complete -C '" + std::string(line) + "'";
    const ProgramEnd end = runProgram(shell("fish", {"-N", "-c", commands}));
    EXPECT_EQ(end.output, std::string(completed) + '\n') << end.errors;
  }
}

}  // namespace
}  // namespace nidus
