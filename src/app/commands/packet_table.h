#pragma once

#include "app/output/data_output.h"
#include "diag/packet_counts.h"

namespace vesk {

/// Writes what came, and what became of it, as a table: a line for each code and version of a log packet, with the
/// subpackets that were not read behind it, then for the other kinds of packets that came. The columns are separated by
/// two blanks or more.
void writePacketTable(DataOutput& output, const diag::PacketCounts& counts);

/// Writes what can be read, as such a table: by code, the versions of which the layout is proven by many packets, by a
/// few samples, or only by the book. "1:25/36" is a subpacket 25 of version 36 in a packet of version 1.
void writeLayoutTable(DataOutput& output);

}  // namespace vesk
