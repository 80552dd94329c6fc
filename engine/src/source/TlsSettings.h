// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <string>

namespace orvtarn {

// Whether servers must have a certificate that is trusted: always, unless the
// environment says ORV_TLS_VERIFY=no.
bool verifiesCertificates();

// The file of the certificates that are trusted: that of SSL_CERT_FILE, or the
// system's. Empty where neither is: the TLS library has its own then.
std::string certificateFile();

}  // namespace orvtarn
