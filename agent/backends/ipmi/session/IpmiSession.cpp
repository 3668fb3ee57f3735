// SPDX-License-Identifier: Apache-2.0
#include "agent/backends/ipmi/session/IpmiSession.h"

#include <freeipmi/freeipmi.h>

#include <array>

namespace QV::Ipmi {
namespace {

// libfreeipmi waits for whole milliseconds, what is left of one not included.
constexpr std::chrono::milliseconds retransmissionIsEarlier{2};

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

std::string cipherSuiteAdvice(const IpmiSettings& settings) {
  const std::string other = settings.cipherSuite == 3 ? "17" : "3";
  return "it refused cipher suite " + std::to_string(settings.cipherSuite) + ": try cipher_suite = " + other +
         ", or a workaround that FreeIPMI knows for this BMC";
}

std::string lanAdvice(const IpmiSettings& settings, int error) {
  switch (error) {
    case IPMI_ERR_CONNECTION_TIMEOUT:
    case IPMI_ERR_SESSION_TIMEOUT:
    case IPMI_ERR_MESSAGE_TIMEOUT:
      return "no answer; check host and port, that IPMI over LAN is enabled there, and that UDP passes";
    case IPMI_ERR_HOSTNAME_INVALID:
      return "the host name is not known";
    case IPMI_ERR_USERNAME_INVALID:
      return "it does not know the user '" + settings.user + "', or grants it no access over LAN";
    case IPMI_ERR_PASSWORD_INVALID:
    case IPMI_ERR_PASSWORD_VERIFICATION_TIMEOUT:
      return "it refused the password in " + settings.passwordFile + " for the user '" + settings.user + '\'';
    case IPMI_ERR_K_G_INVALID:
      return "it refused the BMC key: check k_g_file";
    case IPMI_ERR_PRIVILEGE_LEVEL_INSUFFICIENT:
    case IPMI_ERR_PRIVILEGE_LEVEL_CANNOT_BE_OBTAINED:
      return "the user '" + settings.user + "' may not have the privilege that is asked for: check privilege";
    case IPMI_ERR_IPMI_2_0_UNAVAILABLE:
      return "it speaks no IPMI 2.0 (RMCP+)";
    case IPMI_ERR_CIPHER_SUITE_ID_UNAVAILABLE:
    case IPMI_ERR_BAD_RMCPPLUS_STATUS_CODE:
    case IPMI_ERR_IPMI_ERROR:  // how the library reports an answer to Open Session that it does not understand
      return cipherSuiteAdvice(settings);
    case IPMI_ERR_BMC_BUSY:
      return "it is busy or has no free session: try again, or close sessions of other tools";
    default:
      return std::string(::ipmi_ctx_strerror(error)) + "; check host, user and password_file";
  }
}

std::string inBandAdvice(int error) {
  switch (error) {
    case IPMI_ERR_PERMISSION:
      return "permission denied: the object manager must run as root or be granted the device";
    case IPMI_ERR_DEVICE_NOT_FOUND:
    case IPMI_ERR_DEVICE_NOT_SUPPORTED:
    case IPMI_ERR_SYSTEM_ERROR:
      return "no such device; load the kernel modules ipmi_si and ipmi_devintf, or use connection = lan";
    default:
      return ::ipmi_ctx_strerror(error);
  }
}

// What libfreeipmi's error numbers mean to an administrator: why a session did not open and which setting or step
// helps.
std::string openingAdvice(const IpmiSettings& settings, int error) {
  return settings.connection == IpmiSettings::Connection::Lan ? lanAdvice(settings, error) : inBandAdvice(error);
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
  if (!context_) {
    throw NotSent("there is no memory for an IPMI session");
  }
  const bool lan = settings.connection == IpmiSettings::Connection::Lan;
  if ((lan ? openLan(context_.get(), settings) : openInBand(context_.get(), settings)) != 0) {
    throw NotSent(nameOf(settings) +
                  " did not open a session: " + openingAdvice(settings, ::ipmi_ctx_errnum(context_.get())));
  }
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
  if (length < 0) {
    throw ConnectionLost(::ipmi_ctx_errormsg(context_.get()));
  }
  // The command's number and the completion code come first.
  if (length < 2) {
    throw ConnectionLost("its answer has no completion code");
  }
  lastAnswer_ = Clock::now();
  const bool late = lastAnswer_ - sent >= retransmissionTimeout_ - retransmissionIsEarlier;
  return {answer[1], {answer.begin() + 2, answer.begin() + length}, late};
}

}  // namespace QV::Ipmi
