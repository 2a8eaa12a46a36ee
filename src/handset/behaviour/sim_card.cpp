#include "handset/behaviour/sim_card.h"

#include <memory>
#include <string_view>

#include "handset/model/digits.h"

namespace vesk::handset {

namespace {

Bytes padded(Bytes content, std::size_t size) {
  content.resize(size, 0xFF);
  return content;
}

/// Length, mobile identity.
Bytes imsiFile(const Subscriber& subscriber) {
  const Bytes identity = mobileIdentity(subscriber.imsi);
  Bytes content{static_cast<std::uint8_t>(identity.size())};
  append(content, identity);
  return content;
}

/// The name is to be shown beside the registered network; then the name.
Bytes serviceProviderFile() {
  constexpr std::string_view kName = "Test Network";
  Bytes content;
  content.reserve(17);
  content.push_back(0x01);
  content.insert(content.end(), kName.begin(), kName.end());
  return padded(std::move(content), 17);
}

/// Normal operation; how many digits of the IMSI are the MNC.
Bytes administrativeDataFile() {
  return {0x00, 0x00, 0x00, static_cast<std::uint8_t>(kMncDigits)};
}

/// One bit of 16: the access class is the last digit of the IMSI.
Bytes accessClassFile(const Subscriber& subscriber) {
  Bytes content;
  appendNumber(content, std::uint64_t{1} << (subscriber.imsi.back() - '0'), 2);
  return content;
}

/// The services that this card has: service provider name, MSISDN, home network selector, EPS mobility management.
Bytes serviceTableFile() {
  constexpr unsigned kServices[] = {19, 21, 43, 85};
  Bytes content(11);
  for (const unsigned service : kServices) {
    std::uint8_t& byte = content[(service - 1) / 8];
    byte = static_cast<std::uint8_t>(byte | 1U << (service - 1) % 8);
  }
  return content;
}

/// No name; length, international number, digits in 10 bytes; no capability, no extension.
Bytes ownNumberFile(const Subscriber& subscriber) {
  const Bytes digits = swappedDigits(subscriber.msisdn);
  Bytes content(10, 0xFF);
  content.push_back(static_cast<std::uint8_t>(1 + digits.size()));
  content.push_back(0x91);
  append(content, digits);
  return padded(std::move(content), 24);
}

/// The home network on LTE, UMTS and GSM.
Bytes homeNetworkFile() {
  Bytes content = encodedPlmn(kMnc);
  appendNumber(content, 0xC080, 2);
  return content;
}

Bytes forbiddenNetworksFile() {
  return padded(encodedPlmn(2), 12);
}

/// TMSI, location area, unused, updated.
Bytes locationFile(const TemporaryIdentity& identity) {
  Bytes content;
  appendNumber(content, identity.tmsi, 4);
  append(content, encodedPlmn(kMnc));
  appendNumber(content, identity.locationAreaCode, 2);
  appendNumber(content, 0xFF00, 2);
  return content;
}

/// P-TMSI, its signature, routing area, updated.
Bytes packetLocationFile(const TemporaryIdentity& identity) {
  Bytes content;
  appendNumber(content, identity.pTmsi, 4);
  appendNumber(content, 0xFFFFFF, 3);
  append(content, encodedPlmn(kMnc));
  appendNumber(content, identity.locationAreaCode, 2);
  appendNumber(content, kRoutingAreaCode, 1);
  appendNumber(content, 0, 1);
  return content;
}

/// GUTI as an EPS mobile identity with its length, last tracking area, updated.
Bytes epsLocationFile(const TemporaryIdentity& identity) {
  Bytes content{0x0B, 0xF6};
  append(content, encodedPlmn(kMnc));
  appendNumber(content, identity.mmeGroupId, 2);
  appendNumber(content, identity.mmeCode, 1);
  appendNumber(content, identity.mTmsi, 4);
  append(content, encodedPlmn(kMnc));
  appendNumber(content, identity.trackingAreaCode, 2);
  appendNumber(content, 0, 1);
  return content;
}

}  // namespace

metrics::KCellularSimCardFiles readSimFiles(const Subscriber& subscriber, const TemporaryIdentity& identity) {
  metrics::KCellularSimCardFiles files;
  const auto add = [&files](std::uint32_t id, const Bytes& content) {
    auto file = std::make_shared<metrics::ElementaryFile>();
    file->setEfId(id);
    file->setContent(Data::copy(content));
    files.addEfList(std::move(file));
  };
  add(0x2FE2, swappedDigits(subscriber.iccid));  // EF_ICCID
  add(0x6F07, imsiFile(subscriber));             // EF_IMSI
  add(0x6F38, serviceTableFile());               // EF_UST
  add(0x6F40, ownNumberFile(subscriber));        // EF_MSISDN
  add(0x6F46, serviceProviderFile());            // EF_SPN
  add(0x6F62, homeNetworkFile());                // EF_HPLMNwAcT
  add(0x6F73, packetLocationFile(identity));     // EF_PSLOCI
  add(0x6F78, accessClassFile(subscriber));      // EF_ACC
  add(0x6F7B, forbiddenNetworksFile());          // EF_FPLMN
  add(0x6F7E, locationFile(identity));           // EF_LOCI
  add(0x6FAD, administrativeDataFile());         // EF_AD
  add(0x6FE3, epsLocationFile(identity));        // EF_EPSLOCI
  return files;
}

}  // namespace vesk::handset
