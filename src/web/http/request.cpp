#include "web/http/request.h"

#include <algorithm>
#include <arpa/inet.h>
#include <charconv>

namespace vesk::web {

namespace {

constexpr std::string_view kLineEnd = "\r\n";

bool equalIgnoringCase(std::string_view one, std::string_view other) {
  const auto lower = [](char c) { return c >= 'A' && c <= 'Z' ? static_cast<char>(c - 'A' + 'a') : c; };
  return std::equal(one.begin(), one.end(), other.begin(), other.end(),
                    [&](char a, char b) { return lower(a) == lower(b); });
}

/// Cuts off what stands before the separator, and the separator; all where there is none.
std::string_view cut(std::string_view& text, std::string_view separator) {
  const std::size_t end = text.find(separator);
  const std::string_view front = text.substr(0, end);
  text.remove_prefix(end == std::string_view::npos ? text.size() : end + separator.size());
  return front;
}

std::string_view trimmed(std::string_view text) {
  const auto isBlank = [](char c) { return c == ' ' || c == '\t'; };
  while (!text.empty() && isBlank(text.front()))
    text.remove_prefix(1);
  while (!text.empty() && isBlank(text.back()))
    text.remove_suffix(1);
  return text;
}

/// A zero byte or a line end of another system would be read in two ways.
bool hasControl(std::string_view text) {
  return std::any_of(text.begin(), text.end(),
                     [](char c) { return (static_cast<unsigned char>(c) < ' ' && c != '\t') || c == '\x7f'; });
}

int hexDigit(char c) {
  if (c >= '0' && c <= '9') return c - '0';
  if (c >= 'a' && c <= 'f') return c - 'a' + 10;
  return c >= 'A' && c <= 'F' ? c - 'A' + 10 : -1;
}

/// Absent where an escape is none.
std::optional<std::string> decoded(std::string_view text, bool plusIsBlank) {
  std::string out;
  for (std::size_t at = 0; at < text.size(); ++at) {
    if (text[at] == '+' && plusIsBlank) {
      out += ' ';
    } else if (text[at] != '%') {
      out += text[at];
    } else {
      if (at + 2 >= text.size() || hexDigit(text[at + 1]) < 0 || hexDigit(text[at + 2]) < 0) return std::nullopt;
      out += static_cast<char>(hexDigit(text[at + 1]) * 16 + hexDigit(text[at + 2]));
      at += 2;
    }
  }
  return out;
}

bool readTarget(std::string_view target, Request& request) {
  if (!target.starts_with('/')) return false;
  auto path = decoded(cut(target, "?"), false);
  if (!path) return false;
  request.path = *std::move(path);
  while (!target.empty()) {
    std::string_view pair = cut(target, "&");
    auto name = decoded(cut(pair, "="), true);
    auto value = decoded(pair, true);
    if (!name || !value) return false;
    request.query.emplace(*std::move(name), *std::move(value));
  }
  return true;
}

bool isAddress(const std::string& host) {
  in6_addr address{};
  if (host.starts_with('[') && host.ends_with(']'))
    return inet_pton(AF_INET6, host.substr(1, host.size() - 2).c_str(), &address) == 1;
  return inet_pton(AF_INET, host.c_str(), &address) == 1;
}

bool isPort(std::string_view text) {
  constexpr unsigned kLast = 65535;
  unsigned number = 0;
  const auto [end, error] = std::from_chars(text.data(), text.data() + text.size(), number);
  // None is the usual one.
  return text.empty() || (error == std::errc{} && end == text.data() + text.size() && number <= kLast);
}

/// Cuts the port off a host; false when what stands behind the colon is none.
bool cutPort(std::string_view& host) {
  const std::size_t colon = host.rfind(':');
  if (colon == std::string_view::npos || host.ends_with(']')) return true;
  const std::string_view port = host.substr(colon + 1);
  host = host.substr(0, colon);
  return isPort(port);
}

/// A browser that another site's name led here says that name: such a request is not ours.
bool isOurs(std::string_view host, const std::vector<std::string>& names) {
  return equalIgnoringCase(host, "localhost") || isAddress(std::string(host)) ||
         std::any_of(names.begin(), names.end(),
                     [&](const std::string& name) { return equalIgnoringCase(host, name); });
}

/// The fields of a head that matter here.
struct Fields {
  std::optional<std::string_view> host;
  bool hasBody = false;
  /// Another page asks, be it one of the same machine.
  bool isForeign = false;
  bool isNavigation = false;
  bool isDocument = false;
  bool closes = false;
  bool keeps = false;
  bool isSound = true;

