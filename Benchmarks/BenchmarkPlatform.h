#pragma once

#include <cstddef>
#include <memory>

#include "Assistant/NDAssistantCommand.h"
#include "BenchmarkHome.h"
#include "HomePlatform/HomePlatform.h"

namespace nidus {

/// The platform that the plug-in meets in a benchmark, registered for as long as it lives. All work
/// runs on the thread that calls, be it a light platform or the embedded one in memory.
///
///     BenchmarkPlatform platform(BenchmarkPlatform::Kind::light, {.services = 1'000});
///     benchmark::DoNotOptimize(platform.perform(request));
class BenchmarkPlatform {
 public:
  enum class Kind { light, embedded };

  BenchmarkPlatform(Kind kind, const HomeShape& shape);
  ~BenchmarkPlatform();
  BenchmarkPlatform(const BenchmarkPlatform&) = delete;
  BenchmarkPlatform& operator=(const BenchmarkPlatform&) = delete;

  /// Performs a command to its end and gives the number of its results.
  [[nodiscard]] std::size_t perform(const VAHACommand& request) const;
  /// A gatherer that has its homes.
  [[nodiscard]] std::shared_ptr<NDAssistantGather> gather() const;
  /// A command that has its snapshot and everything else that a filter needs.
  [[nodiscard]] std::shared_ptr<NDAssistantCommand> commandWithSnapshot() const;
  /// Runs all work that waits.
  void drain() const;

 private:
  const std::shared_ptr<HomePlatform> system_;
  std::shared_ptr<NDPlatform> platform_;
};

}  // namespace nidus
