#pragma once

namespace vesk {

/// Whatever can start a transition or answer the system: cells, screens, the application's delegate. A
/// transition's sender is one of these; ask with dynamic_cast which.
class Responder {
 public:
  Responder() = default;
  virtual ~Responder() = default;
  Responder(const Responder&) = delete;
  Responder& operator=(const Responder&) = delete;
};

}  // namespace vesk
