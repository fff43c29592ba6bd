#include "AssistantHost/InputLines.h"

#include <array>
#include <limits>

namespace nidus {

bool InputLines::next() {
  if (isTooLong()) return false;
  line_.clear();
  std::array<char, 4096> piece;
  // A piece without the line's end fails when it is full, and ends the stream when it is the last.
  while (in_.getline(piece.data(), piece.size()).fail()) {
    if (in_.gcount() == 0) return false;
    in_.clear();
    line_.append(piece.data(), static_cast<std::size_t>(in_.gcount()));
    if (isTooLong()) break;
  }
  ++number_;
  if (isTooLong()) return false;
  const bool hasEnd = !in_.eof();
  line_.append(piece.data(), static_cast<std::size_t>(in_.gcount()) - (hasEnd ? 1 : 0));
  return !isTooLong();
}

std::string InputLines::tooLongText() const {
  return "the line is longer than " + std::to_string(mostBytes_) +
         " bytes; it and what follows are not read";
}

}  // namespace nidus
