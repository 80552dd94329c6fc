// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <mpv/client.h>
#include <stdint.h>

#include <string>
#include <variant>

namespace orvtarn {

// A property of mpv and the value to give it, typed: numbers as text would
// depend on the process's locale.
struct MpvAssignment {
    std::string property;
    std::variant<double, int64_t, std::string> value;
};

// Sets the property. 0 or an mpv_error.
int assign(mpv_handle* mpv, const MpvAssignment& assignment);

}  // namespace orvtarn
