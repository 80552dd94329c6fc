// SPDX-License-Identifier: Apache-2.0
#include "source/RequestHeaders.h"

namespace orvtarn {

std::string headerLines(const RequestHeaders& headers) {
    std::string lines;
    for (const auto& [name, value] : headers) {
        const std::string line = name + ": " + value;
        if (name.empty() || line.find_first_of("\r\n") != std::string::npos) continue;
        lines += line + "\r\n";
    }
    return lines;
}

}  // namespace orvtarn
