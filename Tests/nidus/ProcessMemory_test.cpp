#include <cstdio>
#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <functional>

#include "Support/ReportedCount.h"
#include "Support/Sanitizers.h"
#include "nidus/ProgramTest.h"

namespace nidus {
namespace {

constexpr std::int64_t kMebibyte = 1 << 20;

/// Whether the documents are as large as the program promises to manage.
bool isLongForm() { return std::getenv("NIDUS_LARGE_DOCUMENTS") != nullptr; }

std::string uuidOf(std::size_t number) {
  std::string text(37, '\0');
  std::snprintf(text.data(), text.size(), "AA00AA00-0000-4000-8000-%012zX", number);
  text.pop_back();
  return text;
}

/// Writes elements with commas between them, each made by `element` from its number from 1 on.
void writeList(std::ostream& out, std::size_t count,
               const std::function<std::string(std::size_t)>& element) {
  for (std::size_t i = 1; i <= count; ++i) out << (i > 1 ? ",\n" : "") << element(i);
}

/// The most that a process may have resident that reads this file.
std::int64_t boundFor(const std::string& file) {
  return 64 * kMebibyte + 4 * static_cast<std::int64_t>(std::filesystem::file_size(file));
}

/// Documents are written piece by piece: what the test has resident counts for the program.
class ProcessMemoryTest : public ProgramTest {
 protected:
  void SetUp() override {
    if (kIsSanitized) GTEST_SKIP() << "the sanitizers need memory of their own";
  }

  /// Runs the program, which must end with `exitStatus`, and gives the most that it had resident.
  static std::int64_t peakOf(const std::string& name, const ProgramStart& started, int exitStatus) {
    ProgramStart quiet = started;
    quiet.outputFile = "/dev/null";
    const ProgramEnd end = runProgram(quiet);
    EXPECT_EQ(end.exitStatus, exitStatus) << name << ": " << end.errors;
    reportCount("peak of " + name + " in MiB", end.peakBytes / kMebibyte);
    return end.peakBytes;
  }
  /// The same, and compares it with `file`, which the program reads or has read before.
  static void expectBounded(const std::string& name, const ProgramStart& started,
                            const std::string& file, int exitStatus = 0) {
    EXPECT_LT(peakOf(name, started, exitStatus), boundFor(file)) << name;
  }
};

std::string lampOf(std::size_t number) {
  return lampDocument(uuidOf(number), "Lamp " + std::to_string(number));
}

TEST_F(ProcessMemoryTest, ReadsALargeHomeWithinItsBound) {
  const std::size_t services = isLongForm() ? 100'000 : 200;
  const std::string home = folder_.file("home.json");
  {
    std::ofstream out(home);
    out << R"({"format": "nidus-home/1", "homes": [{"uuid": ")" << uuidOf(0)
        << R"(", "name": "Manor", "primary": true, "accessories": [)";
    writeList(out, services, lampOf);
    out << "]}]}\n";
  }
  const auto command = [this](const std::string& name, const std::string& action) {
    return folder_.write(
        name, R"({"filter": {"search": {"serviceType": "LIGHT"}}, "actions": [)" + action + "]}");
  };
  const std::string get = command("get", R"({"actionType": "GET", "attribute": "POWER"})");
  const std::string set =
      command("set", R"({"actionType": "SET", "attribute": "POWER", "value": {"boolean": false}})");
  const std::string scenario = folder_.write(
      "scenario",
      R"({"format": "nidus-scenario/1", "preferences": {"kHomesConfigured": true}, "homeFile": "home.json", "steps": [
                     {"records": {}}, {"perform": )" +
          contentOfFile(get) + "}]}");
  ProgramStart edit = start({"home", "edit", "--yes"});
  edit.environment = {{"EDITOR", "sed -i s/Manor/Castle/"}, {"VISUAL", std::nullopt}};
  expectBounded("first import", start({"home", "import", home}), home);
  expectBounded("import", start({"home", "import", home}), home);
  expectBounded("merge", start({"home", "import", "--merge", home}), home);
  expectBounded("export", start({"home", "export"}), home);
  expectBounded("check", start({"home", "check", home}), home);
  expectBounded("doctor", start({"doctor"}), home);
  expectBounded("edit", edit, home);
  // What answers for each service of the home holds the answers as well.
  peakOf("records", start({"records"}), 0);
  peakOf("read of all", start({"perform", get}), 0);
  peakOf("write of all", start({"perform", set}), 0);
  peakOf("replay", start({"replay", scenario}), 0);
}

struct DenseDocument {
  const char* name;
  std::vector<std::string> command;  ///< The document follows.
  const char* begin;
  std::size_t count;
  std::string (*element)(std::size_t number);
  const char* end;
  int exitStatus;
};

/// Documents that ask for as much memory for each of their bytes as can be.
std::vector<DenseDocument> denseDocuments() {
  const std::size_t many = isLongForm() ? 240'000 : 2'000;
  const auto named = [](std::size_t number) {
    return R"({"uuid":")" + uuidOf(number) + R"(","name":""})";
  };
  const auto service = [](std::size_t number) {
    return R"({"instanceID":)" + std::to_string(number) +
           R"(,"serviceType":"","characteristics":[{"instanceID":)" + std::to_string(number) +
           R"(,"characteristicType":""}]})";
  };
  const auto scene = [](std::size_t number) {
    return R"({"uuid":")" + uuidOf(number) + R"(","name":"","actions":[]})";
  };
  const auto list = [](std::size_t) { return std::string("[]"); };
  const auto object = [](std::size_t) { return std::string("{}"); };
  const auto records = [](std::size_t) { return std::string(R"({"records":{}})"); };
  constexpr const char* kHome =
      R"({"format":"nidus-home/1","homes":[{"uuid":"AA00AA00-0000-4000-8000-000000000000","name":"",)";
  static const std::string kServices =
      std::string(kHome) +
      R"("accessories":[{"uuid":"AA00AA00-0000-4000-8000-000000000001","name":"","services":[)";
  static const std::string kScenes = std::string(kHome) + R"("actionSets":[)";
  const std::vector<std::string> check = {"home", "check"};
  return {
      {"homes", check, R"({"format":"nidus-home/1","homes":[)", many, named, "]}", 0},
      {"services", check, kServices.c_str(), many, service, "]}]}]}", 0},
      {"scenes", check, kScenes.c_str(), many, scene, "]}]}", 0},
      {"wrong lists", check, R"({"format":"nidus-home/1","homes":[],"x":[)", many, list, "]}", 2},
      {"actions", {"perform"}, R"({"actions":[)", many * 2 / 5, object, "]}", 1},
      {"steps",
       {"replay"},
       R"({"format":"nidus-scenario/1","home":{"format":"nidus-home/1","homes":[]},"steps":[)",
       many * 4 / 5,
       records,
       "]}",
       0},
  };
}

TEST_F(ProcessMemoryTest, StaysWithinItsBoundWithDenseDocuments) {
  for (const DenseDocument& document : denseDocuments()) {
    const std::string file = folder_.file("document.json");
    {
      std::ofstream out(file);
      out << document.begin;
      writeList(out, document.count, document.element);
      out << document.end;
    }
    std::vector<std::string> command = document.command;
    command.push_back(file);
    expectBounded(document.name, start(command), file, document.exitStatus);
  }
}

}  // namespace
}  // namespace nidus
