// SPDX-License-Identifier: Apache-2.0
#include "cimom/http/Certificate.h"

#include <gnutls/gnutls.h>
#include <gnutls/x509.h>

#include <utility>

#include "cimom/http/Listener.h"

namespace Cimom::Http {
namespace {

constexpr unsigned longestChain = 16;

gnutls_datum_t datumOf(const std::string& text) {
  return {reinterpret_cast<unsigned char*>(const_cast<char*>(text.data())), static_cast<unsigned>(text.size())};
}

void require(int result, const char* what) {
  if (result < 0) {
    throw ServerError(std::string(what) + ": " + gnutls_strerror(result));
  }
}

// What GnuTLS checks when the two are handed to it together: that they belong together.
void requireMatch(const gnutls_datum_t& chain, const gnutls_datum_t& key) {
  gnutls_certificate_credentials_t both = nullptr;
  require(gnutls_certificate_allocate_credentials(&both), "tls-certificate");
  const int result = gnutls_certificate_set_x509_key_mem2(both, &chain, &key, GNUTLS_X509_FMT_PEM, nullptr, 0);
  gnutls_certificate_free_credentials(both);
  require(result, "tls-certificate and tls-key must be unencrypted PEM and belong together");
}

}  // namespace

Certificate::Certificate(const std::string& chain, const std::string& key) {
  const gnutls_datum_t chainText = datumOf(chain);
  const gnutls_datum_t keyText = datumOf(key);
  requireMatch(chainText, keyText);
  std::vector<gnutls_pcert_st> certificates(longestChain);
  unsigned count = longestChain;
  require(gnutls_pcert_list_import_x509_raw(certificates.data(), &count, &chainText, GNUTLS_X509_FMT_PEM, 0),
          "tls-certificate");
  certificates.resize(count);
  chain_ = std::move(certificates);
  require(gnutls_privkey_init(&key_), "tls-key");
  const int imported = gnutls_privkey_import_x509_raw(key_, &keyText, GNUTLS_X509_FMT_PEM, nullptr, 0);
  if (imported < 0) {
    gnutls_privkey_deinit(key_);
    for (gnutls_pcert_st& certificate : chain_) {
      gnutls_pcert_deinit(&certificate);
    }
  }
  require(imported, "tls-key");
}

Certificate::~Certificate() {
  gnutls_privkey_deinit(key_);
  for (gnutls_pcert_st& certificate : chain_) {
    gnutls_pcert_deinit(&certificate);
  }
}

}  // namespace Cimom::Http
