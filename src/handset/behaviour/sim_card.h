#pragma once

#include "handset/behaviour/registration.h"
#include "messages/nas/nas.h"

namespace vesk::handset {

/// The elementary files of the SIM card (3GPP TS 31.102) as they stand: what the network has told the handset
/// about itself is stored there too.
[[nodiscard]] metrics::KCellularSimCardFiles readSimFiles(const Subscriber& subscriber,
                                                          const TemporaryIdentity& identity);

}  // namespace vesk::handset
