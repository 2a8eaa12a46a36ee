// What a visitor sends.

#include <string>
#include <string_view>

#include "property.h"
#include "web/http/request.h"

namespace vesk::web {
namespace {

void checkHead(std::string_view bytes) {
  const RequestHead head = readRequestHead(bytes, {});
  require(head.size <= bytes.size(), "a head lies within the bytes that came");
  require((head.size > 0) == (head.request || head.refusal != 0), "what has come whole is answered or refused");
  require(!head.request || head.refusal == 0, "what is refused is not answered");
  require(head.size > 0 || bytes.size() < kLongestHead, "a head that is too long is not waited for");
  require(!head.request || head.request->path.starts_with('/'), "a path starts with a slash");
  if (head.size == 0) return;
  const RequestHead again = readRequestHead(std::string(bytes.substr(0, head.size)) + "GET / HTTP/1.1\r\n", {});
  require(head.refusal == 431 || (again.size == head.size && again.refusal == head.refusal),
          "what comes behind a head does not change it");
}

}  // namespace
}  // namespace vesk::web

int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
  vesk::web::checkHead({reinterpret_cast<const char*>(data), size});
  return 0;
}
