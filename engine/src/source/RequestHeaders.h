// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <string>
#include <utility>
#include <vector>

namespace orvtarn {

// Names and values of the headers of an HTTP request, in order.
using RequestHeaders = std::vector<std::pair<std::string, std::string>>;

// As libav takes them: "name: value" lines, each with its line end. Headers
// without a name or with a line break, which would smuggle in others, are left
// out.
std::string headerLines(const RequestHeaders& headers);

}  // namespace orvtarn
