// The program itself, as a user runs it.

#include "app/vesk_program.h"

namespace vesk {
namespace {

const std::string kConnected = R"({"at": 12.5, "metric": "0x3C4E04", "payload": "1003"})";
const std::string kConnectedDecoded =
    R"({"at":12.5,"metric":"0x3C4E04","class":"KCellularLteRrcState","status":"decoded",)"
    R"("fields":{"state":"KLTE_RRC_STATE_CONNECTED"}})";

TEST(Decode, WritesALineForEveryEvent) {
  struct Case {
    std::string event;
    std::string line;
  };
  const Case cases[] = {
      {kConnected, kConnectedDecoded},
      {R"({"at": 0, "metric": 3952132, "payload": ""})",
       R"({"at":0.0,"metric":"0x3C4E04","class":"KCellularLteRrcState","status":"decoded","fields":{}})"},
      {R"({"at": 1, "metric": "0x3C4E04", "payload": "10"})",
       R"({"at":1.0,"metric":"0x3C4E04","class":"KCellularLteRrcState","status":"undecodable","fields":null})"},
      // Known, but without a class; in its 16-bit form; never heard of.
      {R"({"at": 1, "metric": "0x3c4e25", "payload": "10"})",
       R"({"at":1.0,"metric":"0x3C4E25","class":null,"status":"ignored","fields":null})"},
      {R"({"at": 1, "metric": 19972, "payload": "1003"})",
       R"({"at":1.0,"metric":"0x4E04","class":null,"status":"ignored","fields":null})"},
      {R"({"at": 1, "metric": 0, "payload": ""})",
       R"({"at":1.0,"metric":"0x0","class":null,"status":"ignored","fields":null})"},
      {R"({"at": 1, "metric": "0x3CD50D", "payload": "08FFFFFFFFFFFFFFFFFF011A0B1A0561220A62FF2A0213F0"})",
       R"({"at":1.0,"metric":"0x3CD50D","class":"KCellularActivatedBearerContexts","status":"decoded",)"
       "\"fields\":{\"timestamp\":18446744073709551615,"
       "\"bearer_contexts\":[{\"apn\":\"a\\\"\\nb\uFFFD\",\"pdp_addr\":\"0x13f0\"}]}}"},
      {R"({"at": 1, "metric": "0x3CD30E", "payload": "12020307"})",
       R"({"at":1.0,"metric":"0x3CD30E","class":"KCellularLteSelReselCellInfo","status":"decoded",)"
       R"("fields":{"multi_band_info":[3,7]}})"},
  };
  std::string events;
  std::string lines;
  for (const Case& row : cases) {
    EXPECT_EQ(vesk({"decode"}, row.event).output, row.line + '\n');
    events += row.event + '\n';
    lines += row.line + '\n';
  }
  const Finished all = vesk({"decode", "-"}, events);
  EXPECT_EQ(all.output, lines);
  EXPECT_EQ(all.error, "");
  EXPECT_EQ(all.status, 0);
}

TEST(Decode, GoesOnBehindLinesThatAreNoEvent) {
  const TemporaryFile recording(kConnected + "\nbad\n\n{\"at\": 1}\n" + kConnected);
  const std::string& path = recording.path();
  const Finished file = vesk({"decode", path});
  EXPECT_EQ(file.output, kConnectedDecoded + '\n' + kConnectedDecoded + '\n');
  EXPECT_EQ(file.error, path + ":2: no JSON object\n" + path + ":4: \"metric\": missing\n");
  EXPECT_EQ(file.status, 1);
}

TEST(Decode, TellsWhatItCannotRead) {
  struct Case {
    std::vector<std::string> arguments;
    int status;
    std::string error;
  };
  const Case cases[] = {
      {{"decode", "/no/such/file"}, 1, "vesk: /no/such/file: No such file or directory\n"},
      {{"decode", "/"}, 1, "vesk: /: Is a directory\n"},
      {{"decode", "--log", "/no/such/log"}, 1, "vesk: the log cannot go to /no/such/log: No such file or directory\n"},
      {{"unknown"}, 2, "unknown"},
      {{"decode", "a", "b"}, 2, "b"},
      {{"decode", "--unknown"}, 2, "--unknown"},
      {{"decode", "--log"}, 2, "--log"},
  };
  for (const Case& row : cases) {
    const Finished finished = vesk(row.arguments, kConnected);
    EXPECT_EQ(finished.status, row.status) << row.error;
    EXPECT_EQ(finished.output, "");
    if (row.status == 1) {
      EXPECT_EQ(finished.error, row.error);
    } else {
      EXPECT_NE(finished.error.find(row.error), std::string::npos) << finished.error;
    }
  }
}

TEST(Decode, WritesAnEventBeforeItWaitsForTheNext) {
  Pipe input;
  Pipe output;
  const FileDescriptor error = fileWith("");
  ChildProcess process(VESK_PROGRAM, {"decode"}, input.reading, output.writing, error);
  output.writing = FileDescriptor();
  writeAll(input.writing, kConnected + "\n");
  EXPECT_EQ(readLine(output.reading), kConnectedDecoded);
  // An event in two pieces, and the start of one that never ends.
  writeAll(input.writing, kConnected.substr(0, 20));
  writeAll(input.writing, kConnected.substr(20) + "\n{\"at\": 1");
  EXPECT_EQ(readLine(output.reading), kConnectedDecoded);
  input.writing = FileDescriptor();
  EXPECT_EQ(process.waitForExit(), 1);
  EXPECT_EQ(readLine(output.reading), "");
  EXPECT_EQ(contentOf(error), "standard input:3: does not end with the object's closing brace: is the line cut off?\n");
}

TEST(Decode, EndsWhenNobodyReadsItsOutput) {
  Pipe input;
  Pipe output;
  const FileDescriptor error = fileWith("");
  ChildProcess process(VESK_PROGRAM, {"decode"}, input.reading, output.writing, error);
  output = Pipe();
  // It does not wait for the end of its input, which is still open.
  writeAll(input.writing, kConnected + "\n");
  EXPECT_EQ(process.waitForExit(), 1);
  EXPECT_EQ(contentOf(error), "vesk: standard output: Broken pipe\n");
}

TEST(Decode, LogsWhereItIsToldTo) {
  const std::string wrapped = R"({"at": 1, "metric": "0x3C4E04", "payload": "A2E009021003"})";
  const Finished silent = vesk({"decode"}, wrapped);
  EXPECT_EQ(silent.error, "");
  const Finished logged = vesk({"decode", "--log", "stderr"}, wrapped);
  EXPECT_EQ(logged.output, silent.output);
  EXPECT_NE(logged.error.find("valid metricId tag"), std::string::npos) << logged.error;
  EXPECT_NE(logged.error.find("Unknown tag: 4e04:2"), std::string::npos) << logged.error;
}

}  // namespace
}  // namespace vesk
