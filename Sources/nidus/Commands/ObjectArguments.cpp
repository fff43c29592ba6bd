#include "nidus/Commands/ObjectArguments.h"

namespace nidus {

Candidates candidatesOf(ObjectKind kind) {
  switch (kind) {
    case ObjectKind::home:
      return {CandidateKind::homes};
    case ObjectKind::room:
      return {CandidateKind::rooms};
    case ObjectKind::zone:
      return {CandidateKind::zones};
    case ObjectKind::accessory:
      return {CandidateKind::accessories};
    case ObjectKind::service:
      return {CandidateKind::services};
    case ObjectKind::group:
      return {CandidateKind::groups};
    case ObjectKind::scene:
      return {CandidateKind::scenes};
    case ObjectKind::trigger:
      break;
  }
  return {CandidateKind::triggers};
}

void declareObjectArguments(CommandSyntax& syntax, ObjectWords& words) {
  const bool isService = words.kind == ObjectKind::service;
  syntax.requiredArgument(
      "NAME", words.name,
      isService ? "Its name, or ACCESSORY/NAME, or ACCESSORY/INSTANCE-ID" : "Its name or UUID");
  syntax.candidates("NAME", {candidatesOf(words.kind)});
  if (words.kind == ObjectKind::home) return;
  syntax.option("--home", "HOME", words.home,
                "The name or UUID of its home, where several homes have the name");
  syntax.candidates("--home", {{CandidateKind::homes}});
}

std::string withArticle(ObjectKind kind) {
  return (kind == ObjectKind::accessory ? "an " : "a ") + wordOf(kind);
}

std::string exampleName(ObjectKind kind) {
  switch (kind) {
    case ObjectKind::home:
      return "\"Beach House\"";
    case ObjectKind::room:
      return "Kitchen";
    case ObjectKind::zone:
      return "Upstairs";
    case ObjectKind::accessory:
      return "\"Floor lamp\"";
    case ObjectKind::service:
      return "\"Floor lamp/Lamp\"";
    case ObjectKind::group:
      return "\"Reading corner\"";
    case ObjectKind::scene:
      return "\"Movie night\"";
    case ObjectKind::trigger:
      break;
  }
  return "\"At sunset\"";
}

}  // namespace nidus
