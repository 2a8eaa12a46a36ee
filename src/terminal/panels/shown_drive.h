#pragma once

#include <memory>

#include "insight/present.h"

namespace vesk {

/// The drive that the panels show: as it goes on, or held as it once was.
class ShownDrive {
 public:
  /// `live` must outlive this.
  explicit ShownDrive(const insight::Present& live) : live_(live) {}

  [[nodiscard]] const insight::Present& present() const { return held_ == nullptr ? live_ : *held_; }
  [[nodiscard]] bool isHeld() const { return held_ != nullptr; }
  void setHeld(bool isHeld) {
    if (isHeld == this->isHeld()) return;
    held_ = isHeld ? std::make_unique<insight::Present>(live_) : nullptr;
  }

 private:
  const insight::Present& live_;
  std::unique_ptr<insight::Present> held_;
};

}  // namespace vesk
