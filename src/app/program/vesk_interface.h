#pragma once

#include "toolkit/interface_layout.h"

namespace vesk {

/// The program's screens: how they look and lead to one another.
[[nodiscard]] const InterfaceLayout& veskInterface();

}  // namespace vesk
