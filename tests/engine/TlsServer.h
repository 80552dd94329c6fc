// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <string>

namespace orvtest {

// Serves a file over TLS on a port of this machine, with a certificate of its
// own that nobody trusts by itself.
class TlsServer {
public:
    // A name or address that the certificate is for, as in "IP:127.0.0.1".
    TlsServer(const std::string& path, const std::string& subject);
    ~TlsServer();

    std::string url() const;
    // The file of the certificate.
    const std::string& certificate() const { return mCertificate; }

private:
    std::string mCertificate;
    int mPort = 0;
    int mInput = -1;
    int mOutput = -1;
    int mProcess = -1;
};

}  // namespace orvtest
