#include "app/outcome.h"

#include <cstdio>
#include <string>

#include "platform/visible_text.h"

namespace vesk {

void tellUser(std::string_view line) {
  std::string shown;
  appendVisible(shown, line);
  shown += '\n';
  std::fwrite(shown.data(), 1, shown.size(), stderr);
}

}  // namespace vesk
