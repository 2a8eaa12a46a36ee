#include "diag/layout/byte_reader.h"
#include "diag/layout/values.h"
#include "diag/nas/nas_logs.h"
#include "diag/nas/registration_status.h"
#include "diag/translation/event_batch.h"
#include "diag/translation/sim_state.h"

namespace vesk::diag {

namespace {

using namespace metrics;
using namespace notation;
using enum RegStatus;

constexpr std::uint8_t kEmmStateVersion = 2;
constexpr std::size_t kSize = 19;
constexpr std::uint8_t kGutiType = 6;

constexpr StatusOfState kStatuses[] = {
    {3, 0, KREG_STATUS_NORMAL_SERVICE},
    {3, 3, KREG_STATUS_NO_SERVICE},
    {3, 4, KREG_STATUS_NO_SERVICE},
    {3, 5, KREG_STATUS_LIMITED_SERVICE},
    {1, 1, KREG_STATUS_NO_SERVICE},
    {1, 3, KREG_STATUS_NO_SERVICE},
    {1, 6, KREG_STATUS_LIMITED_SERVICE},
    {1, 5, KREG_STATUS_AT_NOT_REGISTERED},
    {1, 2, KREG_STATUS_AT_NOT_REGISTERED},
    {1, 4, KREG_STATUS_AT_NOT_REGISTERED},
    {2, std::nullopt, KREG_STATUS_REGISTRATION_IN_PROGRESS},
    {4, std::nullopt, KREG_STATUS_REGISTRATION_IN_PROGRESS},
    {5, std::nullopt, KREG_STATUS_NORMAL_SERVICE},
    {6, std::nullopt, KREG_STATUS_SERVICE_DETACHED},
};

}  // namespace

Reading readEmmState(const LogPacket& packet, SimState& sim, EventBatch& events) {
  ByteReader body(packet.body);
  if (body.byte(0) != kEmmStateVersion) return Reading::passedOver;
  if (packet.body.size() < kSize) return Reading::damaged;

  setWhenKnown(sim.emm, &KCellularEmmContext::setRegStatus, statusOf(kStatuses, body.byte(1), body.get(h(2))));
  const bool isIdentityValid = body.byte(7) != 0;
  if (isIdentityValid && body.byte(8) == kGutiType) {
    auto guti = makeMessage<Guti>();
    guti->setMmegi(body.get(h(12)));
    guti->setMmec(body.byte(14));
    guti->setMTmsi(body.get(w(15)));
    sim.emm.setGuti(std::move(guti));
  }
  events.add(sim.emm);
  return Reading::read;
}

}  // namespace vesk::diag
