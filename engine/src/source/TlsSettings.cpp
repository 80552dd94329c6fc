// SPDX-License-Identifier: Apache-2.0
#include "source/TlsSettings.h"

#include <stdlib.h>
#include <string.h>
#include <unistd.h>

namespace orvtarn {
namespace {

// Where Debian, Fedora, SUSE and Alpine keep them.
const char* const kSystemFiles[] = {
    "/etc/ssl/certs/ca-certificates.crt",
    "/etc/pki/tls/certs/ca-bundle.crt",
    "/etc/ssl/ca-bundle.pem",
    "/etc/ssl/cert.pem",
};

}  // namespace

bool verifiesCertificates() {
    const char* verify = getenv("ORV_TLS_VERIFY");
    return verify == nullptr || strcmp(verify, "no") != 0;
}

std::string certificateFile() {
    const char* named = getenv("SSL_CERT_FILE");
    if (named != nullptr && *named != '\0') return named;
    for (const char* file : kSystemFiles) {
        if (access(file, R_OK) == 0) return file;
    }
    return "";
}

}  // namespace orvtarn
