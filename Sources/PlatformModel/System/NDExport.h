#pragma once

/// Marks what `PlatformModel` shares between the module and the process that opens it.
#define ND_EXPORT __attribute__((visibility("default")))
