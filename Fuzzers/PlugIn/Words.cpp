#include "PlugIn/Words.h"

#include <algorithm>
#include <bit>
#include <cmath>
#include <cstdint>
#include <limits>

#include "HomePlatform/Metadata/VocabularyReader.h"

namespace nidus {
namespace {

constexpr std::array<std::int64_t, 9> kIntegers = {0,
                                                   1,
                                                   5,
                                                   100,
                                                   -1,
                                                   256,
                                                   std::numeric_limits<std::int32_t>::max(),
                                                   1LL << 53,
                                                   std::numeric_limits<std::int64_t>::min()};
constexpr std::array kFloats = {0.0F, -0.0F, 0.5F, 21.5F, 99.9F, -40.0F, 3.4e38F, 1e-45F};
constexpr std::array kTexts = {"HEAT", "OFF", "", "5", "Zoë"};

float chooseFloat(Choices& choices) {
  if (choices.chance(70)) return choices.oneOf(kFloats);
  const auto any = std::bit_cast<float>(choices.number<std::uint32_t>());
  return std::isfinite(any) ? any : 0.0F;
}

}  // namespace

const Vocabulary& words() {
  static const Vocabulary kWords = builtInVocabulary();
  return kWords;
}

const CharacteristicEntry& entryOf(const NDString& attribute) {
  const auto& all = words().characteristics;
  return *std::find_if(all.begin(), all.end(), [&attribute](const CharacteristicEntry& entry) {
    return entry.assistantName == attribute;
  });
}

NDString platformServiceType(const NDString& serviceType) {
  const auto& all = words().services;
  const auto found = std::find_if(all.begin(), all.end(), [&serviceType](const auto& entry) {
    return entry.assistantName == serviceType;
  });
  return found->serviceType;
}

NDValueRef chooseValue(Choices& choices) {
  switch (choices.upTo(3)) {
    case 0:
      return NDValue::boolean(choices.chance(50));
    case 1:
      return NDValue::integer(choices.oneOf(kIntegers));
    case 2:
      return NDValue::floating(chooseFloat(choices));
    default:
      return NDValue::text(choices.oneOf(kTexts));
  }
}

}  // namespace nidus
