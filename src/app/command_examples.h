#pragma once

/// What stands below the options in the help of the program and of each subcommand. Lines have at most 80 columns.
namespace vesk {

inline constexpr const char* kExamples =
    "Examples:\n"
    "  vesk                                   walk the screens of a simulated drive\n"
    "  vesk --replay drive.jsonl              the screens while a drive is replayed\n"
    "  vesk --replay drive.jsonl --speed 10   the same, ten times as fast\n"
    "  tail -f live.jsonl | vesk --replay -   the screens on a live pipe\n"
    "  vesk --headless --replay drive.jsonl   the diagnostic lines, no screens\n"
    "  vesk --diag /dev/ttyUSB0               the screens on a real modem\n"
    "\n"
    "A recording has one event a line:\n"
    "  {\"at\": 12.5, \"metric\": \"0x3C4E04\", \"payload\": \"1003\"}\n"
    "\n"
    "Exit status: 0 done, 1 something failed, 2 wrong usage, 3 a rule fired.\n"
    "vesk SUBCOMMAND --help tells more of a subcommand.";

inline constexpr const char* kDecodeExamples =
    "One JSON object an event, on one line (here in two):\n"
    "  {\"at\":12.5,\"metric\":\"0x3C4E04\",\"class\":\"KCellularLteRrcState\",\n"
    "   \"status\":\"decoded\",\"fields\":{\"state\":\"KLTE_RRC_STATE_CONNECTED\"}}\n"
    "The status is decoded, undecodable (the payload is damaged) or ignored (no\n"
    "class knows the metric).\n"
    "\n"
    "Examples:\n"
    "  vesk decode drive.jsonl | jq -r '.fields.state // empty'\n"
    "  tail -f live.jsonl | vesk decode";

inline constexpr const char* kStoresExamples =
    "Examples:\n"
    "  vesk stores drive.jsonl | jq .LTE.SelReselCellInfo\n"
    "  vesk stores drive.jsonl | jq .dictionaries.myLTERRCStateDict.state";

inline constexpr const char* kShowExamples =
    "Examples:\n"
    "  vesk show LTE \"Serving Cell Meas\" drive.jsonl\n"
    "  vesk show UMTS \"Tx Power\" drive.jsonl --json | jq '.sections[].rows'";

inline constexpr const char* kSummaryExamples =
    "Examples:\n"
    "  vesk summary drive.jsonl\n"
    "  vesk summary --json drive.jsonl | jq '.kpis[\"lte.rsrp\"].median'";

inline constexpr const char* kTimelineExamples =
    "A rule is a KPI compared with a number, for a time if given, or a kind of event:\n"
    "  lte.rsrp < -110 for 10 s\n"
    "  event no-service\n"
    "When one fires an alert is printed, and the exit status is 3.\n"
    "\n"
    "Examples:\n"
    "  vesk timeline drive.jsonl\n"
    "  vesk timeline --json drive.jsonl | jq -c 'select(.kind == \"reestablished\")'\n"
    "  vesk timeline --rule 'lte.rsrp < -110 for 10 s' drive.jsonl | grep alert";

inline constexpr const char* kSeriesExamples =
    "A line for each event that reports a KPI, with all that are known then. A value\n"
    "is known for 30 s.\n"
    "\n"
    "Examples:\n"
    "  vesk series drive.jsonl\n"
    "  vesk series --csv drive.jsonl > drive.csv";

inline constexpr const char* kReadingsExamples =
    "At the end of the recording, as the screens are then; with the cells heard.\n"
    "\n"
    "Examples:\n"
    "  vesk readings drive.jsonl\n"
    "  vesk readings --json drive.jsonl | jq '.heard[] | select(.role == \"serving\")'";

inline constexpr const char* kReportExamples =
    "One file with charts, cells, timeline and screens. It opens in any browser and\n"
    "asks for nothing else; --redact keeps identities out of it.\n"
    "\n"
    "Examples:\n"
    "  vesk report drive.jsonl -o drive.html\n"
    "  vesk report --redact drive.jsonl -o shareable.html";

inline constexpr const char* kServeExamples =
    "The page is at http://127.0.0.1:8080, JSON at /api/summary, /api/cells,\n"
    "/api/timeline, /api/series and /api/screens, metrics for Prometheus at /metrics.\n"
    "\n"
    "Examples:\n"
    "  vesk serve                                 a simulated drive\n"
    "  vesk serve --replay drive.jsonl --loop     a recording, over and over\n"
    "  curl -s 127.0.0.1:8080/api/cells | jq '.[] | select(.role == \"serving\")'";

inline constexpr const char* kRedactExamples =
    "Masked are IMSI, TMSI, addresses, access points' names, call identifiers and the\n"
    "contents of SIM files that name a subscriber. Cells, areas and times stay.\n"
    "\n"
    "Examples:\n"
    "  vesk redact drive.jsonl > shareable.jsonl\n"
    "  vesk simulate --seconds 600 | vesk redact | vesk decode";

inline constexpr const char* kSimulateExamples =
    "Examples:\n"
    "  vesk simulate --seconds 600 > drive.jsonl\n"
    "  vesk simulate --seed 7 | vesk show LTE \"RRC State\" -";

inline constexpr const char* kImportExamples =
    "A capture is what a program kept of a modem's diagnostic port: QMDL, .mi2log or\n"
    "DLF, told by its content, also compressed with gzip. It becomes a recording.\n"
    "\n"
    "Examples:\n"
    "  vesk import drive.qmdl > drive.jsonl\n"
    "  vesk import --count drive.qmdl         what it holds, and what is read of it\n"
    "  vesk import drive.qmdl | vesk show LTE \"RRC State\" -";

}  // namespace vesk
