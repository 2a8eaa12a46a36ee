#include "values/ordered_lookup.h"

namespace vesk {

const Value* OrderedLookup::findElsewhere(const Text& key) {
  const Dictionary::Entry* found = dictionary_.findEntry(key, next_);
  if (found == nullptr) return nullptr;
  next_ = found + 1;
  return &found->value;
}

}  // namespace vesk
