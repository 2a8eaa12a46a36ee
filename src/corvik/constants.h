#pragma once

#include <cstdint>

#include "values/text.h"

namespace corvik {

using vesk::operator""_text;

/// The keys of commands and events.
inline const vesk::Text kKeyAppID = "kKeyAppID"_text;
inline const vesk::Text kKeyPayload = "kKeyPayload"_text;
inline const vesk::Text kKeyPayloadType = "kKeyPayloadType"_text;
inline const vesk::Text kKeyTriggerRef = "kKeyTriggerRef"_text;
inline const vesk::Text kKeyTriggerType = "kKeyTriggerType"_text;
inline const vesk::Text kKeyTriggerID = "kKeyTriggerID"_text;
inline const vesk::Text kKeyProfileID = "kKeyProfileID"_text;
inline const vesk::Text kKeyMetricID = "kKeyMetricID"_text;

inline const vesk::Text kCommandAddConfiguration = "kCommandAddConfiguration"_text;
inline const vesk::Text kCommandClearConfiguration = "kCommandClearConfiguration"_text;
inline const vesk::Text kCommandQueryMetric = "kCommandQueryMetric"_text;

inline const vesk::Text kEventMetric = "kEventMetric"_text;
inline const vesk::Text kEventTrigger = "kEventTrigger"_text;

}  // namespace corvik
