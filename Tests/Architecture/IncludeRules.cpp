#include "Architecture/IncludeRules.h"

#include <algorithm>
#include <optional>

namespace nidus {
namespace {

/// A folder of `Sources` and the other folders that its files may include. An edge is added here on
/// purpose or not at all.
struct Layer {
  std::string_view folder;
  std::vector<std::string_view> below;
  bool usesStandardLibraryAlone = false;
};

const std::vector<Layer>& layers() {
  static const std::vector<Layer> kLayers = {
      {"PlatformModel", {}},
      {"Logging", {"PlatformModel"}, true},
      {"Assistant", {"Logging", "PlatformModel"}, true},
      {"HomePlatform", {"PlatformModel"}},
      {"AssistantHost", {"HomePlatform", "PlatformModel"}},
      {"nidus", {"AssistantHost", "HomePlatform", "PlatformModel"}},
  };
  return kLayers;
}

/// A library, told by how its headers begin, and the folder of its adapter: the library's types
/// stay inside the source files there.
struct Library {
  std::string_view name;
  std::string_view header;
  std::string_view adapter;
};

constexpr Library kLibraries[] = {
    {"nlohmann-json", "nlohmann/", "HomePlatform/Json/"},
    {"SQLite", "sqlite3", "HomePlatform/Store/"},
    {"CLI11", "CLI/", "nidus/"},
};

std::string_view folderOf(std::string_view path) { return path.substr(0, path.find('/')); }

const Layer* layerOf(std::string_view path) {
  const auto found = std::find_if(layers().begin(), layers().end(), [path](const Layer& layer) {
    return layer.folder == folderOf(path);
  });
  return found == layers().end() ? nullptr : &*found;
}

const Library* libraryOf(std::string_view header) {
  const auto* found =
      std::find_if(std::begin(kLibraries), std::end(kLibraries),
                   [header](const Library& library) { return header.starts_with(library.header); });
  return found == std::end(kLibraries) ? nullptr : found;
}

struct Include {
  std::string header;
  bool isQuoted;
};

/// Takes `word` and the blanks before it from the front of `rest`; false when it is not there.
bool skip(std::string_view& rest, std::string_view word) {
  const std::size_t begin = std::min(rest.find_first_not_of(" \t"), rest.size());
  if (!rest.substr(begin).starts_with(word)) return false;
  rest.remove_prefix(begin + word.size());
  return true;
}

std::optional<Include> includeOf(std::string_view line) {
  if (!skip(line, "#") || !skip(line, "include")) return std::nullopt;
  const bool isQuoted = skip(line, "\"");
  if (!isQuoted && !skip(line, "<")) return std::nullopt;
  return Include{std::string(line.substr(0, line.find_first_of("\">"))), isQuoted};
}

std::string libraryViolation(const SourceFile& file, const Library& library) {
  const std::string name(library.name);
  if (!file.path.ends_with(".cpp")) return "headers of " + name + " belong into source files";
  if (file.path.starts_with(library.adapter)) return {};
  return "headers of " + name + " belong into " + std::string(library.adapter);
}

std::string edgeViolation(const Layer& from, const Include& include, const FileExists& exists) {
  const std::string_view to = folderOf(include.header);
  const bool isAllowed =
      to == from.folder || std::find(from.below.begin(), from.below.end(), to) != from.below.end();
  if (!isAllowed) {
    return std::string(from.folder) + " must not include " + std::string(to);
  }
  return exists(include.header) ? std::string() : "there is no " + include.header;
}

/// What is wrong with one include; empty when nothing is.
std::string violation(const SourceFile& file, const Include& include, const FileExists& exists) {
  const Layer* from = layerOf(file.path);
  if (!from) return "the folder " + std::string(folderOf(file.path)) + " has no layer";
  if (const Library* library = libraryOf(include.header)) return libraryViolation(file, *library);
  if (layerOf(include.header)) return edgeViolation(*from, include, exists);
  if (include.isQuoted) return "there is no " + include.header;
  const bool isStandard = include.header.find('.') == std::string::npos;
  if (from->usesStandardLibraryAlone && !isStandard) {
    return std::string(from->folder) + " uses the standard library alone";
  }
  return {};
}

}  // namespace

std::vector<std::string> includeViolations(const SourceFile& file, const FileExists& exists) {
  std::vector<std::string> violations;
  for (std::size_t at = 0; at < file.lines.size(); ++at) {
    const auto include = includeOf(file.lines[at]);
    if (!include) continue;
    const std::string reason = violation(file, *include, exists);
    if (reason.empty()) continue;
    violations.push_back(file.path + ':' + std::to_string(at + 1) + ": " + reason);
  }
  return violations;
}

}  // namespace nidus
