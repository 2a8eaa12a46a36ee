#include "corvik/inter_process_dictionary.h"

#include <gtest/gtest.h>

#include "values/text_form.h"

namespace vesk {
namespace {

TEST(InterProcessDictionary, BecomesAnOrdinaryOneUnlessAValueHasNoOrdinaryForm) {
  InterProcessDictionary message;
  message.setInteger("id"_text, -7);
  const std::uint8_t bytes[] = {0x08, 0x95};
  message.setData("payload"_text, Data::copy(bytes));
  message.setInteger("id"_text, 9);
  EXPECT_EQ(textOf(*message.ordinary()), "{id: 9, payload: 0x0895}");
  EXPECT_EQ(message.integer("id"_text), 9);
  EXPECT_EQ(message.integer("payload"_text), std::nullopt);
  EXPECT_EQ(message.data("id"_text), nullptr);

  message.setDescriptor("payload"_text, FileDescriptor::borrowed(0));
  EXPECT_EQ(message.data("payload"_text), nullptr);
  EXPECT_EQ(message.size(), 2U);
  EXPECT_EQ(message.ordinary(), std::nullopt);
  message.setData("payload"_text, Data());
  EXPECT_EQ(message.descriptor("payload"_text), nullptr);
}

}  // namespace
}  // namespace vesk
