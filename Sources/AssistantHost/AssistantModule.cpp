#include "AssistantHost/AssistantModule.h"

#include <dlfcn.h>

#include <string>
#include <string_view>
#include <system_error>

#include "HomePlatform/System/TrustedPlace.h"

namespace nidus {
namespace {

constexpr const char kModuleFile[] = "nidus/NidusAssistant.so";
constexpr const char kReinstall[] = "; install the program and the module of one release";

Failure moduleFailure(const std::filesystem::path& file, const std::string& message) {
  return {Failure::Kind::platform, file.string() + ": " + message};
}

}  // namespace

Result<std::filesystem::path> findAssistantModule() {
  std::error_code error;
  const auto program = std::filesystem::read_symlink("/proc/self/exe", error);
  if (error) return moduleFailure("/proc/self/exe", error.message() + "; mount /proc");
  const auto prefix = program.parent_path().parent_path();
  const auto usual = prefix / "lib" / kModuleFile;
  for (const auto& file : {usual, prefix / NIDUS_LIBRARY_FOLDER / kModuleFile}) {
    if (std::filesystem::exists(file, error)) return file;
  }
  return moduleFailure(usual, std::string("the plug-in module is not there") + kReinstall);
}

Result<const NDAssistantModule*> openAssistantModule(const std::filesystem::path& file) {
  if (Status failure = checkTrustedWay(file)) return *failure;
  // Never unloaded: callbacks that the module has handed out may be called until the process ends.
  void* library = dlopen(file.c_str(), RTLD_NOW | RTLD_LOCAL | RTLD_NODELETE);
  if (!library) {
    return moduleFailure(file, std::string("cannot be opened (") + dlerror() + ")" + kReinstall);
  }
  auto* entry = reinterpret_cast<NDAssistantModuleEntryFunction*>(
      dlsym(library, kNDAssistantModuleEntryName));
  if (!entry) {
    return moduleFailure(file, std::string("is not a plug-in module of nidus") + kReinstall);
  }
  const NDAssistantModule* offered = entry();
  if (auto failure = checkAssistantModule(offered, file)) return *failure;
  return offered;
}

Status checkAssistantModule(const NDAssistantModule* offered, const std::filesystem::path& file) {
  if (!offered) return moduleFailure(file, std::string("offers nothing") + kReinstall);
  if (offered->interfaceVersion != kNDAssistantModuleInterfaceVersion) {
    return moduleFailure(file, "offers interface " + std::to_string(offered->interfaceVersion) +
                                   ", this program needs " +
                                   std::to_string(kNDAssistantModuleInterfaceVersion) + kReinstall);
  }
  if (!offered->abi || std::string_view(offered->abi) != kNDAssistantModuleABI) {
    return moduleFailure(file, std::string("was built for ") +
                                   (offered->abi ? offered->abi : "an unknown compiler") +
                                   ", this program for " + kNDAssistantModuleABI + kReinstall);
  }
  return std::nullopt;
}

}  // namespace nidus
