#pragma once

#include <memory>
#include <utility>

#include "PlatformModel/Home/NDHome.h"

namespace nidus {

/// What the named parts of a home have in common: their data, which they keep alive, and the way
/// back to the home, which they do not.
template <class Interface, class Data>
class HomePart : public Interface {
 public:
  HomePart(std::shared_ptr<const Data> data, std::weak_ptr<NDHome> home)
      : data_(std::move(data)), home_(std::move(home)) {}

  [[nodiscard]] const NDUUID& uuid() const override { return data_->uuid; }
  [[nodiscard]] const NDString& name() const override { return data_->name; }
  [[nodiscard]] std::shared_ptr<NDHome> home() const override { return home_.lock(); }
  [[nodiscard]] const Data& data() const { return *data_; }

 private:
  const std::shared_ptr<const Data> data_;
  const std::weak_ptr<NDHome> home_;
};

}  // namespace nidus
