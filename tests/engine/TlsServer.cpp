// SPDX-License-Identifier: Apache-2.0
#include "TlsServer.h"

#include <gtest/gtest.h>
#include <stdlib.h>
#include <sys/wait.h>
#include <unistd.h>

#include "TestMedia.h"

namespace orvtest {

TlsServer::TlsServer(const std::string& path, const std::string& subject) {
    const std::string base = mediaPath("tls-" + std::to_string(getpid()));
    mCertificate = base + ".crt";
    const std::string key = base + ".key";
    outputOf(
        "openssl req -x509 -newkey ec -pkeyopt ec_paramgen_curve:P-256 -nodes -days 2 -subj "
        "/CN=orvtest -addext subjectAltName=" +
        subject + " -keyout '" + key + "' -out '" + mCertificate + "' 2>/dev/null");
    int input[2];
    int output[2];
    if (pipe(input) != 0 || pipe(output) != 0) {
        ADD_FAILURE() << "no pipe";
        return;
    }
    mProcess = fork();
    if (mProcess == 0) {
        dup2(input[0], STDIN_FILENO);
        dup2(output[1], STDOUT_FILENO);
        close(input[1]);
        execlp("python3", "python3", ORV_TLS_SERVER, path.c_str(), mCertificate.c_str(),
               key.c_str(), nullptr);
        _exit(127);
    }
    close(input[0]);
    close(output[1]);
    mInput = input[1];
    mOutput = output[0];
    char line[16] = {};
    if (read(mOutput, line, sizeof(line) - 1) > 0) mPort = atoi(line);
    EXPECT_GT(mPort, 0) << "no port to serve on";
}

TlsServer::~TlsServer() {
    close(mInput);
    close(mOutput);
    waitpid(mProcess, nullptr, 0);
}

std::string TlsServer::url() const {
    return "https://127.0.0.1:" + std::to_string(mPort) + "/film";
}

}  // namespace orvtest
