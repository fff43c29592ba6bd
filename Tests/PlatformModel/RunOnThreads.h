#pragma once

#include <cstddef>
#include <functional>
#include <latch>
#include <thread>
#include <vector>

namespace nidus {

/// Runs `work` on `count` threads that begin together, with the thread's number from 0, and waits
/// for all of them.
inline void runOnThreads(std::size_t count, const std::function<void(std::size_t number)>& work) {
  std::latch start(static_cast<std::ptrdiff_t>(count));
  std::vector<std::thread> threads;
  threads.reserve(count);
  for (std::size_t number = 0; number < count; ++number) {
    threads.emplace_back([&start, &work, number] {
      start.arrive_and_wait();
      work(number);
    });
  }
  for (std::thread& thread : threads) thread.join();
}

}  // namespace nidus
