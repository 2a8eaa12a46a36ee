#include "toolkit/system_appearance.h"

namespace vesk {

namespace {

PlatformVersion theVersion{13, 0};

}  // namespace

PlatformVersion platformVersion() {
  return theVersion;
}

void setPlatformVersion(PlatformVersion version) {
  theVersion = version;
}

}  // namespace vesk
