// Puts the plug-in under load; see StressOptions::help.

#include <exception>
#include <iostream>
#include <random>

#include "Load/Stress.h"

namespace nidus {
namespace {

constexpr int kSuccess = 0;
constexpr int kFault = 1;
constexpr int kWrongArguments = 2;

int run(const StressOptions& options) {
  const std::uint64_t seed = options.seed.value_or(std::random_device()());
  std::cout << "seed " << seed << ", " << options.threads << " threads\n" << std::flush;
  Stress stress(options, seed);
  stress.run();
  for (const std::string& line : stress.report()) std::cout << line << '\n';
  const auto complaints = stress.complaints();
  for (const std::string& line : complaints) std::cerr << "NidusStress: " << line << '\n';
  if (complaints.empty()) std::cout << "everything was as it should be\n";
  return complaints.empty() ? kSuccess : kFault;
}

int runWith(const std::vector<std::string>& arguments) {
  std::string message;
  const auto options = StressOptions::read(arguments, message);
  if (!options) {
    std::cerr << "NidusStress: " << message << '\n';
    return kWrongArguments;
  }
  if (!options->showsHelp) return run(*options);
  std::cout << StressOptions::help();
  return kSuccess;
}

}  // namespace
}  // namespace nidus

int main(int argc, char** argv) try {
  return nidus::runWith({argv + 1, argv + argc});
} catch (const std::exception& error) {
  std::cerr << "NidusStress: " << error.what() << '\n';
  return nidus::kFault;
}
