#pragma once

/// Marks what is shared between the module and the process that opens it: all of `PlatformModel`,
/// the module's entry and the logging functions.
#define ND_EXPORT __attribute__((visibility("default")))
