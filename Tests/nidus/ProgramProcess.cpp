#include "nidus/ProgramProcess.h"

#include <fcntl.h>
#include <poll.h>
#include <unistd.h>

#include <array>
#include <csignal>
#include <stdexcept>

#include "nidus/ProgramSpawn.h"

namespace nidus {
namespace {

int openFile(const std::string& file, int flags) {
  const int number = open(file.c_str(), flags | O_CLOEXEC, 0600);
  if (number < 0) throw std::runtime_error("can not open " + file);
  return number;
}

int openOutput(const std::string& file) { return openFile(file, O_WRONLY | O_CREAT | O_APPEND); }

}  // namespace

ProgramProcess::ProgramProcess(const ProgramStart& start) {
  // A program that has ended early is told by its exit status.
  std::signal(SIGPIPE, SIG_IGN);
  std::array<int, 2> input = {};
  std::array<int, 2> output = {};
  if (pipe2(input.data(), O_CLOEXEC) != 0 || pipe2(output.data(), O_CLOEXEC) != 0) {
    throw std::runtime_error("no pipes");
  }
  const int errors = openOutput(folder_.file("errors"));
  process_ = spawnProgram(start, {input[0], output[1], errors});
  close(input[0]);
  close(output[1]);
  close(errors);
  input_ = input[1];
  output_ = output[0];
}

ProgramProcess::~ProgramProcess() {
  if (process_ >= 0) static_cast<void>(finish());
}

void ProgramProcess::write(std::string_view text) const {
  while (!text.empty()) {
    const ssize_t written = ::write(input_, text.data(), text.size());
    if (written < 0) return;
    text.remove_prefix(static_cast<std::size_t>(written));
  }
}

std::optional<std::string> ProgramProcess::readLine() {
  std::string line;
  char c = 0;
  pollfd waiting = {output_, POLLIN, 0};
  while (poll(&waiting, 1, kPatienceMs) > 0 && read(output_, &c, 1) == 1) {
    if (c == '\n') return line;
    line += c;
  }
  return std::nullopt;
}

void ProgramProcess::sendSignal(int signal) const { ::kill(process_, signal); }

void ProgramProcess::closeOutput() {
  close(output_);
  output_ = -1;
}

ProgramEnd ProgramProcess::finish() {
  close(input_);
  std::string output;
  if (output_ >= 0) {
    for (auto line = readLine(); line; line = readLine()) output += *line + '\n';
    closeOutput();
  }
  ProgramEnd end = waitForEnd(process_);
  process_ = -1;
  end.output = output;
  end.errors = contentOfFile(folder_.file("errors"));
  return end;
}

ProgramEnd runProgram(const ProgramStart& start) {
  const TestFolder folder;
  const std::string output = start.outputFile.empty() ? folder.file("output") : start.outputFile;
  const int in = openFile(folder.write("input", start.input), O_RDONLY);
  const int out = openOutput(output);
  const int errors = openOutput(folder.file("errors"));
  const pid_t process = spawnProgram(start, {in, out, errors});
  for (const int file : {in, out, errors}) close(file);
  ProgramEnd end = waitForEnd(process);
  if (start.outputFile.empty()) end.output = contentOfFile(output);
  end.errors = contentOfFile(folder.file("errors"));
  return end;
}

}  // namespace nidus
