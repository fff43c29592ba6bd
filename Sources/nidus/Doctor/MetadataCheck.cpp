#include <algorithm>
#include <array>
#include <string>
#include <string_view>
#include <unordered_map>

#include "nidus/Doctor/Checks.h"
#include "nidus/ObjectPath.h"

namespace nidus {
namespace {

constexpr const char* kEdit = "correct it with nidus home edit";

constexpr std::array<std::string_view, 7> kNumberFormats = {"int",    "uint8", "uint16", "uint32",
                                                            "uint64", "float", "bool"};

bool isNumberFormat(const NDString& format) {
  return std::any_of(kNumberFormats.begin(), kNumberFormats.end(),
                     [&format](std::string_view known) { return format == known; });
}

/// What the device's values must be for an entry of the vocabulary to make sense of them.
struct Expectation {
  bool isText = false;
  bool fitsBoolean = true;  ///< Whether true and false say all there is.
};

Expectation expectationOf(const CharacteristicEntry& entry) {
  if (entry.values.empty()) return {entry.valueType == "string", entry.valueType == "bool"};
  Expectation expectation;
  for (const ValuePair& pair : entry.values) {
    if (pair.platform->isText()) return {true, false};
    if (pair.platform->integerValue() > 1) expectation.fitsBoolean = false;
  }
  return expectation;
}

/// Looks at one characteristic with metadata.
class MetadataLook {
 public:
  /// `entry` may be null.
  MetadataLook(const CharacteristicData& data, const CharacteristicEntry* entry, std::string place,
               Findings& findings)
      : data_(data),
        metadata_(*data.metadata),
        entry_(entry),
        place_(std::move(place)),
        findings_(findings) {}

  void take() {
    checkFormat();
    checkUnit();
    checkLimits();
    checkStep();
    checkValue();
  }

 private:
  void add(std::string message, std::string remedy = kEdit) {
    findings_.push_back({Severity::attention, place_, std::move(message), std::move(remedy)});
  }

  void checkFormat() {
    const NDString& format = metadata_.format;
    if (!format) return;
    if (format != "string" && !isNumberFormat(format)) {
      return add("its format " + format.str() + " is none that values can have");
    }
    if (!entry_) return;
    const Expectation expected = expectationOf(*entry_);
    const bool isText = format == "string";
    if (isText == expected.isText && (format != "bool" || expected.fitsBoolean)) return;
    add("its format " + format.str() + " does not fit " + entry_->assistantName.str() +
        ", which the vocabulary takes for " + (expected.isText ? "text" : rangeOf(expected)));
  }

  static std::string rangeOf(const Expectation& expected) {
    return expected.fitsBoolean ? "true and false" : "numbers";
  }

  void checkUnit() {
    if (!entry_ || !entry_->unit || !metadata_.units || metadata_.units == entry_->unit) return;
    add("its unit " + metadata_.units.str() + " is not " + entry_->unit.str() +
            ", in which the vocabulary has " + entry_->assistantName.str() +
            ": its values are taken for something else",
        "correct the unit with nidus home edit, or the entry in vocabulary.json");
  }

  void checkLimits() {
    const NDValueRef& least = metadata_.minimumValue;
    if (least && least->compare(metadata_.maximumValue) == std::partial_ordering::greater) {
      add("its minimum " + least->description() + " is above its maximum " +
          metadata_.maximumValue->description() + ": no value can be set");
    }
  }

  void checkStep() {
    const NDValueRef& step = metadata_.stepValue;
    if (!step || step->isText() || step->floatValue() > 0) return;
    add("its step " + step->description() + " is not above zero");
  }

  void checkValue() {
    if (!data_.value) return;
    const auto low = data_.value->compare(metadata_.minimumValue);
    const auto high = data_.value->compare(metadata_.maximumValue);
    if (low == std::partial_ordering::less) {
      add("its value " + data_.value->description() + " is below its minimum " +
              metadata_.minimumValue->description(),
          kValueRemedy);
    } else if (high == std::partial_ordering::greater) {
      add("its value " + data_.value->description() + " is above its maximum " +
              metadata_.maximumValue->description(),
          kValueRemedy);
    }
  }

  static constexpr const char* kValueRemedy =
      "set a value within the limits, or correct them with nidus home edit";

  const CharacteristicData& data_;
  const MetadataData& metadata_;
  const CharacteristicEntry* const entry_;
  const std::string place_;
  Findings& findings_;
};

using Entries = std::unordered_map<NDString, const CharacteristicEntry*>;

Entries entriesByType(const Vocabulary& vocabulary) {
  Entries entries;
  for (const CharacteristicEntry& entry : vocabulary.characteristics) {
    if (entry.read) entries.emplace(entry.read, &entry);
    if (entry.write) entries.emplace(entry.write, &entry);
  }
  return entries;
}

}  // namespace

void checkMetadata(const Examination& examination, Findings& findings) {
  const Entries entries = entriesByType(examination.metadata->vocabulary());
  forEachService(*examination.homes, [&](const HomeData& home, const AccessoryData& accessory,
                                         const ServiceData& service) {
    for (const CharacteristicData& data : service.characteristics) {
      if (!data.metadata) continue;
      const auto found = entries.find(data.characteristicType);
      const CharacteristicEntry* entry = found == entries.end() ? nullptr : found->second;
      const NDString& name = entry ? entry->assistantName : data.characteristicType;
      MetadataLook(data, entry, pathOf(home, accessory, service) + ": " + name.str(), findings)
          .take();
    }
  });
}

}  // namespace nidus
