#include "insight/redaction.h"

#include <algorithm>
#include <array>
#include <memory>
#include <vector>

#include "messages/registry/metric_classes.h"
#include "messages/registry/metric_of_message.h"

namespace vesk::insight {

namespace {

using namespace metrics;

// clang-format off
/// Labels that many access points have.
constexpr std::array<std::string_view, 6> kCommonLabels{"internet", "ims", "sos", "mms", "xcap", "gprs"};
/// Labels of a network, before their three digits.
constexpr std::array<std::string_view, 2> kNetworkLabels{"mnc", "mcc"};
/// The SIM files that name no subscriber.
constexpr std::array<std::uint32_t, 16> kImpersonalFiles{
    0x2F00, 0x2F05, 0x6F05, 0x6F06, 0x6F31, 0x6F38, 0x6F46, 0x6F56,
    0x6F60, 0x6F61, 0x6F62, 0x6F7B, 0x6FAD, 0x6FB7, 0x6FC5, 0x6FC6};
// clang-format on

std::optional<Data> zeros(const std::optional<Data>& data) {
  if (!data) return std::nullopt;
  return Data::copy(std::vector<std::uint8_t>(data->bytes().size()));
}

char lowerCase(char letter) {
  return letter >= 'A' && letter <= 'Z' ? static_cast<char>(letter - 'A' + 'a') : letter;
}

bool isCommon(std::string_view label) {
  constexpr std::size_t kDigits = 3;
  std::string lower(label);
  std::transform(lower.begin(), lower.end(), lower.begin(), lowerCase);
  if (std::find(kCommonLabels.begin(), kCommonLabels.end(), lower) != kCommonLabels.end()) return true;
  return std::any_of(kNetworkLabels.begin(), kNetworkLabels.end(), [&](std::string_view prefix) {
    return lower.size() == prefix.size() + kDigits && lower.starts_with(prefix) &&
           std::all_of(lower.end() - kDigits, lower.end(), [](char digit) { return digit >= '0' && digit <= '9'; });
  });
}

void mask(KCellularMmCommonInfo& message) {
  message.setImsi(zeros(message.imsi()));
}

void mask(KCellularEmmContext& message) {
  if (message.guti() != nullptr && message.guti()->hasMTmsi()) message.guti()->setMTmsi(0);
}

void mask(KCellularMmContext& message) {
  if (message.hasTmsi()) message.setTmsi(0);
}

void mask(KCellularGmmContext& message) {
  if (message.hasPTmsi()) message.setPTmsi(0);
}

void mask(KCellularActivatedBearerContexts& message) {
  if (!message.bearerContexts()) return;
  for (const std::shared_ptr<BearerContext>& bearer : *message.bearerContexts()) {
    bearer->setPdpAddr(zeros(bearer->pdpAddr()));
    bearer->setPrimaryDnsAddr(zeros(bearer->primaryDnsAddr()));
    bearer->setSecondaryDnsAddr(zeros(bearer->secondaryDnsAddr()));
    if (bearer->apn()) bearer->setApn(Text::copy(redactedAccessPoint(bearer->apn()->view())));
  }
}

void mask(KCellularLteRsrpRsrqSinr& message) {
  if (message.callId()) message.setCallId(Text::copy(std::string(message.callId()->view().size(), '0')));
}

void mask(KCellularSimCardFiles& message) {
  if (!message.efLists()) return;
  for (const std::shared_ptr<ElementaryFile>& file : *message.efLists()) {
    const bool isImpersonal = file->hasEfId() && std::find(kImpersonalFiles.begin(), kImpersonalFiles.end(),
                                                           file->efId()) != kImpersonalFiles.end();
    if (!isImpersonal) file->setContent(zeros(file->content()));
  }
}

struct Mask {
  std::int64_t metricId;
  void (*apply)(ProtoCodable& message);
};

template <class MetricMessage>
constexpr Mask maskOf() {
  return {kMetricId<MetricMessage>, [](ProtoCodable& message) { mask(static_cast<MetricMessage&>(message)); }};
}

/// The messages that hold identities.
constexpr std::array kMasks{
    maskOf<KCellularMmCommonInfo>(),
    maskOf<KCellularEmmContext>(),
    maskOf<KCellularMmContext>(),
    maskOf<KCellularGmmContext>(),
    maskOf<KCellularActivatedBearerContexts>(),
    maskOf<KCellularLteRsrpRsrqSinr>(),
    maskOf<KCellularSimCardFiles>(),
};

}  // namespace

std::string redactedAccessPoint(std::string_view name) {
  std::string out;
  for (;;) {
    const std::size_t dot = name.find('.');
    const std::string_view label = name.substr(0, dot);
    if (isCommon(label)) {
      out += label;
    } else {
      out.append(label.size(), 'x');
    }
    if (dot == std::string_view::npos) return out;
    out += '.';
    name.remove_prefix(dot + 1);
  }
}

std::optional<Data> redactedPayload(std::int64_t metricId, std::span<const std::uint8_t> payload) {
  const MetricClass* metricClass = findMetricClass(metricId);
  if (metricClass == nullptr) return std::nullopt;
  const std::shared_ptr<ProtoCodable> message = metricClass->decodeMessage(payload);
  if (message == nullptr) return std::nullopt;
  const auto* mask =
      std::find_if(kMasks.begin(), kMasks.end(), [=](const Mask& each) { return each.metricId == metricId; });
  if (mask != kMasks.end()) mask->apply(*message);
  ProtoWriter writer;
  message->writeTo(writer);
  return Data::copy(writer.written());
}

}  // namespace vesk::insight
