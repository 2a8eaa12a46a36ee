#pragma once

#include <cstdint>
#include <optional>

#include "insight/technology.h"
#include "values/text.h"

/// The states and causes of a radio connection, by what they mean.
namespace vesk::insight {

enum class RrcClass : std::uint8_t { idle, attempt, connected };

/// Absent for a state that the technology does not have.
[[nodiscard]] std::optional<RrcClass> rrcClassOf(Technology technology, const Text& state);

enum class AttemptKind : std::uint8_t { setUp, reestablishment };

/// What is attempted for that cause; absent for a cause that says nothing of it.
[[nodiscard]] std::optional<AttemptKind> attemptKindOf(const std::optional<Text>& cause);

/// Whether a connection that ends in that state, for that cause, was lost.
[[nodiscard]] bool isDrop(Technology technology, const Text& state, const std::optional<Text>& cause);

}  // namespace vesk::insight
