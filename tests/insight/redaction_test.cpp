#include "insight/redaction.h"

#include <gtest/gtest.h>
#include <memory>
#include <optional>
#include <span>
#include <string>
#include <utility>
#include <vector>

#include "messages/registry/metric_classes.h"
#include "messages/registry/metric_of_message.h"
#include "support/metric_events.h"

namespace vesk::insight {

namespace {

using namespace metrics;

using Bytes = std::vector<std::uint8_t>;

Bytes redacted(std::int64_t metricId, std::span<const std::uint8_t> payload) {
  const std::optional<Data> data = redactedPayload(metricId, payload);
  if (!data) return {};
  EXPECT_EQ(redactedPayload(metricId, data->bytes()), data) << "again";
  return {data->bytes().begin(), data->bytes().end()};
}

/// The fields of the message once it is redacted, as JSON.
template <class MetricMessage>
std::string redactedFields(const MetricMessage& message) {
  std::string fields;
  EXPECT_TRUE(findMetricClass(kMetricId<MetricMessage>)
                  ->appendJson(fields, redacted(kMetricId<MetricMessage>, encoded(message).bytes())));
  return fields;
}

Data dataOf(Bytes content) {
  return Data::copy(content);
}

TEST(Redaction, MasksWhatNamesTheSubscriberAndNothingElse) {
  KCellularMmCommonInfo common;
  common.setTimestamp(7);
  common.setImsi(dataOf({1, 2, 3}));
  EXPECT_EQ(redactedFields(common), R"({"timestamp":7,"imsi":"0x000000"})");

  KCellularEmmContext emm;
  emm.setGuti(std::make_shared<Guti>());
  emm.guti()->setMmegi(65320);
  emm.guti()->setMTmsi(99);
  emm.setT3412DurS(3240);
  EXPECT_EQ(redactedFields(emm), R"({"guti":{"mmegi":65320,"m_tmsi":0},"t3412_dur_s":3240})");

  KCellularMmContext mm;
  mm.setTmsi(99);
  mm.setT3212DurS(60);
  EXPECT_EQ(redactedFields(mm), R"({"tmsi":0,"t3212_dur_s":60})");

  KCellularGmmContext gmm;
  gmm.setPTmsi(99);
  gmm.setRejectCause(static_cast<NasMmRejectCause>(77));
  EXPECT_EQ(redactedFields(gmm), R"~({"p_tmsi":0,"reject_cause":"(unknown: 77)"})~");

  KCellularActivatedBearerContexts bearers;
  auto bearer = std::make_shared<BearerContext>();
  bearer->setNsapi(5);
  bearer->setApn("corp.Internet"_text);
  bearer->setPdpAddr(dataOf({10, 0, 0, 1}));
  bearer->setPrimaryDnsAddr(dataOf({8}));
  bearer->setSecondaryDnsAddr(dataOf({}));
  bearers.addBearerContexts(bearer);
  bearers.addBearerContexts(std::make_shared<BearerContext>());
  EXPECT_EQ(redactedFields(bearers),
            R"({"bearer_contexts":[{"nsapi":5,"apn":"xxxx.Internet","pdp_addr":"0x00000000","primary_dns_addr":"0x00",)"
            R"("secondary_dns_addr":"0x"},{}]})");

  KCellularLteRsrpRsrqSinr levels;
  levels.setCallId("ab-12"_text);
  levels.setNumSamples(3);
  EXPECT_EQ(redactedFields(levels), R"({"call_id":"00000","num_samples":3})");

  KCellularSimCardFiles files;
  for (const std::optional<std::uint32_t> identifier :
       {std::optional(0x6F07U), std::optional(0x6FADU), std::optional(0x1234U), std::optional<std::uint32_t>()}) {
    auto file = std::make_shared<ElementaryFile>();
    if (identifier) file->setEfId(*identifier);
    file->setContent(dataOf({9, 9}));
    files.addEfList(file);
  }
  EXPECT_EQ(redactedFields(files),
            R"({"ef_list":[{"ef_id":28423,"content":"0x0000"},{"ef_id":28589,"content":"0x0909"},)"
            R"({"ef_id":4660,"content":"0x0000"},{"content":"0x0000"}]})");
}

TEST(Redaction, MasksTheLabelsOfAnAccessPointThatMayTellWhoseItIs) {
  for (const auto& [name, masked] : {
           std::pair{"acme.intranet.lan.mnc260.mcc310.gprs", "xxxx.xxxxxxxx.xxx.mnc260.mcc310.gprs"},
           {"IMS.Sos.mms.XCAP", "IMS.Sos.mms.XCAP"},
           {"MNC26.mcc3100.mcc31a.mncabc", "xxxxx.xxxxxxx.xxxxxx.xxxxxx"},
           {"", ""},
           {".a.", ".x."},
           {"\xFF\xC3\xA9", "xxx"},
       })
    EXPECT_EQ(redactedAccessPoint(name), masked);
}

TEST(Redaction, DropsUnknownFieldsAndWhatNobodyKnows) {
  KCellularLteRrcState state;
  state.setState(LteRrcState::KLTE_RRC_STATE_CONNECTED);
  const Data payload = encoded(state);
  const Bytes known(payload.bytes().begin(), payload.bytes().end());
  Bytes withIdentity = known;
  // Field 100, text.
  const Bytes unknownField{0xA2, 0x06, 0x03, '2', '6', '0'};
  withIdentity.insert(withIdentity.end(), unknownField.begin(), unknownField.end());
  EXPECT_EQ(redacted(K_LTE_RRC_STATE, withIdentity), known);

  EXPECT_FALSE(redactedPayload(K_LTE_RRC_STATE, Bytes{0x10}));
  EXPECT_FALSE(redactedPayload(0x3C0000, known));
  EXPECT_EQ(redactedPayload(K_LTE_RRC_STATE, {}), Data());
}

}  // namespace

}  // namespace vesk::insight
