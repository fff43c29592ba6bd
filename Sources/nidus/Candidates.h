#pragma once

#include <initializer_list>
#include <string>
#include <utility>
#include <vector>

namespace nidus {

/// A kind of text that a person may be helped to complete.
enum class CandidateKind {
  attributes,
  values,  ///< Of the attribute that stands among the arguments before.
  serviceTypes,
  entityTypes,
  homes,
  rooms,  ///< Of the home that an option names, like all that follow; else of all homes.
  zones,
  accessories,
  services,
  groups,
  scenes,
  triggers,
  backups,  ///< Of the homes, in the data folder.
  files,
};

/// What may stand as an option's value or as one word of an argument: texts of some kinds, or
/// words of the command's own.
struct Candidates {
  Candidates(std::initializer_list<CandidateKind> ofKinds) : kinds(ofKinds) {}
  explicit Candidates(std::vector<std::string> ownWords) : words(std::move(ownWords)) {}

  std::vector<CandidateKind> kinds;
  std::vector<std::string> words = {};
};

}  // namespace nidus
