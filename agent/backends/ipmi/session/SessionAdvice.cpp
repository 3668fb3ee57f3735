#include "agent/backends/ipmi/session/SessionAdvice.h"

#include <freeipmi/freeipmi.h>

namespace QV::Ipmi {
namespace {

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

}  // namespace

std::string openingAdvice(const IpmiSettings& settings, int error) {
  return settings.connection == IpmiSettings::Connection::Lan ? lanAdvice(settings, error) : inBandAdvice(error);
}

}  // namespace QV::Ipmi
