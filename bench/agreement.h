#pragma once

#include "bench/corpus.h"

namespace vesk::bench {

/// Makes sure that all sides do the same work on every event: they read the same fields, write the same bytes, and come
/// to the same JSON text. Ends the program with one line when they do not.
void requireAgreement(const Corpus& corpus);

}  // namespace vesk::bench
