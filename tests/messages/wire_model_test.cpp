#include "messages/wire_model.h"

#include <gtest/gtest.h>
#include <random>

#include "messages/every_message.h"
#include "messages/filled_message.h"
#include "support/bytes.h"
#include "values/text_form.h"

namespace vesk {
namespace {

/// Damages payloads in the ways in which they are damaged on the wire, and in some in which they are not. The same
/// payloads in every run.
class Damage {
 public:
  void applyTo(Bytes& payload) {
    for (std::size_t times = 1 + below(3); times > 0; --times) {
      const auto place = payload.begin() + static_cast<std::ptrdiff_t>(below(payload.size() + 1));
      if (place == payload.end()) {
        payload.push_back(byte());
        continue;
      }
      switch (below(4)) {
        case 0:
          *place = byte();
          break;
        case 1:
          *place ^= static_cast<std::uint8_t>(1U << below(8));
          break;
        case 2:
          payload.insert(place, 1 + below(11), byte());
          break;
        default:
          payload.erase(place, std::min(place + 1 + static_cast<std::ptrdiff_t>(below(4)), payload.end()));
      }
    }
  }

 private:
  std::size_t below(std::size_t end) { return random_() % end; }
  /// Now and then one that means something: the keys of groups, a long number, a wire type that there is not.
  std::uint8_t byte() {
    constexpr std::uint8_t kTelling[] = {0x00, 0x0B, 0x0C, 0x7F, 0x80, 0x9A, 0xFF, 0x0E};
    return static_cast<std::uint8_t>(below(2) == 0 ? kTelling[below(std::size(kTelling))] : below(256));
  }

  std::mt19937 random_{20261125};
};

class WireModel : public testing::TestWithParam<MessageClass> {};
INSTANTIATE_TEST_SUITE_P(Schema, WireModel, testing::ValuesIn(metrics::kEveryMessage), nameOfTest);

TEST_P(WireModel, AgreesWithTheGeneratedReaderOnDamagedPayloads) {
  const Bytes whole = filledMessage(GetParam().name, Filling::small).payload;
  Damage damage;
  std::size_t accepted = 0;
  constexpr std::size_t kTries = 300;
  for (std::size_t tried = 0; tried < kTries; ++tried) {
    Bytes payload = whole;
    damage.applyTo(payload);
    const std::optional<Dictionary> expected = modelledDictionary(GetParam().name, payload);
    const auto message = GetParam().decode(payload);
    ASSERT_EQ(message != nullptr, expected.has_value()) << hexOf(payload);
    if (message == nullptr) continue;
    ++accepted;
    EXPECT_EQ(message->dictionaryRepresentation(), *expected) << hexOf(payload);
    EXPECT_EQ(textOf(message->dictionaryRepresentation()), textOf(*expected)) << hexOf(payload);
  }
  // Otherwise the damage is too small or too great to tell anything.
  EXPECT_GT(accepted, kTries / 20);
  EXPECT_LT(accepted, kTries - kTries / 20);
}

}  // namespace
}  // namespace vesk
