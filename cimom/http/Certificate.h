// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <gnutls/abstract.h>

#include <string>
#include <vector>

namespace Cimom::Http {

// The certificate with which the server shows who it is, and its key. A connection holds it from its beginning on, so
// that it can be replaced meanwhile.
class Certificate {
 public:
  // The chain, and the unencrypted key of its first certificate, as PEM. Throws ServerError.
  Certificate(const std::string& chain, const std::string& key);
  ~Certificate();
  Certificate(const Certificate&) = delete;
  Certificate& operator=(const Certificate&) = delete;

  std::vector<gnutls_pcert_st>& chain() { return chain_; }
  gnutls_privkey_t key() const { return key_; }

 private:
  std::vector<gnutls_pcert_st> chain_;
  gnutls_privkey_t key_ = nullptr;
};

}  // namespace Cimom::Http