  /// Nobody asks but this page and its readers, who may come here by a link.
  [[nodiscard]] bool isOurPages() const { return !isForeign || (isNavigation && isDocument); }

  void take(std::string_view name, std::string_view value) {
    if (equalIgnoringCase(name, "Host")) {
      if (host) isSound = false;
      host = value;
      if (!cutPort(*host)) isSound = false;
    }
    if (equalIgnoringCase(name, "Transfer-Encoding")) hasBody = true;
    if (equalIgnoringCase(name, "Content-Length") && value != "0") hasBody = true;
    if (equalIgnoringCase(name, "Sec-Fetch-Site") && value != "same-origin" && value != "none") isForeign = true;
    if (equalIgnoringCase(name, "Sec-Fetch-Mode")) isNavigation = value == "navigate";
    if (equalIgnoringCase(name, "Sec-Fetch-Dest")) isDocument = value == "document";
    if (equalIgnoringCase(name, "Connection")) {
      closes = equalIgnoringCase(value, "close");
      keeps = equalIgnoringCase(value, "keep-alive");
    }
  }
};

Fields readFields(std::string_view lines) {
  Fields fields;
  while (!lines.empty()) {
    std::string_view value = cut(lines, kLineEnd);
    const bool hasColon = value.find(':') != std::string_view::npos;
    const bool isText = !hasControl(value);
    const std::string_view name = cut(value, ":");
    const bool isName = hasColon && !name.empty() && name.find_first_of(" \t") == std::string_view::npos;
    if (!isName || !isText) fields.isSound = false;
    fields.take(name, trimmed(value));
  }
  return fields;
}

int readRequest(std::string_view head, const std::vector<std::string>& names, Request& request) {
  std::string_view line = cut(head, kLineEnd);
  if (hasControl(line)) return 400;
  const std::string_view method = cut(line, " ");
  const std::string_view target = cut(line, " ");
  if (line != "HTTP/1.1" && line != "HTTP/1.0") return line.starts_with("HTTP/") ? 505 : 400;
  const Fields fields = readFields(head);
  if (!fields.isSound || !readTarget(target, request)) return 400;
  if (!fields.host && line == "HTTP/1.1") return 400;
  if (!fields.host || !isOurs(*fields.host, names) || !fields.isOurPages()) return 403;
  if (method != "GET" && method != "HEAD") return 405;
  if (fields.hasBody) return 413;
  request.isHead = method == "HEAD";
  request.isLast = fields.closes || (line == "HTTP/1.0" && !fields.keeps);
  return 0;
}

}  // namespace

std::string_view Request::parameter(std::string_view name) const {
  const auto found = query.find(name);
  return found == query.end() ? std::string_view{} : found->second;
}

RequestHead readRequestHead(std::string_view bytes, const std::vector<std::string>& names) {
  constexpr std::string_view kHeadEnd = "\r\n\r\n";
  const std::size_t end = bytes.substr(0, kLongestHead).find(kHeadEnd);
  if (end == std::string_view::npos) {
    if (bytes.size() < kLongestHead) return {};
    return {bytes.size(), std::nullopt, 431};
  }
  RequestHead head{end + kHeadEnd.size(), Request(), 0};
  head.refusal = readRequest(bytes.substr(0, end), names, *head.request);
  if (head.refusal != 0) head.request.reset();
  return head;
}

}  // namespace vesk::web
