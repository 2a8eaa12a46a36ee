#pragma once

#include <cstdint>
#include <functional>
#include <memory>
#include <string>
#include <string_view>

namespace vesk::web {

/// Bytes that several visitors are sent.
using SharedText = std::shared_ptr<const std::string>;

/// A visitor whose answer goes on for as long as he stays.
using StreamId = std::uint64_t;

struct Response {
  int status = 200;
  std::string_view type = "text/plain; charset=utf-8";
  /// Of a stream: what it begins with. Null is empty.
  SharedText body;
  /// Not null: the answer is a stream, told here, once its beginning is on the way.
  std::function<void(StreamId)> begin{};
};

/// A text; without one, what the status says.
[[nodiscard]] Response plainResponse(int status, std::string text = {});

/// The bytes before the body. After a response that is the last, the connection is closed.
[[nodiscard]] std::string headOf(const Response& response, bool isLast);

}  // namespace vesk::web
