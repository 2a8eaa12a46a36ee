#include <gtest/gtest.h>

#include "support/fake_interface.h"
#include "support/pictures.h"
#include "terminal/small_drive.h"

namespace vesk {
namespace {

using namespace insight;

/// The overview of a drive with carriers, C-DRX and bearers.
std::string overviewAt(Size size) {
  Drive drive(smallDrive());
  drive.play({carriers(21'000, {{1, SccState::SCC_STATE_ACTIVATED, 2000, 62, -90}}), cdrx(21'500, 1, 10),
              bearers(22'000, {5, 7})});
  Surroundings surroundings;
  surroundings.drive = &drive.insight;
  FakeInterface interface;
  Desk desk(interface.stack(), size, surroundings);
  desk.type(U"o");
  return desk.picture();
}

TEST(Overview, FillsAWideTerminal) {
  EXPECT_EQ(overviewAt({120, 40}), R"(
| Vesk › Overview
|┌─ SERVING  LTE ──────────────────────────────────────────────────┬─ CONNECTION ───────────── 2018-01-20 21:53:05 UTC ─┐
|│  PCI 338   eNB 191040 / 17   TAI 310-410 19980                  │ RRC     CONNECTED   4.8 s   REEST OTHER FAIL       │
|│  EARFCN 5815   B17 742.5 MHz, UL 712.5 MHz                      │ EMM     NORMAL SERVICE                             │
|│▸ RSRP    -88 dBm ██████████████░░░░░░ good       60 s -112…-88  │ C-DRX   on 10 of 320 ms                            │
|│  RSRQ      -9 dB ███████████████░░░░░ good       60 s -15…-9    │ CA      SCC 1 PCI 62 B4 2000, 5 MHz, active        │
|│  SINR          – not reported                                   │ Tx      –                                          │
|│  RRC CONNECTED 4.8 s   serves 15.0 s   age 0.0 s                │ Bearers 2   5 internet   7                         │
|│  Srxlev +34 dB over QRxLevMin -122 dBm   measured PCI agrees    │                                                    │
|│  next PCI 316 B17 5815, -112 dBm, -24 dB                        │                                                    │
|├─ RSRP dBm, 2 min 46 s ──────────────────────────────────────────┴───────────────────────┬─ LAST 60 s ────────────────┤
|│  -85                                                                                   ▃│ R re-established         1 │
|│  -90                                                                                   █│ C cell changes           1 │
|│  -95                                                                            ▆▆▆▆▆▆ █│ D dropped                0 │
|│ -100                                                                            ██████ █│ F failed                 0 │
|│ -105                                                                            ██████ █│ N no service             0 │
|│ -110                                                                       ▅▅▅▅▅██████ █│ X rejected               0 │
|│                                                                                 C    R  │ A alerts                 0 │
|├─ CELLS HEARD ───────────────────────────────────────────────────────────────────────────┴────────────────────────────┤
|│  RAT   band       channel    MHz  code  level  diff  quality                          age note                       │
|│▸ LTE   B17           5815  742.5   338    -88             -9 ██████████████░░░░░░   0.0 s serving                    │
|│  LTE   B4            2000 2115.0    62    -90    -2          █████████████░░░░░░░   0.0 s secondary                  │
|│  LTE   B17           5815  742.5   316   -112   -24      -15 ██████░░░░░░░░░░░░░░  24.0 s served 15.0 s ago          │
|│  LTE                                 7   -120   -32          ███░░░░░░░░░░░░░░░░░  23.5 s                            │
|│                                                                                                                      │
|│                                                                                                                      │
|│                                                                                                                      │
|├─ WHAT HAPPENED ──────────────────────────────────────────────────────────────────────────────────────────────────────┤
|│ 21:53:05.000  ca-activated   SCC 1 PCI 62 B4 2000, 5 MHz                                                             │
|│ 21:53:00.200  reestablished  PCI 338 B17 5815 CI 48906257 -> PCI 338 B17 5815 CI 48906257, REEST OTHER FAIL, 200 ms,…│
|│ 21:52:52.000  emm            NORMAL SERVICE                                                                          │
|│ 21:52:50.000  handover       PCI 316 B17 5815 -> PCI 338 B17 5815, -112 dBm, after 10.0 s                            │
|│ 21:52:40.000  area           TAI 310-410 19980                                                                       │
|│ 21:52:40.000  cell           PCI 316 B17 5815                                                                        │
|│ 21:52:40.000  technology     LTE                                                                                     │
|│                                                                                                                      │
|│                                                                                                                      │
|│                                                                                                                      │
|└──────────────────────────────────────────────────────────────────────────────────────────────────────────────────────┘
| ? help  Esc back  1 to 4 areas  t trend  e events  c cells  Space hold  q quit
)");
}

TEST(Overview, FillsAVeryWideTerminal) {
  EXPECT_EQ(overviewAt({200, 60}), R"(
| Vesk › Overview
|┌─ SERVING  LTE ──────────────────────────────────────────────────────────────────────────────────────────────┬─ CONNECTION ───────────────────────────────────────────────── 2018-01-20 21:53:05 UTC ─┐
|│  PCI 338   eNB 191040 / 17   TAI 310-410 19980                                                              │ RRC     CONNECTED   4.8 s   REEST OTHER FAIL                                           │
|│  EARFCN 5815   B17 742.5 MHz, UL 712.5 MHz                                                                  │ EMM     NORMAL SERVICE                                                                 │
|│▸ RSRP    -88 dBm ████████████████████████████░░░░░░░░░░░░ good       60 s -112…-88                          │ C-DRX   on 10 of 320 ms                                                                │
|│  RSRQ      -9 dB █████████████████████████████░░░░░░░░░░░ good       60 s -15…-9                            │ CA      SCC 1 PCI 62 B4 2000, 5 MHz, active                                            │
|│  SINR          – not reported                                                                               │ Tx      –                                                                              │
|│  RRC CONNECTED 4.8 s   serves 15.0 s   age 0.0 s                                                            │ Bearers 2   5 internet   7                                                             │
|│  Srxlev +34 dB over QRxLevMin -122 dBm   measured PCI agrees                                                │                                                                                        │
|│  next PCI 316 B17 5815, -112 dBm, -24 dB                                                                    │                                                                                        │
|├─ RSRP dBm, 2 min 33 s ──────────────────────────────────────────────────────────────────────────────────────┴─────────────────────────────────────────────────┬─ LAST 60 s ──────────────────────────┤
|│  -78                                                                                                                                                          │ R re-established                   1 │
|│                                                                                                                                                               │ C cell changes                     1 │
|│  -82                                                                                                                                                          │ D dropped                          0 │
|│                                                                                                                                                               │ F failed                           0 │
|│  -86                                                                                                                                                          │ N no service                       0 │
|│                                                                                                                                                              █│ X rejected                         0 │
|│  -90                                                                                                                                                         █│ A alerts                           0 │
|│                                                                                                                                                              █│ P ping-pongs                       0 │
|│  -94                                                                                                                                                         █│ T technology changes               0 │
|│                                                                                                                                                ██████████    █│ ┆ gaps                             0 │
|│  -98                                                                                                                                           ██████████    █│                                      │
|│                                                                                                                                                ██████████    █│                                      │
|│ -102                                                                                                                                           ██████████    █│                                      │
|│                                                                                                                                                ██████████    █│                                      │
|│ -106                                                                                                                                           ██████████    █│                                      │
|│                                                                                                                                                ██████████    █│                                      │
|│ -110                                                                                                                                           ██████████    █│                                      │
|│                                                                                                                                      ████████████████████    █│                                      │
|│ -114                                                                                                                                 ████████████████████    █│                                      │
|│                                                                                                                                      ████████████████████    █│                                      │
|│ -118                                                                                                                                 ████████████████████    █│                                      │
|│                                                                                                                                      ████████████████████    █│                                      │
|│ -122                                                                                                                                 ████████████████████    █│                                      │
|│                                                                                                                                               C         R     │                                      │
|├─ CELLS HEARD ─────────────────────────────────────────────────────────────────────────────────────────────────────────┬─ WHAT HAPPENED ───────────────────────┴──────────────────────────────────────┤
|│  RAT   band       channel    MHz  code  level  diff  quality                          age note                        │ 21:53:05.000  ca-activated   SCC 1 PCI 62 B4 2000, 5 MHz                     │
|│▸ LTE   B17           5815  742.5   338    -88             -9 ██████████████░░░░░░   0.0 s serving                     │ 21:53:00.200  reestablished  PCI 338 B17 5815 CI 48906257 -> PCI 338 B17 581…│
|│  LTE   B4            2000 2115.0    62    -90    -2          █████████████░░░░░░░   0.0 s secondary                   │ 21:52:52.000  emm            NORMAL SERVICE                                  │
|│  LTE   B17           5815  742.5   316   -112   -24      -15 ██████░░░░░░░░░░░░░░  24.0 s served 15.0 s ago           │ 21:52:50.000  handover       PCI 316 B17 5815 -> PCI 338 B17 5815, -112 dBm,…│
|│  LTE                                 7   -120   -32          ███░░░░░░░░░░░░░░░░░  23.5 s                             │ 21:52:40.000  area           TAI 310-410 19980                               │
|│                                                                                                                       │ 21:52:40.000  cell           PCI 316 B17 5815                                │
|│                                                                                                                       │ 21:52:40.000  technology     LTE                                             │
|│                                                                                                                       │                                                                              │
|│                                                                                                                       │                                                                              │
|│                                                                                                                       │                                                                              │
|│                                                                                                                       │                                                                              │
|│                                                                                                                       │                                                                              │
|│                                                                                                                       │                                                                              │
|│                                                                                                                       │                                                                              │
|│                                                                                                                       │                                                                              │
|│                                                                                                                       │                                                                              │
|│                                                                                                                       │                                                                              │
|│                                                                                                                       │                                                                              │
|│                                                                                                                       │                                                                              │
|│                                                                                                                       │                                                                              │
|│                                                                                                                       │                                                                              │
|│                                                                                                                       │                                                                              │
|└───────────────────────────────────────────────────────────────────────────────────────────────────────────────────────┴──────────────────────────────────────────────────────────────────────────────┘
| ? help  Esc back  1 to 4 areas  t trend  e events  c cells  Space hold  q quit
)");
}

}  // namespace
}  // namespace vesk
