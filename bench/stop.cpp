#include "bench/stop.h"

#include <cstdlib>
#include <string>

#include "app/output/outcome.h"

namespace vesk::bench {

void stop(std::string_view reason) {
  tellUser("bench: " + std::string(reason));
  std::exit(EXIT_FAILURE);
}

}  // namespace vesk::bench
