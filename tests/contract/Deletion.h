// SPDX-License-Identifier: Apache-2.0
#pragma once

namespace orvtest {

// Whether a block that was made with new is deleted while this lives. A leak is seen
// by it without a sanitizer. At most eight at a time.
class Deletion {
public:
    explicit Deletion(const void* block);
    ~Deletion();
    Deletion(const Deletion&) = delete;
    Deletion& operator=(const Deletion&) = delete;

    bool happened() const;

private:
    int mSlot = 0;
};

}  // namespace orvtest
