#include "HomePlatform/System/WorkTracker.h"

namespace nidus {

void WorkTracker::end() {
  if (count_.fetch_sub(1) > 1) return;
  if (const auto main = main_.lock()) main->wake();
}

}  // namespace nidus
