#include <gtest/gtest.h>

#include "app/commands/suggestion.h"
#include "app/output/progress.h"
#include "app/vesk_program.h"

namespace vesk {
namespace {

TEST(Suggestion, NamesTheNearestUnlessAllAreFar) {
  const std::vector<std::string> candidates{"decode", "stores", "Tx Power", "LTE"};
  EXPECT_EQ(suggestionFor("decoed", candidates), "; did you mean decode");
  EXPECT_EQ(suggestionFor("power", candidates, "'"), "; did you mean 'Tx Power'");
  EXPECT_EQ(suggestionFor("replay", candidates), "");
  EXPECT_EQ(suggestionFor("", candidates), "");
  EXPECT_EQ(suggestionFor(std::string(100000, 'x'), candidates), "");
}

TEST(Progress, GroupsTheDigits) {
  EXPECT_EQ(progressText(999, std::nullopt), "999 events");
  EXPECT_EQ(progressText(1200000, 0.439), "1,200,000 events, 43%");
  EXPECT_EQ(progressText(1000000, 7.0), "1,000,000 events, 100%");
}

TEST(CommandLine, AnswersMistakesWithWhatToTypeInstead) {
  struct Case {
    std::vector<std::string> arguments;
    std::string error;
  };
  const Case cases[] = {
      {{"--sped=3"}, "vesk: no option --sped; did you mean --speed; see vesk --help\n"},
      {{"decoed"}, "vesk: no subcommand decoed; did you mean decode; see vesk --help\n"},
      {{"show", "LTE", "NAS", "--jsn"}, "vesk: no option --jsn; did you mean --json; see vesk show --help\n"},
      {{"show", "LTE", "Tx", "Power", "drive.jsonl"},
       "vesk: an argument too many: drive.jsonl (quote a name that holds blanks); see vesk show --help\n"},
      {{"show", "LTE"}, "vesk: CATEGORY is required; see vesk show --help\n"},
      {{"--speed", "x"}, "vesk: --speed: expected a positive number or max, got x; see vesk --help\n"},
  };
  for (const Case& row : cases) {
    const Finished finished = vesk(row.arguments);
    EXPECT_EQ(finished.error, row.error);
    EXPECT_EQ(finished.output, "");
    EXPECT_EQ(finished.status, 2) << row.error;
  }
}

TEST(CommandLine, TellsWhatARecordingLooksLikeWhenNoLineIsAnEvent) {
  const std::string hint =
      "vesk: standard input is no recording: no line of it is an event, as this one is: "
      "{\"at\": 12.5, \"metric\": \"0x3C4E04\", \"payload\": \"1003\"}\n";
  EXPECT_EQ(vesk({"--headless", "--replay", "-"}, "one\n").error, "standard input:1: no JSON object\n" + hint);
  for (const char* command : {"decode", "stores"}) {
    EXPECT_EQ(vesk({command, "-"}, "one\n").error, "standard input:1: no JSON object\n" + hint);
    EXPECT_EQ(vesk({command, "-"}, "").error, "");
    EXPECT_EQ(vesk({command, "-"}, "one\n{\"at\": 1, \"metric\": 1, \"payload\": \"\"}\n").error,
              "standard input:1: no JSON object\n");
  }
}

TEST(CommandLine, HelpFitsInEightyColumns) {
  for (const char* command : {"", "decode", "stores", "show", "simulate"}) {
    std::vector<std::string> arguments{"--help"};
    if (*command != '\0') arguments.insert(arguments.begin(), command);
    const Finished help = vesk(arguments);
    EXPECT_EQ(help.status, 0);
    std::size_t start = 0;
    for (std::size_t end = 0; (end = help.output.find('\n', start)) != std::string::npos; start = end + 1)
      EXPECT_LE(end - start, 80U) << help.output.substr(start, end - start);
    EXPECT_GT(start, 0U);
  }
}

}  // namespace
}  // namespace vesk
