#include "Load/LifeWatch.h"

namespace nidus {
namespace {

constexpr std::size_t kLeastCount = 256;

void forgetGone(std::vector<std::weak_ptr<const void>>& objects) {
  std::erase_if(objects, [](const auto& object) { return object.expired(); });
}

}  // namespace

void LifeWatch::add(const std::string& kind, const std::weak_ptr<const void>& object) {
  const NDLock lock(mutex_);
  Watched& watched = watched_[kind];
  if (watched.objects.size() >= watched.greatestCount) {
    forgetGone(watched.objects);
    watched.greatestCount = kLeastCount + 2 * watched.objects.size();
  }
  watched.objects.push_back(object);
}

std::map<std::string, std::size_t> LifeWatch::survivors() {
  std::map<std::string, std::size_t> alive;
  const NDLock lock(mutex_);
  for (auto& [kind, watched] : watched_) {
    forgetGone(watched.objects);
    if (!watched.objects.empty()) alive[kind] = watched.objects.size();
  }
  return alive;
}

}  // namespace nidus
