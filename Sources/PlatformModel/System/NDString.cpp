#include "PlatformModel/System/NDString.h"

#include <new>

namespace nidus {

NDString::Text* NDString::makeText(std::size_t length) {
  return new (::operator new(sizeof(Text) + length)) Text(length);
}

NDString::Text* NDString::makeText(std::string_view text) {
  Text* const made = makeText(text.size());
  text.copy(charactersOf(made), text.size());
  return made;
}

NDString NDString::joined(std::initializer_list<std::string_view> parts) {
  std::size_t length = 0;
  for (const std::string_view part : parts) length += part.size();
  NDString made;
  made.text_ = makeText(length);
  char* end = charactersOf(made.text_);
  for (const std::string_view part : parts) end += part.copy(end, part.size());
  return made;
}

void NDString::destroy(Text* text) noexcept {
  text->~Text();
  ::operator delete(text);
}

}  // namespace nidus
