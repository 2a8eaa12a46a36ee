#pragma once

#include "values/value.h"

namespace vesk {

/// Finds the values of a dictionary under one key after another. It may be asked in any order; in that in which the
/// dictionary has the keys, each is found at the first look. Valid until the dictionary changes.
class OrderedLookup {
 public:
  explicit OrderedLookup(const Dictionary& dictionary)
      : dictionary_(dictionary), next_(dictionary.begin()), end_(dictionary.end()) {}

  /// The value under `key`, or null.
  [[nodiscard]] const Value* find(const Text& key) {
    if (next_ != end_ && next_->key.isSameAs(key)) return &next_++->value;
    return findElsewhere(key);
  }

 private:
  [[nodiscard]] const Value* findElsewhere(const Text& key);

  const Dictionary& dictionary_;
  /// Behind the entry found last: where the next key is expected.
  const Dictionary::Entry* next_;
  const Dictionary::Entry* end_;
};

}  // namespace vesk
