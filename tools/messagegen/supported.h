#pragma once

#include "schema.h"

namespace messagegen {

/// Throws Refusal for the first thing in the file that protoc takes and no class can be generated for, and for a name
/// that would clash with another one of the generated code.
void checkSupported(const FileDescriptor& file);

}  // namespace messagegen
