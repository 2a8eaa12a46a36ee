#include "diag/frame_reader.h"
