#pragma once

#include "app/data_output.h"
#include "diag/packet_counts.h"

namespace vesk {

/// Writes what came, and what became of it, as a table: a line for each code and version of a log packet, then for the
/// other kinds of packets that came. The columns are separated by two blanks or more.
void writePacketTable(DataOutput& output, const diag::PacketCounts& counts);

}  // namespace vesk
