#include "handset/behaviour/registration.h"

#include <memory>

#include "handset/model/digits.h"

namespace vesk::handset {

using namespace metrics;

namespace {

constexpr std::int64_t kUpdateMs = 400;
constexpr std::uint32_t kPeriodicTrackingS = 3240;
constexpr std::uint32_t kPeriodicLocationS = 3600;
constexpr std::uint32_t kPeriodicRoutingS = 3240;
/// The network next door, which does not let this subscriber in.
constexpr std::uint32_t kForbiddenMnc = 2;
constexpr std::uint32_t kForbiddenLocationArea = 3001;
constexpr std::uint32_t kForbiddenTrackingArea = 30001;

std::string randomDigits(std::string digits, std::size_t count, Random& random) {
  while (digits.size() < count)
    digits += static_cast<char>('0' + random.below(10));
  return digits;
}

std::uint32_t random32(Random& random) {
  return static_cast<std::uint32_t>(random.next() >> 32);
}

Data plmn(std::uint32_t mnc = kMnc) {
  return Data::copy(encodedPlmn(mnc));
}

std::shared_ptr<KCellularLocationAreaId> locationArea(std::uint32_t mnc, std::uint32_t code) {
  auto area = std::make_shared<KCellularLocationAreaId>();
  area->setEncodedPlmn(plmn(mnc));
  area->setLac(code);
  return area;
}

std::shared_ptr<KCellularTrackingAreaId> trackingArea(std::uint32_t mnc, std::uint32_t code) {
  auto area = std::make_shared<KCellularTrackingAreaId>();
  area->setEncodedPlmn(plmn(mnc));
  area->setTac(code);
  return area;
}

Data number(std::uint64_t value, unsigned bytes) {
  Bytes content;
  appendNumber(content, value, bytes);
  return Data::copy(content);
}

/// 2001:db8::53 or 2001:db8::5353, of the prefix set aside for documentation.
Data nameServer6(std::uint64_t host) {
  Bytes content;
  appendNumber(content, 0x20010DB800000000, 8);
  appendNumber(content, host, 8);
  return Data::copy(content);
}

std::shared_ptr<BearerContext> makeBearer(std::uint32_t cid, std::uint32_t nsapi, std::string_view apn) {
  auto bearer = std::make_shared<BearerContext>();
  bearer->setCid(cid);
  bearer->setNsapi(nsapi);
  bearer->setApn(Text::copy(apn));
  bearer->setIsAddrIratMobile(true);
  return bearer;
}

KCellularEmmContext makeEmmContext(RegStatus status, EpsUpdateStatus updateStatus, EmmProc procedure) {
  KCellularEmmContext context;
  context.setRegStatus(status);
  context.setUpdateStatus(updateStatus);
  context.setUeOpMode(EpsUeOpMode::EPS_UE_OP_MODE_CSPS_MODE_2);
  context.setRejectCause(EmmCause::EMM_CAUSE_NO_CAUSE);
  context.setRegProc(procedure);
  context.setT3412DurS(kPeriodicTrackingS);
  context.setIsImsVoiceSupported(true);
  context.setIsEmergBearerSupported(true);
  return context;
}

KCellularMmContext makeMmContext(RegStatus status, MmUpdateStatus updateStatus) {
  KCellularMmContext context;
  context.setRegStatus(status);
  context.setUpdateStatus(updateStatus);
  context.setT3212DurS(kPeriodicLocationS);
  context.setProcFailureCause(NasMmProcFailureCause::KNAS_MM_PROC_FAILURE_CAUSE_NONE);
  context.setRejectCause(NasMmRejectCause::KNAS_MM_REJ_CAUSE_NONE);
  return context;
}

KCellularGmmContext makeGmmContext(RegStatus status, GprsUpdateStatus updateStatus, NasMmRegProc procedure) {
  KCellularGmmContext context;
  context.setRegStatus(status);
  context.setUpdateStatus(updateStatus);
  context.setT3312DurS(kPeriodicRoutingS);
  context.setProcFailureCause(NasMmProcFailureCause::KNAS_MM_PROC_FAILURE_CAUSE_NONE);
  context.setRejectCause(NasMmRejectCause::KNAS_MM_REJ_CAUSE_NONE);
  context.setRegProc(procedure);
  return context;
}

}  // namespace

Registration::Registration(Random& random) {
  subscriber_.imsi = randomDigits("00101", 15, random);
  subscriber_.iccid = withCheckDigit(randomDigits("89001010", 18, random));
  subscriber_.msisdn = randomDigits("99955", 12, random);
  identity_.mmeGroupId = 0x8001;
  identity_.mmeCode = 1 + random.below(16);
  identity_.mTmsi = random32(random);
  identity_.tmsi = random32(random);
  identity_.pTmsi = random32(random) | 0xC0000000;
  identity_.trackingAreaCode = kFirstTrackingArea;
  identity_.locationAreaCode = kFirstLocationArea;
  interfaceId_ = random.next();
  internetAddress_ = 0x0A000000 | random.below(1 << 24);
}

void Registration::switchOn(Outbox& outbox) {
  KCellularMmCommonInfo info;
  info.setImsi(Data::copy(mobileIdentity(subscriber_.imsi)));
  auto equivalent = std::make_shared<Plmn>();
  equivalent->setEncodedPlmn(plmn());
  info.addEplmnList(std::move(equivalent));
  info.addRoamingFlaiList(locationArea(kForbiddenMnc, kForbiddenLocationArea));
  info.addRoamingFtaiList(trackingArea(kForbiddenMnc, kForbiddenTrackingArea));
  outbox.tell(info);
}

void Registration::keepUp(const Area& area, std::int64_t nowMs, Outbox& outbox, Random& random) {
  if (isRegisteredIn(area)) return;
  if (!update_ || update_->area != area) {
    update_ = Update{area, nowMs + kUpdateMs};
    begin(area, outbox);
  } else if (nowMs >= update_->completeMs) {
    update_.reset();
    complete(area, outbox, random);
  }
}

void Registration::begin(const Area& area, Outbox& outbox) const {
  constexpr RegStatus kInProgress = RegStatus::KREG_STATUS_REGISTRATION_IN_PROGRESS;
  if (area.isTrackingArea) {
    auto emm = makeEmmContext(kInProgress, EpsUpdateStatus::EPS_STATUS_NOT_UPDATED,
                              area_ ? EmmProc::EMM_PROC_TAU_COMB : EmmProc::EMM_PROC_ATTACH_COMB);
    outbox.tell(emm);
  } else {
    auto gmm = makeGmmContext(kInProgress, GprsUpdateStatus::GPRS_STATUS_NOT_UPDATED,
                              NasMmRegProc::KNAS_MM_REG_PROC_ROUTING_AREA_UPDATE);
    outbox.tell(gmm);
  }
}

void Registration::complete(const Area& area, Outbox& outbox, Random& random) {
  const bool hasChangedSystem = !area_ || area_->isTrackingArea != area.isTrackingArea;
  area_ = area;
  identity_.tmsi = random32(random);
  if (area.isTrackingArea) {
    identity_.mTmsi = random32(random);
    identity_.trackingAreaCode = area.code;
    // The update is a combined one.
    identity_.locationAreaCode = locationAreaOf(area.code);
  } else {
    identity_.pTmsi = random32(random) | 0xC0000000;
    identity_.locationAreaCode = area.code;
  }
  tellContexts(outbox);
  if (hasChangedSystem) tellBearers(area.isTrackingArea, outbox);
}

void Registration::tellContexts(Outbox& outbox) const {
  constexpr RegStatus kServed = RegStatus::KREG_STATUS_NORMAL_SERVICE;
  constexpr RegStatus kElsewhere = RegStatus::KREG_STATUS_NO_SERVICE;
  const bool isOnLte = area_->isTrackingArea;

  auto emm =
      makeEmmContext(isOnLte ? kServed : kElsewhere, EpsUpdateStatus::EPS_STATUS_UPDATED, EmmProc::EMM_PROC_NO_PROC);
  emm.addTaiList(trackingArea(kMnc, identity_.trackingAreaCode));
  auto guti = std::make_shared<Guti>();
  guti->setMmegi(identity_.mmeGroupId);
  guti->setMmec(identity_.mmeCode);
  guti->setMTmsi(identity_.mTmsi);
  emm.setGuti(std::move(guti));
  outbox.tell(emm);

  auto mm = makeMmContext(kServed, MmUpdateStatus::STATUS_UPDATED);
  mm.setLai(locationArea(kMnc, identity_.locationAreaCode));
  mm.setTmsi(identity_.tmsi);
  mm.setIsCombinedProc(isOnLte);
  outbox.tell(mm);

  auto gmm = makeGmmContext(isOnLte ? kElsewhere : kServed, GprsUpdateStatus::GPRS_STATUS_UPDATED,
                            NasMmRegProc::KNAS_MM_REG_PROC_PROC_NONE);
  auto routingArea = std::make_shared<RoutingAreaId>();
  routingArea->setEncodedPlmn(plmn());
  routingArea->setLac(identity_.locationAreaCode);
  routingArea->setRac(kRoutingAreaCode);
  gmm.setRai(std::move(routingArea));
  gmm.setPTmsi(identity_.pTmsi);
  outbox.tell(gmm);
}

void Registration::tellBearers(bool isOnLte, Outbox& outbox) const {
  KCellularActivatedBearerContexts contexts;
  auto internet = makeBearer(1, 5, "internet");
  internet->setPdpType(isOnLte ? PdpType::PDP_TYPE_IPv4_PDN : PdpType::PDP_TYPE_IPv4);
  internet->setPdpAddr(number(internetAddress_, 4));
  internet->setPrimaryDnsType(PdpType::PDP_TYPE_IPv4);
  internet->setPrimaryDnsAddr(number(0xC0000235, 4));
  internet->setSecondaryDnsType(PdpType::PDP_TYPE_IPv4);
  internet->setSecondaryDnsAddr(number(0xC6336435, 4));
  contexts.addBearerContexts(std::move(internet));
  if (isOnLte) {
    auto ims = makeBearer(2, 6, "ims");
    ims->setPdpType(PdpType::PDP_TYPE_IPv6_PDN);
    ims->setPdpAddr(number(interfaceId_, 8));
    ims->setPrimaryDnsType(PdpType::PDP_TYPE_IPv6);
    ims->setPrimaryDnsAddr(nameServer6(0x53));
    ims->setSecondaryDnsType(PdpType::PDP_TYPE_NONE);
    contexts.addBearerContexts(std::move(ims));
  }
  contexts.setBearerContextCount(static_cast<std::uint32_t>(contexts.bearerContextsCount()));
  outbox.tell(contexts);
}

}  // namespace vesk::handset
