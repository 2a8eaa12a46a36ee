// The commands that tell what a drive was, as a user runs them.

#include <filesystem>
#include <fstream>

#include "app/vesk_program.h"

namespace vesk {
namespace {

/// The RRC state at 2018-01-20 21:52:40 UTC and 91 ms later: an attempt, for mobile originated data, then connected.
const std::string kDrive = R"({"at": 0, "metric": "0x3C4E04", "payload": "08C0D8BCAC912C10022804"})"
                           "\n"
                           R"({"at": 0.091, "metric": "0x3C4E04", "payload": "089BD9BCAC912C10032804"})"
                           "\n";
const std::string kLines =
    "21:52:40.000  technology  LTE\n"
    "21:52:40.000  rrc  ATMPT CONNECTION, EST MO DATA\n"
    "21:52:40.091  rrc  CONNECTED, EST MO DATA, after 91 ms in ATMPT CONNECTION\n";

TEST(DriveCommands, TellWhatADriveWas) {
  struct Case {
    std::vector<std::string> arguments;
    std::string output;
    int status = 0;
  };
  for (const auto& [arguments, output, status] : std::vector<Case>{
           {{"timeline"}, kLines},
           {{"timeline", "-", "--rule", "event drop"}, kLines},
           {{"timeline", "--rule", "event rrc", "--rule", "event service", "-"},
            "21:52:40.000  technology  LTE\n"
            "21:52:40.000  rrc  ATMPT CONNECTION, EST MO DATA\n"
            "21:52:40.000  alert  event rrc\n"
            "21:52:40.091  rrc  CONNECTED, EST MO DATA, after 91 ms in ATMPT CONNECTION\n"
            "21:52:40.091  alert  event rrc\n",
            3},
           {{"series", "--csv"},
            "timestamp,technology,channel,code,lte.rsrp,lte.rsrq,lte.sinr,lte.tx_power.pusch,lte.tx_power.pucch,"
            "lte.scc.rsrp,lte.nbr.rsrp,umts.rscp,umts.ecno,umts.rssi,umts.tx_power,gsm.rxlev,gsm.rxqual,gsm.tx_"
            "power\n"},
           {{"summary"},
            "2 of 2 events, 2018-01-20 21:52:40 to 2018-01-20 21:52:40 UTC\n"
            "91 ms counted in 1 stretch, 0 gaps\n"
            "technology  LTE 100 %\n"
            "LTE connections: 1 attempted, 1 established, 0 failed, 0 dropped, 0 released\n"},
       }) {
    const Finished finished = vesk(arguments, kDrive);
    EXPECT_EQ(finished.output, output) << arguments.front();
    EXPECT_EQ(finished.error, "");
    EXPECT_EQ(finished.status, status);
  }
}

TEST(DriveCommands, GoOnBehindLinesThatAreNoEvent) {
  const TemporaryFile recording("bad\n" + kDrive);
  const Finished finished = vesk({"timeline", recording.path()});
  EXPECT_EQ(finished.output, kLines);
  EXPECT_EQ(finished.error, recording.path() + ":1: no JSON object\n");
  EXPECT_EQ(finished.status, 1);
}

TEST(DriveCommands, RefuseRulesThatAreNone) {
  const TemporaryFile rules(
      "\xEF\xBB\xBF# Weak\n\n  lte.rsrp < -110 for 10 s  # for long\n lte.rsrp for 10 s\nevent alert\n");
  const Finished file = vesk({"timeline", "--rules", rules.path()}, kDrive);
  EXPECT_EQ(file.output, "");
  EXPECT_EQ(file.error, "vesk: " + rules.path() + ":4:11: expected <, <=, >, >=, == or !=, got for\n" +
                            "vesk: " + rules.path() +
                            ":5:7: expected a kind of event, such as handover or no-service, got alert\n");
  EXPECT_EQ(file.status, 2);
  const Finished option = vesk({"--headless", "--seconds", "1", "--rule", "lte.rsrp < x"});
  EXPECT_EQ(option.error, "vesk: --rule \"lte.rsrp < x\", column 12: expected a number, got x\n");
  EXPECT_EQ(option.status, 2);
}

TEST(DriveCommands, HaveRunsWithoutScreensJudgeRules) {
  const TemporaryFile recording(kDrive);
  const Finished finished =
      vesk({"--headless", "--replay", recording.path(), "--speed", "max", "--rule", "event technology"});
  EXPECT_NE(finished.output.find("\nAlert: event technology\n"), std::string::npos);
  EXPECT_EQ(finished.status, 3);
  EXPECT_EQ(vesk({"serve", "--port", "0", "--replay", recording.path(), "--speed", "max", "--seconds", "0.3", "--rule",
                  "event technology"})
                .status,
            3);
}

TEST(DriveCommands, WriteAReportThatIsOneFile) {
  const TemporaryFile page("");
  Finished finished = vesk({"report", "-o", page.path()}, kDrive);
  EXPECT_EQ(finished.output + finished.error, "");
  EXPECT_EQ(finished.status, 0);
  const std::string report = vesk({"report"}, kDrive).output;
  EXPECT_EQ(vesk({"report", page.path() + "/none", "-o", page.path()}).status, 1);
  for (const char* part :
       {R"("title":"standard input")", R"("rrc","CONNECTED, EST MO DATA, after 91 ms in ATMPT CONNECTION"])",
        R"({"area":"LTE","category":"RRC State")", "</html>"})
    EXPECT_NE(report.find(part), std::string::npos) << part;
  finished = vesk({"report", "-o", page.path() + "/none"}, kDrive);
  EXPECT_EQ(finished.error, "vesk: " + page.path() + "/none: Not a directory\n");
  EXPECT_EQ(finished.status, 1);
}

TEST(DriveCommands, KeepAFileUntilAReportCanTakeItsPlace) {
  const std::filesystem::path folder = testing::TempDir() + "vesk-report-" + std::to_string(getpid());
  std::filesystem::create_directory(folder);
  const std::string recording = folder / "drive.jsonl";
  const std::string page = folder / "page.html";
  const std::string link = folder / "link";
  std::filesystem::create_symlink("page.html", link);
  const auto contentOf = [](const std::string& path) {
    std::ifstream file(path);
    return std::string(std::istreambuf_iterator<char>(file), {});
  };
  std::ofstream(recording) << kDrive;
  std::filesystem::create_hard_link(recording, page);
  for (const std::string& output : {recording, page, link}) {
    EXPECT_EQ(vesk({"report", recording, "-o", output}).status, 2) << output;
    EXPECT_EQ(contentOf(recording), kDrive);
  }
  std::filesystem::remove(page);
  EXPECT_EQ(vesk({"report", recording, "-o", link}).status, 0) << "a link to nothing yet";
  EXPECT_TRUE(std::filesystem::is_symlink(link));
  EXPECT_EQ(std::filesystem::status(page).permissions(), std::filesystem::perms(0600));
  const std::string written = contentOf(page);
  EXPECT_TRUE(written.ends_with("</html>\n\n")) << written.substr(written.size() - 20);
  for (const std::string& input : {recording + "x", std::string("/dev/null/x"), folder.string()})
    EXPECT_EQ(vesk({"report", input, "-o", page}).status, 1) << input;
  EXPECT_EQ(vesk({"report", "-o", page}, "no recording\n").status, 1);
  EXPECT_EQ(contentOf(page), written);
  EXPECT_EQ(vesk({"report", recording, "-o", "/dev/full"}).error, "vesk: /dev/full: No space left on device\n");
  EXPECT_EQ(vesk({"report", recording, "-o", "/dev/stdout"}).output, written);
  EXPECT_EQ(vesk({"report", recording, "-o", ""}).output, "");
  EXPECT_EQ(std::distance(std::filesystem::directory_iterator(folder), {}), 3) << "what was written aside is gone";
  std::filesystem::remove_all(folder);
}

TEST(DriveCommands, TellWhoCanReadWhatTheyServe) {
  struct Case {
    std::vector<std::string> arguments;
    std::string place;
    std::string warning;
  };
  const std::string everybody = "vesk: everybody who reaches this machine";
  for (const auto& [arguments, place, warning] : std::vector<Case>{
           {{"--bind", "localhost"}, "http://localhost:", ""},
           {{"--bind", "0.0.0.0"},
            "http://127.0.0.1:",
            "without a password, and the subscriber's identities; --redact"},
           {{"--bind", "0.0.0.0", "--redact"}, "http://127.0.0.1:", "can read the measurements, without a password\n"},
       }) {
    std::vector<std::string> all{"serve", "--port", "0", "--seconds", "0.01"};
    all.insert(all.end(), arguments.begin(), arguments.end());
    const Finished finished = vesk(all);
    EXPECT_EQ(finished.status, 0);
    EXPECT_TRUE(finished.error.starts_with("vesk: serving " + place)) << finished.error;
    EXPECT_EQ(finished.error.find(everybody) == std::string::npos, warning.empty()) << finished.error;
    EXPECT_NE(finished.error.find(warning), std::string::npos) << finished.error;
  }
}

TEST(DriveCommands, RefuseToServeWhereTheyCannot) {
  const Finished finished = vesk({"serve", "--bind", "everywhere", "--seconds", "1"});
  EXPECT_EQ(finished.error, "vesk: everywhere is no address\n");
  EXPECT_EQ(finished.status, 1);
}

}  // namespace
}  // namespace vesk
