#include "handset/behaviour/sim_card.h"

#include <gtest/gtest.h>
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

class SimCardTest : public testing::Test {
 protected:
  [[nodiscard]] std::span<const std::uint8_t> file(std::uint32_t id) const {
    for (std::size_t index = 0; index < files_.efListsCount(); ++index) {
      if (files_.efListAtIndex(index)->efId() == id) return files_.efListAtIndex(index)->content()->bytes();
    }
    ADD_FAILURE() << "no file " << id;
    return {};
  }

  Random random_{42};
  Registration registration_{random_};
  metrics::KCellularSimCardFiles files_ = readSimFiles(registration_.subscriber(), registration_.identity());
};

TEST_F(SimCardTest, TheIccIdIsOfTheTestCountryAndHasItsCheckDigit) {
  const std::string digits = digitsOf(file(0x2FE2));
  EXPECT_EQ(digits.size(), 19U);
  EXPECT_EQ(digits.substr(0, 5), "89001");
  EXPECT_TRUE(isValidByLuhn(digits)) << digits;
  EXPECT_EQ(withCheckDigit("7992739871"), "79927398713");
}

TEST_F(SimCardTest, TheImsiIsOfTheTestNetworkAndTheOtherFilesFollowIt) {
  const auto content = file(0x6F07);
  ASSERT_EQ(content.size(), 9U);
  EXPECT_EQ(content[0], 8);
  EXPECT_EQ(content[1] & 0xF, 9);
  const std::string imsi = static_cast<char>('0' + (content[1] >> 4)) + digitsOf(content.subspan(2));
  EXPECT_EQ(imsi, registration_.subscriber().imsi);
  EXPECT_EQ(imsi.substr(0, 5), "00101");
  const auto accessClass = file(0x6F78);
  EXPECT_EQ(accessClass[0] << 8 | accessClass[1], 1 << (imsi.back() - '0'));
  EXPECT_EQ(file(0x6FAD)[3], 2);
}

TEST_F(SimCardTest, TheNetworkIsCodedDigitByDigit) {
  EXPECT_EQ(encodedPlmn(1), (Bytes{0x00, 0xF1, 0x10}));
  EXPECT_EQ(encodedPlmn(27), (Bytes{0x00, 0xF1, 0x72}));
}

TEST_F(SimCardTest, FilesHaveTheSizesOfTheStandard) {
  const std::pair<std::uint32_t, std::size_t> sizes[] = {
      {0x2FE2, 10}, {0x6F46, 17}, {0x6F62, 5},  {0x6F73, 14}, {0x6F7B, 12},
      {0x6F7E, 11}, {0x6FAD, 4},  {0x6FE3, 18}, {0x6F40, 24}, {0x6F78, 2},
  };
  for (const auto& [id, size] : sizes)
    EXPECT_EQ(file(id).size(), size) << std::hex << id;
}

}  // namespace
}  // namespace vesk::handset
