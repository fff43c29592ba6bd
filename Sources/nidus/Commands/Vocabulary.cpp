#include <memory>
#include <sstream>

#include "HomePlatform/Metadata/VocabularyWriter.h"
#include "nidus/CommandSyntax.h"
#include "nidus/Commands/Commands.h"
#include "nidus/Commands/ExitStatusText.h"
#include "nidus/Orders/WordChoice.h"
#include "nidus/StandardStreams.h"
#include "nidus/VocabularyText.h"
#include "nidus/Workspace.h"

namespace nidus {
namespace {

struct VocabularyOptions {
  std::string word;
  bool isJson = false;
};

std::string documentOf(const Vocabulary& vocabulary) {
  std::ostringstream document;
  writeVocabulary(document, vocabulary);
  return document.str();
}

ExitStatus showVocabulary(const VocabularyOptions& options, Workspace& workspace) {
  const auto session = workspace.home();
  if (!session) return report(session.failure());
  const Vocabulary& all = (*session)->platform().vocabulary();
  if (options.word.empty()) {
    return printText(options.isJson ? documentOf(all) : vocabularyText(all, standardOutputStyle()));
  }
  const Vocabulary matching = entriesMatching(all, options.word);
  if (matching.isEmpty()) {
    return report(unknownWord(options.word, wordsOf(all),
                              "no word of the vocabulary contains this; see nidus vocabulary"));
  }
  return printText(options.isJson ? documentOf(matching) : vocabularyDetails(matching));
}

}  // namespace

void declareVocabulary(CommandSyntax& program, Workspace& workspace) {
  const auto options = std::make_shared<VocabularyOptions>();
  CommandSyntax& syntax = program.command(
      "vocabulary", "Lists the words that orders and commands can use",
      std::string(
          "Without WORD all of them; with it the entry of that name, else those that contain it, "
          "and\n"
          "what they stand for on the devices. Words of your own come from vocabulary.json in the "
          "data\n"
          "folder.\n\n"
          "Example: what values does the climate mode take?\n"
          "  nidus vocabulary climate") +
          kExitStatuses);
  syntax.argument("WORD", options->word, "The word to show, in either case");
  syntax.candidates("WORD", {{CandidateKind::attributes, CandidateKind::serviceTypes}});
  syntax.flag("--json", options->isJson, "Write a vocabulary document, as vocabulary.json is");
  syntax.run([options, &workspace] { return showVocabulary(*options, workspace); });
}

}  // namespace nidus
