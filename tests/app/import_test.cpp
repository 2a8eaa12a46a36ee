// The program itself, as a user runs it on a capture.

#include "app/vesk_program.h"
#include "diag/framing/frame.h"
#include "messages/nas/nas.h"
#include "messages/registry/metric_identifiers.h"
#include "support/bytes.h"

namespace vesk {
namespace {

std::string framed(std::string_view content) {
  Bytes frame;
  diag::appendFrame(frame, bytesOf(content));
  return {frame.begin(), frame.end()};
}

/// An LTE cell, framed.
const std::string kCellFrame = framed(
    "10 00 29 00 29 00 C2 B0 4C 6B 4E 4E 2A CA D3 00 03 B9 00 94 16 00 00 E4 5C 00 00 32 32 11 86 A4 02 08 54 11 00 00 "
    "00 36 01 03 9A 01 00");
/// The UMTS state 1 of SIM 2, framed.
const std::string kFrameOfSim2 = framed("98 01 00 00 02 00 00 00 10 00 0D 00 0D 00 25 41 4C 6B 4E 4E 2A CA D3 00 01");
/// An LTE serving measurement of which no subpacket is known.
const std::string kUnreadFrame =
    framed("10 00 1D 00 1D 00 93 B1 4C 6B 4E 4E 2A CA D3 00 01 03 00 00 1A 01 04 00 19 09 05 00 07 1A 01 04 00");
const std::string kDamage = "\x01\x02\x7E";
const std::string kCellRecording =
    R"({"at": 0.0, "metric": "0x3C40C2", "payload": "08e1bbb4eda42a10b90118942d20e4b9012814301438918c921540114888a801500358b602609a03"})"
    "\n"
    R"({"at": 0.0, "metric": "0x3CD30B", "payload": "08e1bbb4eda42a10942d280a"})"
    "\n";

TEST(Import, WritesARecordingOrATable) {
  const Finished imported = vesk({"import"}, kDamage + kCellFrame);
  EXPECT_EQ(imported.output, kCellRecording);
  EXPECT_EQ(imported.error, "standard input: 1 damaged packet was passed over\n");
  EXPECT_EQ(imported.status, 0);

  const Finished counted = vesk({"import", "--count", "-"}, kDamage + kCellFrame + kUnreadFrame);
  EXPECT_EQ(counted.output.substr(counted.output.find('\n') + 1),
            "B0C2          3  LTE serving cell                                 1            0           0\n"
            "B193          1  LTE serving measurement                          0            1           0\n"
            "B193     1:25/9  subpackets 25, version 9                         0            1           0\n"
            "B193     1:26/1  subpackets 26, version 1                         0            2           0\n"
            "-             -  frames                                           0            0           1\n");
}

TEST(Import, TellsWhatIsNoCapture) {
  const struct {
    std::string input;
    std::string reason;
  } cases[] = {
      {"", "is empty"},
      {kCellRecording, "is a recording already"},
      {"text\n", "is text, and no capture of a diagnostic port"},
      {"\xD4\xC3\xB2\xA1 1234", "is a capture of a network (pcap), and not of a diagnostic port"},
      {"PK\x03\x04", "is an archive or compressed in a way that is not read: unpack it first"},
  };
  for (const auto& row : cases) {
    const Finished refused = vesk({"import"}, row.input);
    EXPECT_EQ(refused.error, "vesk: standard input " + row.reason + '\n');
    EXPECT_EQ(refused.output, "");
    EXPECT_EQ(refused.status, 1);
  }
}

TEST(Capture, IsTakenWhereverARecordingIs) {
  const TemporaryFile capture(kCellFrame);
  const TemporaryFile recording(kCellRecording);
  const std::vector<std::vector<std::string>> commands = {
      {"decode"}, {"stores"}, {"show", "LTE", "Serving Cell Info"}, {"--headless", "--speed", "max", "--replay"}};
  for (const std::vector<std::string>& command : commands) {
    std::vector<std::string> onCapture = command;
    std::vector<std::string> onRecording = command;
    onCapture.push_back(capture.path());
    onRecording.push_back(recording.path());
    const Finished taken = vesk(onCapture);
    EXPECT_EQ(taken.output, vesk(onRecording).output);
    EXPECT_EQ(taken.status, 0) << taken.error;
    onCapture.back() = "-";
    EXPECT_EQ(vesk(onCapture, kCellFrame).output, taken.output);
  }
}

TEST(Capture, IsReadForTheSimThatIsChosen) {
  const TemporaryFile both(kCellFrame + kFrameOfSim2);
  const TemporaryFile second(kFrameOfSim2);
  const TemporaryFile recording(kCellRecording);
  const std::vector<std::vector<std::string>> commands = {
      {"import"}, {"redact"}, {"decode"}, {"stores"}, {"timeline"}, {"--headless", "--speed", "max", "--replay"}};
  for (const std::vector<std::string>& command : commands) {
    const auto run = [&](const TemporaryFile& file, std::vector<std::string> arguments) {
      arguments.insert(arguments.begin(), command.begin(), command.end());
      arguments.insert(arguments.begin() + static_cast<std::ptrdiff_t>(command.size()), file.path());
      return vesk(arguments);
    };
    EXPECT_NE(run(both, {}).error.find("it holds the SIMs 1 and 2, and all are taken"), std::string::npos);
    EXPECT_EQ(run(both, {"--sim", "2"}).output, run(second, {}).output) << command[0];
    EXPECT_NE(run(recording, {"--sim", "2"}).error.find(" is a recording"), std::string::npos) << command[0];
  }
}

TEST(Record, KeepsNoIdentitiesWhereTheyAreLeftOut) {
  const auto bearer = std::make_shared<metrics::BearerContext>();
  bearer->setApn("private.mnc410"_text);
  metrics::KCellularActivatedBearerContexts bearers;
  bearers.addBearerContexts(bearer);
  const TemporaryFile recording(recorded(0, K_CELLULAR_ACTIVE_BEARER, bearers));
  const TemporaryFile kept("");
  EXPECT_EQ(
      vesk({"--headless", "--speed", "max", "--redact", "--replay", recording.path(), "--record", kept.path()}).status,
      0);
  const std::string events = vesk({"decode", kept.path()}).output;
  EXPECT_NE(events.find("xxxxxxx.mnc410"), std::string::npos) << events;
  EXPECT_EQ(events, vesk({"decode", "--redact", recording.path()}).output);
}

TEST(Record, KeepsWhatComesAndOverwritesNothing) {
  const TemporaryFile recording(kCellRecording);
  const TemporaryFile kept("");
  const std::vector<std::string> command = {"--headless",     "--speed",  "max",      "--replay",
                                            recording.path(), "--record", kept.path()};
  EXPECT_EQ(vesk(command).status, 0);
  EXPECT_EQ(vesk({"decode", kept.path()}).output, vesk({"decode", recording.path()}).output);
  const Finished refused = vesk(command);
  EXPECT_EQ(refused.error,
            "vesk: " + kept.path() + ": holds something already, which would be lost; choose another name\n");
  EXPECT_EQ(refused.status, 1);
}

}  // namespace
}  // namespace vesk
