#pragma once

#include "toolkit/application.h"

namespace vesk {

/// The launch always succeeds, and nothing is done at the other stations of the application's life: the configuration
/// stays with the service until the next start clears it.
class AppDelegate : public ApplicationDelegate {};

}  // namespace vesk
