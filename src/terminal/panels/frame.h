#pragma once

#include <cstdint>
#include <vector>

#include "terminal/panels/canvas.h"

namespace vesk {

/// The lines around boxes, which meet where boxes touch.
class Frame {
 public:
  explicit Frame(Size size);

  /// A box whose lines run along the edge of `box`.
  void add(Rectangle box);
  void draw(const Canvas& canvas) const;

 private:
  void join(int column, int line, std::uint8_t arms);

  Size size_;
  /// Of every place, which of its neighbours a line goes to.
  std::vector<std::uint8_t> arms_;
};

}  // namespace vesk
