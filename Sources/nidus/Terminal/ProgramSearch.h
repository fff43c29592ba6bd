#pragma once

#include <string>
#include <vector>

namespace nidus {

/// The folders of PATH in which programs are looked up, in its form: those that are absolute, so
/// that nothing is run from the working folder because somebody has put it there.
[[nodiscard]] std::string programFolders();

/// The program `name` in the first of `folders` that has it, empty when none has it. A name with a
/// slash stands for itself.
[[nodiscard]] std::string findProgram(const std::string& name, const std::string& folders);

/// The environment of this process with `folders` for PATH.
[[nodiscard]] std::vector<std::string> environmentWith(const std::string& folders);

}  // namespace nidus
