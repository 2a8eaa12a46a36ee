#pragma once

#include <gtest/gtest.h>
#include <string>

#include "messages/message_classes.h"

namespace vesk {

inline std::string nameOfTest(const testing::TestParamInfo<MessageClass>& test) {
  return std::string(test.param.name);
}

}  // namespace vesk
