// SPDX-License-Identifier: Apache-2.0
#pragma once

namespace orvtrace {

// page.html, in which kPageData stands where a trace's data go.
extern const char kPage[];
constexpr char kPageData[] = "{{DATA}}";

}  // namespace orvtrace
