#pragma once

#include <cstdint>
#include <memory>
#include <optional>
#include <utility>
#include <vector>

#include "system/file_descriptor.h"
#include "values/value.h"

namespace vesk {

/// A dictionary as it travels between processes: text keys to signed 64-bit integers, byte strings, or open
/// descriptors, which have no form outside a message. Copies share their content.
class InterProcessDictionary {
 public:
  InterProcessDictionary() = default;

  void reserve(std::size_t capacity) { values_.reserve(capacity); }
  /// These replace the value under `key`, whatever its kind.
  void setInteger(Text key, std::int64_t value) { setValue(std::move(key), value); }
  void setData(Text key, Data value) { setValue(std::move(key), std::move(value)); }
  void setDescriptor(Text key, FileDescriptor descriptor);
  /// These add a value under a key that the dictionary does not hold yet, without looking.
  void appendInteger(Text key, std::int64_t value) { values_.append(std::move(key), value); }
  void appendData(Text key, Data value) { values_.append(std::move(key), std::move(value)); }

  [[nodiscard]] std::size_t size() const { return values_.size() + descriptors_.size(); }
  [[nodiscard]] bool empty() const { return size() == 0; }
  /// Absent also when another kind of value lies under `key`.
  [[nodiscard]] std::optional<std::int64_t> integer(const Text& key) const;
  [[nodiscard]] const Data* data(const Text& key) const;
  [[nodiscard]] const FileDescriptor* descriptor(const Text& key) const;

  /// The same entries, in the order they came, as an ordinary dictionary; absent when a value has no ordinary
  /// form.
  [[nodiscard]] std::optional<Dictionary> ordinary() const;

 private:
  struct Descriptor {
    Text key;
    std::shared_ptr<const FileDescriptor> descriptor;
  };

  void setValue(Text key, Value value);

  Dictionary values_;
  std::vector<Descriptor> descriptors_;
};

}  // namespace vesk
