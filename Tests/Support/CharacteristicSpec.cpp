#include "Support/CharacteristicSpec.h"

#include "Support/TestTypes.h"

namespace nidus {

CharacteristicSpec power(bool value) {
  return CharacteristicSpec(kPower).value(value).format("bool");
}

CharacteristicSpec brightness(int value) {
  return CharacteristicSpec(kBrightness)
      .value(value)
      .format("int")
      .units("percentage")
      .limits(0, 100, 1);
}

CharacteristicSpec currentTemperature(float value) {
  return CharacteristicSpec(kCurrentTemperature)
      .value(value)
      .format("float")
      .units("celsius")
      .limits(0.0F, 100.0F, 0.1F)
      .readOnly();
}

CharacteristicSpec targetTemperature(float value) {
  return CharacteristicSpec(kTargetTemperature)
      .value(value)
      .format("float")
      .units("celsius")
      .limits(10.0F, 38.0F, 0.5F);
}

CharacteristicSpec identify() {
  return CharacteristicSpec(kIdentify).format("bool").properties({"writable"});
}

CharacteristicSpec unmapped() { return CharacteristicSpec(kUnmapped).value(1).format("int"); }

}  // namespace nidus
