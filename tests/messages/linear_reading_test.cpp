// What a message costs grows no faster than its bytes. Neither of the two measures depends on time: the steps that the
// code takes, and the memory that it asks for, which bounds what it copies.

#include <functional>
#include <gtest/gtest.h>

#include "messages/messagegen/kinds.h"
#include "support/allocations.h"
#include "support/bytes.h"
#include "support/steps.h"

namespace vesk {
namespace {

using metrics::Kinds;

struct Cost {
  std::uint64_t steps;
  std::uint64_t bytes;
};

Cost costOf(const std::function<void()>& action) {
  const Cost before{stepsTaken(), allocatedBytes()};
  action();
  return {stepsTaken() - before.steps, allocatedBytes() - before.bytes};
}

/// All that can be done with a payload.
void use(const Bytes& payload) {
  const std::shared_ptr<Kinds> message = Kinds::initWithData(payload);
  if (message == nullptr) return;
  (void)message->description();
  ProtoWriter writer;
  message->writeTo(writer);
  const std::shared_ptr<Kinds> other = message->copyWithZone();
  (void)(message->isEqual(*other) && message->hash() == other->hash());
  message->copyTo(*other);
  other->mergeFrom(*message);
}

Bytes many(std::size_t times, std::string_view hex) {
  const Bytes one = bytesOf(hex);
  Bytes all;
  for (; times > 0; --times)
    all.insert(all.end(), one.begin(), one.end());
  return all;
}

/// `start`, then the length of the content, then the content.
Bytes sectionOf(std::string_view start, const Bytes& content) {
  Bytes section = bytesOf(start);
  for (std::size_t rest = content.size(); rest > 0; rest /= 128)
    section.push_back(static_cast<std::uint8_t>(rest % 128 + (rest < 128 ? 0 : 128)));
  section.insert(section.end(), content.begin(), content.end());
  return section;
}

struct Shape {
  std::string name;
  std::function<Bytes(std::size_t times)> payload;
};

Shape repeating(std::string name, std::string_view hex) {
  return {std::move(name), [hex](std::size_t times) { return many(times, hex); }};
}

const Shape kShapes[] = {
    repeating("OneScalarOverAndOver", "08 01"),
    repeating("OneMessageOverAndOver", "52 02 08 01"),
    repeating("ElementsOfTwoLists", "5A 02 08 01 62 02 08 01"),
    repeating("UnpackedNumbers", "68 05"),
    repeating("PackedListsOfOne", "72 01 05"),
    repeating("LongNumbers", "08 80 80 80 80 80 80 80 80 80 80"),
    repeating("LongKeys", "80 80 80 80 80 80 80 80 80 80 00"),
    repeating("GroupsThatNeverEnd", "A3 01"),
    repeating("SectionsOfMetricsInOneAnother", "9A 01 7F"),
    {"GroupsInGroups",
     [](std::size_t times) {
       return bytesOf(repeated(times, "A3 01" + repeated(99, "0B") + repeated(99, "0C") + "A4 01"));
     }},
    {"OnePackedList", [](std::size_t times) { return sectionOf("6A", many(times, "05")); }},
    {"OneText", [](std::size_t times) { return sectionOf("FA FF 1F", many(times, "61")); }},
    {"ElementsThatEndEarly", [](std::size_t times) { return many(times, "5A 03 0C 08 01"); }},
    {"OneElementOfOneScalarOverAndOver", [](std::size_t times) { return sectionOf("5A", many(times, "08 01")); }},
    {"OneElementThatIsCutOff",
     [](std::size_t times) {
       Bytes payload = sectionOf("5A", many(times, "08 01"));
       payload.pop_back();
       return payload;
     }},
};

class LinearReading : public testing::TestWithParam<Shape> {};
INSTANTIATE_TEST_SUITE_P(Kinds, LinearReading, testing::ValuesIn(kShapes),
                         [](const testing::TestParamInfo<Shape>& test) { return test.param.name; });

TEST_P(LinearReading, CostsFourTimesAsMuchForFourTimesTheBytes) {
  const Bytes small = GetParam().payload(1000);
  const Bytes large = GetParam().payload(4000);
  // The first use of a class makes what lasts as long as the program.
  use(small);
  const Cost ofSmall = costOf([&] { use(small); });
  const Cost ofLarge = costOf([&] { use(large); });
  EXPECT_GT(ofSmall.steps, 0U);
  EXPECT_LE(ofLarge.steps, 5 * ofSmall.steps);
  EXPECT_LE(ofLarge.bytes, 5 * ofSmall.bytes);

  constexpr std::uint64_t kMostStepsForAByte = 500;
  constexpr std::uint64_t kMostMemoryForAByte = 250;
  EXPECT_LE(ofLarge.steps, kMostStepsForAByte * large.size());
  EXPECT_LE(ofLarge.bytes, kMostMemoryForAByte * large.size());
}

}  // namespace
}  // namespace vesk
