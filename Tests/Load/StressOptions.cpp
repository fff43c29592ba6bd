#include "Load/StressOptions.h"

#include <charconv>
#include <map>

namespace nidus {
namespace {

const std::map<std::string, StressOptions::Platform> kPlatforms = {
    {"unruly", StressOptions::Platform::unruly}, {"embedded", StressOptions::Platform::embedded}};

const std::map<std::string, Plant> kPlants = {{"lost-reply", Plant::lostReply},
                                              {"leaked-command", Plant::leakedCommand},
                                              {"leaked-memory", Plant::leakedMemory},
                                              {"leaked-descriptor", Plant::leakedDescriptor}};

std::optional<std::uint64_t> numberFrom(const std::string& text) {
  std::uint64_t number = 0;
  const char* const end = text.data() + text.size();
  const auto [stop, error] = std::from_chars(text.data(), end, number);
  if (error != std::errc() || stop != end) return std::nullopt;
  return number;
}

template <class Value>
bool take(const std::map<std::string, Value>& values, const std::string& name, Value& value) {
  const auto found = values.find(name);
  if (found == values.end()) return false;
  value = found->second;
  return true;
}

/// Takes a number that is at least 1.
template <class Number>
bool take(const std::string& text, Number& number) {
  const auto read = numberFrom(text);
  if (!read || *read == 0) return false;
  number = *read;
  return true;
}

/// Takes one option; false when there is none of that name, or its value is wrong.
bool takeOption(StressOptions& options, const std::string& name, const std::string& value) {
  if (name == "--platform") return take(kPlatforms, value, options.platform);
  if (name == "--plant") return take(kPlants, value, options.plant);
  if (name == "--commands") return take(value, options.commands);
  if (name == "--seconds") return take(value, options.seconds);
  if (name == "--round") return take(value, options.round);
  if (name == "--threads") return take(value, options.threads);
  if (name == "--seed") return take(value, options.seed);
  if (name == "--growth") return take(value, options.growthKiB);
  return false;
}

}  // namespace

std::optional<StressOptions> StressOptions::read(const std::vector<std::string>& arguments,
                                                 std::string& message) {
  StressOptions options;
  for (std::size_t i = 0; i < arguments.size(); i += 2) {
    if (arguments[i] == "--help") {
      options.showsHelp = true;
      return options;
    }
    const std::string value = i + 1 < arguments.size() ? arguments[i + 1] : "";
    if (takeOption(options, arguments[i], value)) continue;
    message = "'" + arguments[i] + " " + value + "' is not understood; see --help";
    return std::nullopt;
  }
  return options;
}

const char* StressOptions::help() {
  return R"(usage: NidusStress [OPTION VALUE]...

Gives commands and syncs from many threads while the homes change, and judges every reply.

  --platform unruly    homes and answers come late, in no order, on several threads or never, and
                       homes change while a command looks at them (the default)
  --platform embedded  the embedded platform on a database on disk that others change meanwhile
  --commands N         how many commands are given (20000)
  --seconds N          for how long commands are given, instead of how many
  --round N            after how many commands everything comes to rest and is counted (10000)
  --threads N          from how many threads (8)
  --seed N             draws the same commands and changes again; the threads keep their own time
  --growth KIB         by how much the memory may grow from the first round to the last (4096)
  --plant FAULT        makes a fault, to see that it is noticed: lost-reply, leaked-command,
                       leaked-memory, leaked-descriptor

The database is in the folder that TMPDIR names.

Exit status: 0 when all is as it should be, 1 when something is not, 2 for wrong arguments.

Example, the long form: NidusStress --platform embedded --commands 1000000
)";
}

}  // namespace nidus
