#pragma once

#include "diag/layout/byte_reader.h"
#include "messages/nas/nas.h"

namespace vesk::diag {

/// Sets the first two name servers that the protocol configuration options of a bearer name.
void setNameServers(metrics::BearerContext& bearer, ByteSpan options);

}  // namespace vesk::diag
