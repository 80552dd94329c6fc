// SPDX-License-Identifier: Apache-2.0
#include "MpvValue.h"

namespace orvtarn {

int assign(mpv_handle* mpv, const MpvAssignment& assignment) {
    mpv_node node = {};
    if (const double* number = std::get_if<double>(&assignment.value)) {
        node.format = MPV_FORMAT_DOUBLE;
        node.u.double_ = *number;
    } else if (const int64_t* integer = std::get_if<int64_t>(&assignment.value)) {
        node.format = MPV_FORMAT_INT64;
        node.u.int64 = *integer;
    } else {
        node.format = MPV_FORMAT_STRING;
        // Only read by mpv, whatever the type says.
        node.u.string = const_cast<char*>(std::get_if<std::string>(&assignment.value)->c_str());
    }
    return mpv_set_property(mpv, assignment.property.c_str(), MPV_FORMAT_NODE, &node);
}

}  // namespace orvtarn
