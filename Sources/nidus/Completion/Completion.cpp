#include "nidus/Completion/Completion.h"

#include <algorithm>
#include <set>
#include <string_view>

#include "PlatformModel/Assistant/VAHAConstants.h"
#include "PlatformModel/System/NDTextMatching.h"

namespace nidus {
namespace {

constexpr std::string_view kEntityTypes[] = {
    VAHAEntityTypeHOMEValue,    VAHAEntityTypeSERVICEValue, VAHAEntityTypeGROUPValue,
    VAHAEntityTypeROOMValue,    VAHAEntityTypeZONEValue,    VAHAEntityTypeSCENEValue,
    VAHAEntityTypeTRIGGERValue,
};

char lowerCase(char c) { return c >= 'A' && c <= 'Z' ? static_cast<char>(c - 'A' + 'a') : c; }

/// The assistant's words are shown as a person types them.
std::string lowerCase(std::string_view text) {
  std::string lower(text);
  std::transform(lower.begin(), lower.end(), lower.begin(), [](char c) { return lowerCase(c); });
  return lower;
}

bool beginsLoosely(std::string_view text, std::string_view start) {
  const std::u32string whole = withoutDiacritics(lowerCase(text));
  const std::u32string part = withoutDiacritics(lowerCase(start));
  return whole.compare(0, part.size(), part) == 0;
}

/// Gathers all that a word may be, whatever of it has been typed.
class Gathering {
 public:
  Gathering(const CompletionPoint& point, const std::vector<HomeName>& names,
            const Vocabulary& vocabulary)
      : point_(point), names_(names), vocabulary_(vocabulary), texts_(point.texts) {
    for (const CandidateKind kind : point.kinds) add(kind);
  }

  [[nodiscard]] const std::vector<std::string>& texts() const { return texts_; }

 private:
  void add(CandidateKind kind) {
    switch (kind) {
      case CandidateKind::attributes:
        for (const auto& entry : vocabulary_.characteristics) addLower(entry.assistantName.view());
        break;
      case CandidateKind::serviceTypes:
        for (const auto& entry : vocabulary_.services) addLower(entry.assistantName.view());
        break;
      case CandidateKind::entityTypes:
        for (const auto type : kEntityTypes) addLower(type);
        break;
      case CandidateKind::values:
        for (const auto& entry : vocabulary_.characteristics) {
          if (isAskedFor(entry)) addValues(entry);
        }
        break;
      case CandidateKind::files:
        break;
      default:
        addNames(kind);
    }
  }

  [[nodiscard]] bool isAskedFor(const CharacteristicEntry& entry) const {
    const auto& words = point_.arguments;
    return std::any_of(words.begin(), words.end(), [&entry](const std::string& word) {
      return lowerCase(word) == lowerCase(entry.assistantName.view());
    });
  }

  void addValues(const CharacteristicEntry& entry) {
    for (const ValuePair& pair : entry.values) {
      if (pair.assistant->isText()) addLower(pair.assistant->stringValue().view());
    }
    if (entry.valueType == "bool") {
      addText("on");
      addText("off");
    }
  }

  void addNames(CandidateKind kind) {
    for (const HomeName& name : names_) {
      const bool isInHome = kind == CandidateKind::homes || kind == CandidateKind::backups ||
                            point_.home.empty() ||
                            isEqualIgnoringDiacritics(name.home, point_.home);
      if (name.kind == kind && isInHome) addText(name.name);
    }
  }

  void addLower(std::string_view text) { addText(lowerCase(text)); }
  void addText(std::string_view text) {
    texts_.push_back(point_.word.substr(0, point_.valueStart).append(text));
  }

  const CompletionPoint& point_;
  const std::vector<HomeName>& names_;
  const Vocabulary& vocabulary_;
  std::vector<std::string> texts_;
};

template <typename Matches>
std::vector<std::string> selected(const std::vector<std::string>& texts, const Matches& matches) {
  std::set<std::string> found;
  std::copy_if(texts.begin(), texts.end(), std::inserter(found, found.end()), matches);
  return {found.begin(), found.end()};
}

}  // namespace

bool needsHome(const CompletionPoint& point) {
  return std::any_of(point.kinds.begin(), point.kinds.end(), [](CandidateKind kind) {
    return kind != CandidateKind::files && kind != CandidateKind::entityTypes &&
           kind != CandidateKind::backups;
  });
}

Completion completionAt(const CompletionPoint& point, const std::vector<HomeName>& names,
                        const Vocabulary& vocabulary) {
  const Gathering gathering(point, names, vocabulary);
  const std::string& word = point.word;
  Completion completion;
  completion.isFile =
      std::find(point.kinds.begin(), point.kinds.end(), CandidateKind::files) != point.kinds.end();
  completion.words = selected(gathering.texts(), [&word](const std::string& text) {
    return text.compare(0, word.size(), word) == 0;
  });
  if (completion.words.empty()) {
    completion.words = selected(
        gathering.texts(), [&word](const std::string& text) { return beginsLoosely(text, word); });
  }
  return completion;
}

}  // namespace nidus
