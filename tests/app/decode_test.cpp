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
      {R"({"at": 1, "metric": "0x3CD50D", "payload": "08FFFFFFFFFFFFFFFFFF011A0B1A0561220A62FF2A0213F0"})",
       R"({"at":1.0,"metric":"0x3CD50D","class":"KCellularActivatedBearerContexts","status":"decoded",)"
       "\"fields\":{\"timestamp\":18446744073709551615,"
       "\"bearer_contexts\":[{\"apn\":\"a\\\"\\nb\uFFFD\",\"pdp_addr\":\"0x13f0\"}]}}"},
  };
  std::string events;
  std::string lines;
  for (const Case& row : cases) {
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

TEST(Commands, TellWhatTheyCannotOpen) {
  struct Case {
    std::vector<std::string> arguments;
    std::string error;
  };
  const Case cases[] = {
      {{"decode", "/no/such/file"}, "vesk: /no/such/file: No such file or directory\n"},
      {{"decode", "/"}, "vesk: /: Is a directory\n"},
      {{"stores", "/no/such"}, "vesk: /no/such: No such file or directory\n"},
      {{"show", "LTE", "NAS", "/no/such"}, "vesk: /no/such: No such file or directory\n"},
      {{"--headless", "--log", "none", "--replay", "/no/such"}, "vesk: /no/such: No such file or directory\n"},
      {{"decode", "--log", "/no/such/log"}, "vesk: the log cannot go to /no/such/log: No such file or directory\n"},
      {{"show", "--log", "/no/such/log", "LTE", "NAS"},
       "vesk: the log cannot go to /no/such/log: No such file or directory\n"},
      {{"simulate", "--log", "/no/such/log"}, "vesk: the log cannot go to /no/such/log: No such file or directory\n"},
  };
  for (const Case& row : cases) {
    const Finished finished = vesk(row.arguments, kConnected);
    EXPECT_EQ(finished.status, 1) << row.error;
    EXPECT_EQ(finished.output, "");
    EXPECT_EQ(finished.error, row.error);
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

TEST(Commands, LogWhereTheyAreToldTo) {
  const std::string wrapped = R"({"at": 1, "metric": "0x3C4E04", "payload": "A2E009021003"})";
  for (const std::vector<std::string>& command : {std::vector<std::string>{"decode"}, {"show", "LTE", "NAS", "-"}}) {
    const Finished silent = vesk(command, wrapped);
    EXPECT_EQ(silent.error, "");
    std::vector<std::string> logging = command;
    logging.insert(logging.end(), {"--log", "stderr"});
    const Finished logged = vesk(logging, wrapped);
    EXPECT_EQ(logged.output, silent.output);
    EXPECT_NE(logged.error.find("Unknown tag: 4e04:2"), std::string::npos) << logged.error;
  }
}

}  // namespace
}  // namespace vesk
