#pragma once

#include <array>
#include <compare>
#include <cstddef>
#include <cstdint>
#include <optional>
#include <span>

namespace vesk::diag {

/// How far a layout is known to be true.
enum class Proof : std::uint8_t {
  /// By many packets of real captures.
  checked,
  /// By the few packets that were at hand.
  sample,
  /// It stands in public readers only.
  byTheBook,
};

/// A version of a packet that can be read.
struct Version {
  /// Absent for a packet that says none.
  std::optional<std::uint8_t> number;
  /// For a packet that is made of smaller ones, each with a version of its own: what is read in it.
  struct Subpacket {
    std::uint8_t id;
    std::uint8_t version;
    auto operator<=>(const Subpacket&) const = default;
  };
  std::optional<Subpacket> subpacket;
  Proof proof;
};

using Versions = std::span<const Version>;

/// Of a packet that has only one layout, and says no version.
template <Proof proof>
[[nodiscard]] Versions unversioned() {
  static constexpr Version kOnly[] = {{std::nullopt, std::nullopt, proof}};
  return kOnly;
}

/// Of a packet that has only one layout, and says this version.
template <std::uint8_t number, Proof proof>
[[nodiscard]] Versions onlyVersion() {
  static constexpr Version kOnly[] = {{number, std::nullopt, proof}};
  return kOnly;
}

/// Of a table of layouts, one a row.
template <class Layout, std::size_t Count>
constexpr std::array<Version, Count> versionsOf(const Layout (&layouts)[Count]) {
  std::array<Version, Count> versions{};
  for (std::size_t index = 0; index < Count; ++index)
    versions[index] = {layouts[index].version, std::nullopt, layouts[index].proof};
  return versions;
}

/// Of packets of version 1 whose subpackets `id` have a table of layouts, one a row.
template <class Layout, std::size_t Count>
constexpr std::array<Version, Count> subpacketVersionsOf(std::uint8_t id, const Layout (&layouts)[Count]) {
  std::array<Version, Count> versions{};
  for (std::size_t index = 0; index < Count; ++index)
    versions[index] = {std::uint8_t{1}, Version::Subpacket{id, layouts[index].version}, layouts[index].proof};
  return versions;
}

/// The row of a version, or null.
template <class Layout, std::size_t Count>
[[nodiscard]] const Layout* findLayout(const Layout (&layouts)[Count], std::uint8_t version) {
  for (const Layout& layout : layouts) {
    if (layout.version == version) return &layout;
  }
  return nullptr;
}

}  // namespace vesk::diag
