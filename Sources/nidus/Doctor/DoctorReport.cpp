#include "nidus/Doctor/DoctorReport.h"

#include <algorithm>
#include <cstddef>
#include <utility>

#include "AssistantHost/JsonLine.h"
#include "HomePlatform/System/OneLine.h"
#include "nidus/StandardStreams.h"

namespace nidus {
namespace {

/// How something is marked: by a symbol in colour, and by a word without.
struct Mark {
  const char* symbol;
  Colour colour;
  const char* word;
};

constexpr Mark kWell = {"✓ ", Colour::good, "ok         "};
constexpr Mark kAttention = {"✗ ", Colour::bad, "attention  "};
constexpr Mark kNote = {"• ", Colour::warning, "note       "};

std::string textOf(const Mark& mark, const TerminalStyle& style) {
  return style.hasColour ? coloured(mark.symbol, mark.colour, style) : mark.word;
}

bool isGrave(const Finding& finding) { return finding.severity == Severity::attention; }

std::size_t countOf(const std::vector<AreaFindings>& areas, Severity severity) {
  std::size_t count = 0;
  for (const AreaFindings& area : areas) {
    count += static_cast<std::size_t>(
        std::count_if(area.findings.begin(), area.findings.end(),
                      [severity](const Finding& finding) { return finding.severity == severity; }));
  }
  return count;
}

const Mark& markOf(const Findings& findings) {
  if (findings.empty()) return kWell;
  return std::any_of(findings.begin(), findings.end(), isGrave) ? kAttention : kNote;
}

std::string lineOf(const Finding& finding, const TerminalStyle& style) {
  std::string text = "  ";
  text += textOf(isGrave(finding) ? kAttention : kNote, style);
  if (!finding.place.empty()) text += onOneLine(finding.place) + ": ";
  text += onOneLine(finding.message);
  if (!finding.remedy.empty()) text += "; " + onOneLine(finding.remedy);
  return text + '\n';
}

std::string conclusionOf(const std::vector<AreaFindings>& areas) {
  const std::size_t grave = countOf(areas, Severity::attention);
  const std::size_t notes = countOf(areas, Severity::note);
  std::string text = "All is well";
  if (grave > 0)
    text = std::to_string(grave) + (grave == 1 ? " thing needs" : " things need") + " attention";
  if (notes > 0) text += ", with " + std::to_string(notes) + (notes == 1 ? " note" : " notes");
  return text + ".\n";
}

NDDictionaryValue textValue(const std::string& text) { return NDDictionaryValue(NDString(text)); }

NDDictionaryValue findingValue(const AreaFindings& area, const Finding& finding) {
  NDDictionary value;
  value.set("area", textValue(area.area));
  value.set("severity", textValue(isGrave(finding) ? "attention" : "note"));
  value.set("place", textValue(finding.place));
  value.set("message", textValue(finding.message));
  value.set("remedy", textValue(finding.remedy));
  return NDDictionaryValue(std::move(value));
}

}  // namespace

bool isWell(const std::vector<AreaFindings>& areas) {
  return countOf(areas, Severity::attention) == 0;
}

std::string doctorText(const std::vector<AreaFindings>& areas, const TerminalStyle& style) {
  std::string text;
  for (const AreaFindings& area : areas) {
    text.append(textOf(markOf(area.findings), style)).append(area.area).append(1, '\n');
    for (const Finding& finding : area.findings) text += lineOf(finding, style);
  }
  return text + conclusionOf(areas);
}

std::string doctorJson(const std::vector<AreaFindings>& areas) {
  NDDictionaryList names;
  NDDictionaryList findings;
  for (const AreaFindings& area : areas) {
    names.push_back(textValue(area.area));
    for (const Finding& finding : area.findings) findings.push_back(findingValue(area, finding));
  }
  NDDictionary report;
  report.set("isWell", NDDictionaryValue(isWell(areas)));
  report.set("areas", NDDictionaryValue(std::move(names)));
  report.set("findings", NDDictionaryValue(std::move(findings)));
  return jsonLine(report);
}

}  // namespace nidus
