#pragma once

#include <vector>

#include "PlatformModel/System/NDString.h"
#include "PlatformModel/System/NDValue.h"

namespace nidus {

/// The "format" of a vocabulary document.
inline constexpr const char kVocabularyFormat[] = "nidus-vocabulary/1";

/// The tables between the assistant's words and the platform's types, as plain data. Texts are
/// never null unless said so.

struct ServiceEntry {
  NDString assistantName;
  NDString serviceType;
};

struct ValuePair {
  NDValueRef assistant;  ///< Never null.
  NDValueRef platform;   ///< Never null.
};

struct CharacteristicEntry {
  NDString assistantName;
  NDString read;   ///< The type that is read; may be null.
  NDString write;  ///< The type that is written; may be null.
  NDString valueType;
  NDString unit;           ///< The platform's unit of both types; may be null.
  bool localized = false;  ///< Whether values follow the user's unit system.
  bool follows = false;    ///< Whether what is written shows in what is read.
  std::vector<ValuePair> values;
};

struct UnitEntry {
  NDString assistantName;
  NDString unit;
};

/// Within one vocabulary each assistant name stands once in its list, and each type and each unit
/// of the platform belongs to one entry.
struct Vocabulary {
  std::vector<ServiceEntry> services;
  std::vector<CharacteristicEntry> characteristics;
  std::vector<UnitEntry> units;

  [[nodiscard]] bool isEmpty() const noexcept {
    return services.empty() && characteristics.empty() && units.empty();
  }
};

}  // namespace nidus
