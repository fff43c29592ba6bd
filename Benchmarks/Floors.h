#pragma once

#include <array>
#include <cstddef>
#include <memory>
#include <string>
#include <vector>

#include "BenchmarkHome.h"
#include "PlatformModel/Assistant/VAHACommand.h"

namespace nidus {

// What a careful programmer would write by hand for the same outcome, without a model, a mapper or
// a platform: the floors that the plug-in is measured against.

/// The texts of one object, flat.
struct FlatRecord {
  std::string name;
  std::string identifier;
  std::string home;
  std::string room;
  std::string serviceType;
  std::array<std::string, 3> characteristicTypes;
  std::string group;
  std::string entityType;
  std::string zone;
};
using FlatRecords = std::vector<FlatRecord>;

/// The objects of `records`, the dictionary forms of a snapshot of that shape.
[[nodiscard]] FlatRecords flatRecords(const NDDictionaryList& records);

/// Copies nine texts of each record into fresh records: name, identifier, home, room, service type,
/// characteristic types and group.
[[nodiscard]] FlatRecords copiedTexts(const FlatRecords& records);

/// Compares eight keys of every record with those of `wanted` and gives the records with all equal.
[[nodiscard]] std::vector<const FlatRecord*> equalInEightKeys(const FlatRecords& records,
                                                              const FlatRecord& wanted);

/// One pass over the records: those whose `key` equals `wanted`.
[[nodiscard]] std::vector<const FlatRecord*> equalInKey(const FlatRecords& records,
                                                        std::string FlatRecord::*key,
                                                        const std::string& wanted);

/// What an answer says of one object, as shared texts.
struct AnswerTexts {
  NDString name;
  NDString entityType;
  NDString serviceType;
  NDString room;
  NDString home;
};

[[nodiscard]] std::vector<AnswerTexts> answerTexts(const FlatRecords& records);

/// One entity with a fresh random identifier for each.
[[nodiscard]] std::vector<std::shared_ptr<const VAHAEntity>> entitiesByHand(
    const std::vector<AnswerTexts>& texts);

/// One result, with a value and an entity that has a fresh random identifier, for each.
[[nodiscard]] VAHACommandCompleted::Results resultsByHand(const std::vector<AnswerTexts>& texts);

/// What a device answers.
struct DeviceResponse {
  std::int64_t code = 0;
  NDValueRef value;
};

/// A device that has one value and answers with it in one virtual call. Who calls it must not see
/// what kinds of devices there are, or the compiler saves the call.
class AnsweringDevice {
 public:
  virtual ~AnsweringDevice() = default;
  [[nodiscard]] virtual DeviceResponse read() const = 0;
};
using AnsweringDevices = std::vector<std::unique_ptr<AnsweringDevice>>;

[[nodiscard]] AnsweringDevices answeringDevices(std::size_t count);

}  // namespace nidus
