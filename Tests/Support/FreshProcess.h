#pragma once

#include <functional>

namespace nidus {

/// Runs `body` in a fresh process, where nothing has been done yet but what the test has done
/// before; what fails there fails the test here. At most once in a test.
void inFreshProcess(const std::function<void()>& body);

}  // namespace nidus
