#pragma once

namespace nidus {

/// From now on the system's random source gives this process the same bytes each time it runs, so
/// that identifiers, and the order of what is looked up by them, are the same.
void seedRandomSource();

}  // namespace nidus
