#pragma once

#include <functional>

#include "app/output/data_output.h"
#include "app/output/outcome.h"
#include "app/source/recording_input.h"
#include "insight/insight.h"

namespace vesk {

/// Plays the recording through the whole program while `insight` watches. What the step handler of `insight` and
/// `atEnd`, called once all is played, write to `output` is on its way before more of a pipe is waited for.
[[nodiscard]] Outcome watchDrive(const RecordingInput& input, insight::Insight& insight, DataOutput& output,
                                 const std::function<void()>& atEnd = {});

}  // namespace vesk
