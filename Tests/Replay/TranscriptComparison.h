#pragma once

#include <optional>
#include <string>
#include <string_view>

namespace nidus {

/// Whether `text` is what `pattern` says. Every `*` of the pattern stands for any text, also for
/// none; all else is compared byte by byte.
[[nodiscard]] bool matchesPattern(std::string_view pattern, std::string_view text);

/// Compares the transcript of a replay with the expected one, both JSON lines.
///
/// Texts are compared as by `matchesPattern`, with the expected one as the pattern. Integers and
/// floats differ even when their numbers are equal, floats are compared as 32-bit floats. The keys
/// of objects have no order; nor have the replies of a step, the results of a reply, the platform
/// calls of a step, the writes of a call and the log messages of a step. All other lists do.
///
/// Returns none when they agree, otherwise a text for people: the number of the first line that
/// differs, the place in it, and both lines. Text that is not JSON differs from everything.
[[nodiscard]] std::optional<std::string> transcriptDifference(std::string_view expected,
                                                              std::string_view printed);

}  // namespace nidus
