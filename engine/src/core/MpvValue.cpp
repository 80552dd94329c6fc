// SPDX-License-Identifier: Apache-2.0
#include "core/MpvValue.h"

#include "base/LibraryVersions.h"
#include "core/MpvHandle.h"

namespace orvtarn {
namespace {

mpv_node nodeOf(const MpvAssignment& assignment) {
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
    return node;
}

// Under the property's name, or under the one that this mpv has for it.
template <typename Operation>
int underItsName(const char* property, Operation operation) {
    const int error = operation(property);
    const char* former = formerMpvName(property);
    return error == MPV_ERROR_PROPERTY_NOT_FOUND && former != nullptr ? operation(former) : error;
}

}  // namespace

std::optional<MpvAssignment> currentValue(mpv_handle* mpv, const char* property) {
    MpvNode value;
    const int error = underItsName(property, [&](const char* name) {
        return mpv_get_property(mpv, name, MPV_FORMAT_NODE, value.get());
    });
    if (error < 0) return {};
    switch ((*value).format) {
        case MPV_FORMAT_DOUBLE:
            return MpvAssignment{property, (*value).u.double_};
        case MPV_FORMAT_INT64:
            return MpvAssignment{property, (*value).u.int64};
        case MPV_FORMAT_STRING:
            return MpvAssignment{property, std::string((*value).u.string)};
        case MPV_FORMAT_FLAG:
            return MpvAssignment{property, std::string((*value).u.flag != 0 ? "yes" : "no")};
        default:
            return {};
    }
}

int assign(mpv_handle* mpv, const MpvAssignment& assignment) {
    mpv_node node = nodeOf(assignment);
    return underItsName(assignment.property.c_str(), [&](const char* name) {
        return mpv_set_property(mpv, name, MPV_FORMAT_NODE, &node);
    });
}

}  // namespace orvtarn
