#include "web/http/response.h"

#include <array>
#include <utility>

namespace vesk::web {

namespace {

std::string_view phraseOf(int status) {
  constexpr std::array<std::pair<int, std::string_view>, 9> kPhrases{{
      {200, "OK"},
      {400, "Bad Request"},
      {403, "Forbidden"},
      {404, "Not Found"},
      {405, "Method Not Allowed"},
      {413, "Content Too Large"},
      {431, "Request Header Fields Too Large"},
      {503, "Service Unavailable"},
      {505, "HTTP Version Not Supported"},
  }};
  for (const auto& [known, phrase] : kPhrases)
    if (known == status) return phrase;
  return "Error";
}

}  // namespace

Response plainResponse(int status, std::string text) {
  if (text.empty()) text = phraseOf(status);
  return {.status = status, .body = std::make_shared<const std::string>(std::move(text) + "\n")};
}

std::string headOf(const Response& response, bool isLast) {
  std::string head = "HTTP/1.1 " + std::to_string(response.status);
  head.append(" ").append(phraseOf(response.status)).append("\r\nContent-Type: ").append(response.type);
  head +=
      "\r\nCache-Control: no-store"
      "\r\nContent-Security-Policy: default-src 'none'; script-src 'self'; style-src 'self'; connect-src 'self'; "
      "img-src 'self'; "
      "base-uri 'none'; form-action 'none'; frame-ancestors 'none'"
      "\r\nCross-Origin-Resource-Policy: same-origin"
      "\r\nReferrer-Policy: no-referrer"
      "\r\nX-Content-Type-Options: nosniff";
  if (response.status == 405) head += "\r\nAllow: GET, HEAD";
  if (response.status == 503) head += "\r\nRetry-After: 1";
  if (!response.begin) head += "\r\nContent-Length: " + std::to_string(response.body ? response.body->size() : 0);
  if (isLast || response.begin) head += "\r\nConnection: close";
  return head + "\r\n\r\n";
}

}  // namespace vesk::web
