#pragma once

#include <cstddef>

#include "HomePlatform/Store/HomeData.h"

namespace nidus {

/// What the home of a benchmark is like.
struct HomeShape {
  std::size_t services = 0;
  std::size_t nameLength = 12;  ///< Of every name, in bytes; at least 12.
  bool hasAccents = false;      ///< Whether the services' names begin with an accented word.
  bool hasScene = false;        ///< Whether there is a scene; it dims the lights of the first room.
  // NOLINTNEXTLINE(modernize-use-nullptr): a mistake of the check about defaulted comparisons
  friend auto operator<=>(const HomeShape&, const HomeShape&) = default;
};

/// The words that the names of services begin with; they differ in an accent alone.
inline constexpr const char* kServiceWord = "Lampe";
inline constexpr const char* kAccentedServiceWord = "L\u00e4mpe";

/// The name of the scene.
inline constexpr const char* kSceneName = "Good Night";

/// The name that begins with `word` and ends with `number`, filled up with zeros to `length` bytes.
[[nodiscard]] NDString numberedName(const std::string& word, std::size_t number,
                                    std::size_t length);

/// One home, the primary one, of lights, each with power, brightness and hue: a room for ten of
/// them, a zone for five rooms, and for twenty of them a group that has ten. Types and other words
/// that many objects share are one text.
[[nodiscard]] HomeData benchmarkHome(const HomeShape& shape);

}  // namespace nidus
