#include "Support/ReportedCount.h"

#include <gtest/gtest.h>

#include <iostream>

namespace nidus {

void reportCount(const std::string& name, std::int64_t count) {
  testing::Test::RecordProperty(name, std::to_string(count));
  std::cout << "[ REPORTED ] " << name << ": " << count << std::endl;
}

}  // namespace nidus
