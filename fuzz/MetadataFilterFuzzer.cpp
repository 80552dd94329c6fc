// SPDX-License-Identifier: Apache-2.0
//
// Metadata filters from any parcel, held to a second reading of the same words.
// Input: words of 32 bits; "at N" sets the position that is read from, "cut N"
// takes that many bytes off the end, "set" sets the filter and starts afresh.
#include <binder/Parcel.h>
#include <jni/media-service/OrvMediaService.h>
#include <string.h>

#include <algorithm>
#include <optional>
#include <set>
#include <vector>

#include "support/QuietLog.h"
#include "support/Require.h"
#include "support/Words.h"

namespace {

using orvfuzz::require;
using Codes = std::set<int>;

// The filters as they should stand.
class Model {
public:
    android::status_t set(const std::vector<uint8_t>& bytes, size_t position) {
        mBytes = &bytes;
        mPosition = std::min(position, bytes.size());
        Codes allow, drop;
        const android::status_t status = readSet(allow);
        if (status != android::NO_ERROR) return status;
        const android::status_t second = readSet(drop);
        if (second != android::NO_ERROR) return second;
        mAllow = allow;
        mDrop = drop;
        return android::NO_ERROR;
    }
    bool drops(int code) const {
        return finds(mDrop, code) || (!mAllow.empty() && !finds(mAllow, code));
    }
    Codes codes() const {
        Codes all = {-1, 0, 1, INT32_MIN, INT32_MAX};
        all.insert(mAllow.begin(), mAllow.end());
        all.insert(mDrop.begin(), mDrop.end());
        return all;
    }

private:
    std::optional<int32_t> word() {
        int32_t value;
        if (mBytes->size() - mPosition < sizeof(value)) return {};
        memcpy(&value, mBytes->data() + mPosition, sizeof(value));
        mPosition += sizeof(value);
        return value;
    }
    android::status_t readSet(Codes& codes) {
        const std::optional<int32_t> count = word();
        if (!count) return android::NOT_ENOUGH_DATA;
        if (*count < 0 || *count > 64) return android::BAD_VALUE;
        for (int32_t i = 0; i < *count; i++) {
            const std::optional<int32_t> code = word();
            if (!code) return android::NOT_ENOUGH_DATA;
            codes.insert(*code);
        }
        return android::NO_ERROR;
    }
    // The smallest code stands first, and 0 there stands for any.
    static bool finds(const Codes& codes, int code) {
        return !codes.empty() && (*codes.begin() == 0 || codes.count(code) != 0);
    }

    const std::vector<uint8_t>* mBytes = nullptr;
    size_t mPosition = 0;
    Codes mAllow, mDrop;
};

struct Filter {
    std::vector<uint8_t> bytes;
    size_t position = 0;

    void add(int32_t word) {
        const auto* start = reinterpret_cast<const uint8_t*>(&word);
        bytes.insert(bytes.end(), start, start + sizeof(word));
    }
    void cut(size_t count) { bytes.resize(bytes.size() - std::min(count, bytes.size())); }
};

void setBoth(android::OrvMediaService& service, Model& model, const Filter& filter) {
    android::Parcel parcel;
    parcel.setData(filter.bytes.data(), filter.bytes.size());
    parcel.setDataPosition(filter.position);
    require(service.setMetadataFilter(parcel) == model.set(filter.bytes, filter.position),
            "the status is that of the words");
    for (int code : model.codes()) {
        require(service.shouldDropMetadata(code) == model.drops(code),
                "a code is dropped as the filters say");
    }
}

}  // namespace

extern "C" int LLVMFuzzerInitialize(int*, char***) {
    orvfuzz::quietLog();
    return 0;
}

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size) {
    orvfuzz::Words words(data, size);
    android::sp<android::OrvMediaService> service = new android::OrvMediaService;
    Model model;
    Filter filter;
    while (!words.atEnd()) {
        orvfuzz::Words ahead = words;
        const std::string_view word = ahead.next();
        if (word == "at") {
            words = ahead;
            filter.position = static_cast<size_t>(words.below(1 << 16));
        } else if (word == "cut") {
            words = ahead;
            filter.cut(static_cast<size_t>(words.below(1 << 16)));
        } else if (word == "set") {
            words = ahead;
            setBoth(*service, model, filter);
            filter = Filter();
        } else {
            filter.add(words.int32());
        }
    }
    setBoth(*service, model, filter);
    return 0;
}
