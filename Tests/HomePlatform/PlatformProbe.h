#pragma once

#include <gtest/gtest.h>

#include <memory>
#include <string>
#include <vector>

#include "HomePlatform/HomePlatform.h"
#include "HomePlatform/SampleHome.h"

namespace nidus {

/// Opens a platform, with a failure of the test when that fails, and shuts it down at the end.
class OpenPlatform {
 public:
  explicit OpenPlatform(HomePlatformOptions options);
  ~OpenPlatform();
  OpenPlatform(const OpenPlatform&) = delete;
  OpenPlatform& operator=(const OpenPlatform&) = delete;

  HomePlatform* operator->() const { return platform_.get(); }
  HomePlatform& operator*() const { return *platform_; }

  /// The homes that a new manager reports.
  [[nodiscard]] NDArray<NDHome> homes() const;

 private:
  std::shared_ptr<HomePlatform> platform_;
};

/// A platform with its homes in memory, whose work is done by whoever drains it.
inline HomePlatformOptions onCaller() { return {.drainsOnCaller = true}; }

/// Hears of the updates of one manager.
class DelegateProbe final : public NDHomeManagerDelegate {
 public:
  void homeManagerDidUpdateHomes(const std::shared_ptr<NDHomeManager>& manager) override {
    homes = manager->homes();
    ++updates;
  }
  void homeManagerWillNotUpdateHomes(const std::shared_ptr<NDHomeManager>& /*manager*/) override {
    ++refusals;
  }
  NDArray<NDHome> homes;
  int updates = 0;
  int refusals = 0;
};

/// What a batch was answered with.
struct BatchAnswer {
  std::int64_t error = 0;           ///< Of the batch; 0 for none.
  std::vector<std::int64_t> codes;  ///< Of the responses; 0 for success.
  int calls = 0;                    ///< How often the completion ran.
};

/// The characteristic at that place, as the loaded objects have it; null when there is none.
[[nodiscard]] std::shared_ptr<NDCharacteristic> characteristicAt(
    const std::shared_ptr<NDHome>& home, const CharacteristicAddress& address);

/// Asks the home and drains the platform.
[[nodiscard]] BatchAnswer read(HomePlatform& platform, const std::shared_ptr<NDHome>& home,
                               const std::vector<CharacteristicAddress>& targets);
struct Write {
  CharacteristicAddress target;
  NDValueRef value;
};
[[nodiscard]] BatchAnswer write(HomePlatform& platform, const std::shared_ptr<NDHome>& home,
                                const std::vector<Write>& writes);
/// The code of the answer, 0 for success, -1 for none.
[[nodiscard]] std::int64_t execute(HomePlatform& platform, const std::shared_ptr<NDHome>& home);

/// The values of a characteristic in the database, as texts: "value/deviceValue".
[[nodiscard]] std::string storedValues(HomePlatform& platform,
                                       const CharacteristicAddress& address);

}  // namespace nidus
