#include "corvik/inter_process_dictionary.h"

#include <algorithm>

namespace vesk {

void InterProcessDictionary::setValue(Text key, Value value) {
  std::erase_if(descriptors_, [&](const Descriptor& each) { return each.key == key; });
  values_.set(std::move(key), std::move(value));
}

void InterProcessDictionary::setDescriptor(Text key, FileDescriptor descriptor) {
  values_.erase(key);
  std::erase_if(descriptors_, [&](const Descriptor& each) { return each.key == key; });
  descriptors_.push_back({std::move(key), std::make_shared<const FileDescriptor>(std::move(descriptor))});
}

std::optional<std::int64_t> InterProcessDictionary::integer(const Text& key) const {
  const Value* value = values_.find(key);
  return value == nullptr ? std::nullopt : value->integer();
}

const Data* InterProcessDictionary::data(const Text& key) const {
  const Value* value = values_.find(key);
  return value == nullptr ? nullptr : value->data();
}

const FileDescriptor* InterProcessDictionary::descriptor(const Text& key) const {
  const auto found =
      std::find_if(descriptors_.begin(), descriptors_.end(), [&](const Descriptor& each) { return each.key == key; });
  return found == descriptors_.end() ? nullptr : found->descriptor.get();
}

std::optional<Dictionary> InterProcessDictionary::ordinary() const {
  if (!descriptors_.empty()) return std::nullopt;
  return values_;
}

}  // namespace vesk
