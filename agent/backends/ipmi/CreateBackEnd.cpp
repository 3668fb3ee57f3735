#include "agent/backends/ipmi/IpmiBackEnd.h"
#include "agent/backends/ipmi/settings/IpmiSettings.h"

extern "C" __attribute__((visibility("default"))) QV::BackEnd* qvCreateBackEnd(const QV::BackEndSettings& settings) {
  return new QV::Ipmi::IpmiBackEnd(QV::Ipmi::parseSettings(settings));
}

static_assert(std::is_same_v<decltype(qvCreateBackEnd), QV::CreateBackEnd>);
