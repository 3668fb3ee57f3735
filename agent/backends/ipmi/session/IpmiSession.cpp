#include "agent/backends/ipmi/session/IpmiSession.h"

#include <freeipmi/freeipmi.h>

#include <array>

#include "agent/backends/ipmi/session/SessionAdvice.h"

namespace QV::Ipmi {
namespace {

std::string addressOf(const IpmiSettings& settings) {
  const bool ipv6 = settings.host.find(':') != std::string::npos;
  return (ipv6 ? '[' + settings.host + ']' : settings.host) + ':' + std::to_string(settings.port);
}

int openLan(ipmi_ctx* context, const IpmiSettings& settings) {
  const std::string password = readPassword(settings);
  const std::string key = readKey(settings);
  return ::ipmi_ctx_open_outofband_2_0(
      context, addressOf(settings).c_str(), settings.user.c_str(), password.c_str(),
      key.empty() ? nullptr : reinterpret_cast<const unsigned char*>(key.data()), static_cast<unsigned>(key.size()),
      settings.privilege, settings.cipherSuite, static_cast<unsigned>(settings.sessionTimeout.count()),
      static_cast<unsigned>(settings.retransmissionTimeout.count()), settings.workarounds, IPMI_FLAGS_DEFAULT);
}

// Only the operating system's driver is used: probing for bare interfaces would interfere with it.
int openInBand(ipmi_ctx* context, const IpmiSettings& settings) {
  constexpr int noProbing = 1;
  return ::ipmi_ctx_open_inband(context, IPMI_DEVICE_OPENIPMI, noProbing, 0, 0, settings.device.c_str(), 0,
                                IPMI_FLAGS_DEFAULT);
}

}  // namespace

std::string nameOf(const IpmiSettings& settings) {
  return settings.connection == IpmiSettings::Connection::Lan ? "the BMC at " + addressOf(settings)
                                                              : "the BMC behind " + settings.device;
}

unsigned IpmiSession::openingRoundTrips(const IpmiSettings& settings) {
  return settings.connection == IpmiSettings::Connection::Lan ? 5 : 0;
}

void IpmiSession::Close::operator()(ipmi_ctx* context) const {
  ::ipmi_ctx_close(context);
  ::ipmi_ctx_destroy(context);
}

IpmiSession::IpmiSession(const IpmiSettings& settings)
    : context_(::ipmi_ctx_create()), retransmissionTimeout_(settings.retransmissionTimeout) {
  if (!context_) throw NotSent("there is no memory for an IPMI session");
  const bool lan = settings.connection == IpmiSettings::Connection::Lan;
  if ((lan ? openLan(context_.get(), settings) : openInBand(context_.get(), settings)) != 0)
    throw NotSent(nameOf(settings) +
                  " gives no session: " + openingAdvice(settings, ::ipmi_ctx_errnum(context_.get())));
  lastAnswer_ = Clock::now();
}

IpmiResponse IpmiSession::send(const IpmiRequest& request) {
  std::vector<std::uint8_t> message = {request.command};
  message.insert(message.end(), request.data.begin(), request.data.end());
  std::array<std::uint8_t, 256> answer;
  const Clock::time_point sent = Clock::now();
  const int length =
      ::ipmi_cmd_raw(context_.get(), 0, static_cast<std::uint8_t>(request.networkFunction), message.data(),
                     static_cast<unsigned>(message.size()), answer.data(), static_cast<unsigned>(answer.size()));
  // The command's number and the completion code come first.
  if (length < 2) throw ConnectionLost(::ipmi_ctx_errormsg(context_.get()));
  lastAnswer_ = Clock::now();
  return {answer[1], {answer.begin() + 2, answer.begin() + length}, lastAnswer_ - sent >= retransmissionTimeout_};
}

}  // namespace QV::Ipmi
