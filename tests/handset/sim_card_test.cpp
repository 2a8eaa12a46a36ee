#include "handset/behaviour/sim_card.h"

#include <gtest/gtest.h>
#include <map>
#include <string>

#include "handset/model/digits.h"

namespace vesk::handset {
namespace {

/// The digits of a file coded two a byte, up to its filler.
std::string digitsOf(std::span<const std::uint8_t> bytes) {
  std::string digits;
  for (const std::uint8_t byte : bytes) {
    for (const int half : {byte & 0xF, byte >> 4}) {
      if (half < 10) digits += static_cast<char>('0' + half);
    }
  }
  return digits;
}

bool isValidByLuhn(const std::string& digits) {
  int sum = 0;
  for (std::size_t index = 0; index < digits.size(); ++index) {
    const int digit = digits[digits.size() - 1 - index] - '0';
    const int value = index % 2 == 1 ? 2 * digit : digit;
    sum += value > 9 ? value - 9 : value;
  }
  return sum % 10 == 0;
}

TEST(SimCardTest, FilesHoldTheNumbersOfTheSubscriberAsTheyAreCoded) {
  Random random(42);
  const Registration registration(random);
  const metrics::KCellularSimCardFiles files = readSimFiles(registration.subscriber(), registration.identity());
  std::map<std::uint32_t, std::span<const std::uint8_t>> contents;
  for (std::size_t index = 0; index < files.efListsCount(); ++index)
    contents[files.efListAtIndex(index)->efId()] = files.efListAtIndex(index)->content()->bytes();

  const std::string digits = digitsOf(contents.at(0x2FE2));
  EXPECT_EQ(digits.size(), 19U);
  EXPECT_EQ(digits.substr(0, 5), "89001");
  EXPECT_TRUE(isValidByLuhn(digits)) << digits;

  const auto content = contents.at(0x6F07);
  ASSERT_EQ(content.size(), 9U);
  EXPECT_EQ(content[0], 8);
  EXPECT_EQ(content[1] & 0xF, 9);
  const std::string imsi = static_cast<char>('0' + (content[1] >> 4)) + digitsOf(content.subspan(2));
  EXPECT_EQ(imsi, registration.subscriber().imsi);
  EXPECT_EQ(imsi.substr(0, 5), "00101");
  const auto accessClass = contents.at(0x6F78);
  EXPECT_EQ(accessClass[0] << 8 | accessClass[1], 1 << (imsi.back() - '0'));
  EXPECT_EQ(encodedPlmn(27), (Bytes{0x00, 0xF1, 0x72}));
}

}  // namespace
}  // namespace vesk::handset
