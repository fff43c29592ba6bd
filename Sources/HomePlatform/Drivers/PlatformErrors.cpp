#include "HomePlatform/Drivers/PlatformErrors.h"

#include <string>

namespace nidus {
namespace {

struct CodeText {
  std::int64_t code;
  const char* text;
};

constexpr CodeText kTexts[] = {
    {kNDErrorUnreachable, "the accessory cannot be reached"},
    {kNDErrorNotWritable, "the characteristic cannot be written"},
    {kNDErrorNotReadable, "the characteristic cannot be read"},
    {kNDErrorWrongType, "the value is of the wrong type"},
    {kNDErrorOutOfRange, "the value is out of range"},
    {kNDErrorMustUnlock, "the device must be unlocked"},
    {kErrorNotKept, "the home database failed"},
};

}  // namespace

NDError errorOfCode(std::int64_t code) {
  for (const CodeText& known : kTexts) {
    if (known.code == code) return {code, known.text};
  }
  return {code, "error " + std::to_string(code)};
}

}  // namespace nidus
