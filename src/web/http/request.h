#pragma once

#include <map>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

/// HTTP/1.1 as far as a page that is only read needs it.
namespace vesk::web {

/// A request that may be answered: GET or HEAD of a path of this host.
struct Request {
  bool isHead = false;
  /// Decoded; starts with a slash.
  std::string path;
  /// Decoded; of equal names the first.
  std::map<std::string, std::string, std::less<>> query;
  /// Whether the connection is to be closed after the answer.
  bool isLast = false;

  /// The parameter; empty where it was not given.
  [[nodiscard]] std::string_view parameter(std::string_view name) const;
};

/// What the bytes of a connection come to so far.
struct RequestHead {
  /// How many bytes the head has; 0 while its end has not come.
  std::size_t size = 0;
  std::optional<Request> request;
  /// Why it is refused: 400, 403, 405, 413, 431 or 505. 0 when it is not.
  int refusal = 0;
};

/// A longer head is refused.
inline constexpr std::size_t kLongestHead = 8192;

/// Reads the head at the start of `bytes`. Only a Host is accepted that no other site can make a browser send here:
/// an address, "localhost", or one of `names`.
[[nodiscard]] RequestHead readRequestHead(std::string_view bytes, const std::vector<std::string>& names);

}  // namespace vesk::web
