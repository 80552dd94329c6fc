// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <mpv/client.h>
#include <stdint.h>

#include <optional>
#include <string>
#include <variant>

namespace orvtarn {

// A property of mpv and the value to give it, typed: numbers as text would
// depend on the process's locale.
struct MpvAssignment {
    std::string property;
    std::variant<double, int64_t, std::string> value;
};

// What the property is set to now, in mpv's own type for it.
std::optional<MpvAssignment> currentValue(mpv_handle* mpv, const char* property);

// Sets the property. 0 or an mpv_error. Both know a property by its name in the
// newest mpv.
int assign(mpv_handle* mpv, const MpvAssignment& assignment);

}  // namespace orvtarn
