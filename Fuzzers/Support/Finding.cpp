#include "Support/Finding.h"

#include <cstdlib>
#include <iostream>

namespace nidus {

void reportFinding(const std::string& what) {
  std::cerr << "\n==FINDING== " + what + '\n' << std::flush;
  std::abort();
}

void expectSameText(std::string_view what, std::string_view expected, std::string_view actual) {
  if (expected == actual) return;
  reportFinding(std::string(what) + "\n--- expected\n" + std::string(expected) + "\n--- actual\n" +
                std::string(actual));
}

}  // namespace nidus
