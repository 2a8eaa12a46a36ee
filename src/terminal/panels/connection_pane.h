#pragma once

#include "insight/present.h"
#include "terminal/panels/canvas.h"

namespace vesk {

/// The radio connection, the registrations and what is set up: carriers, discontinuous reception, power, bearers.
void drawConnection(const Canvas& canvas, const insight::Present& drive);

}  // namespace vesk
