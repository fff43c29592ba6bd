#pragma once

#include <cstdint>
#include <string>

namespace nidus {

/// Says how much a test has tried or measured: on standard output and as a property of the test.
void reportCount(const std::string& name, std::int64_t count);

}  // namespace nidus
