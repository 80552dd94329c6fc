// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <cstddef>
#include <string_view>

namespace orvtrace {

// What a native method of the player writes to the log when it is called.
enum class Trail {
    kPair,   // a line when it is entered and one when it is left
    kEnter,  // a line when it is entered alone
    kOccur,  // a line that says that it occurs
    kNone,   // nothing, as it is called many times a second
};

// A native method. Names are as the log has them; some methods log another's.
struct NativeMethod {
    const char* name;  // in reports
    Trail trail;
    const char* enter;  // how its first line names it
    const char* leave;  // how its last line names it
};

// All of them, in the order of registration.
extern const NativeMethod kNativeMethods[];
extern const size_t kNativeMethodCount;

// The method whose first line, or whose only one, has this name; null for none.
const NativeMethod* findEntered(std::string_view name);
// The method whose last line has this name; null for none.
const NativeMethod* findLeft(std::string_view name);
// Two methods log each other's name when they are entered: entered as one, it was the
// other if the other's name follows.
bool mayBe(const NativeMethod& entered, const NativeMethod& left);
// Whether the outer method calls the inner one.
bool calls(const NativeMethod& outer, const NativeMethod& inner);

}  // namespace orvtrace
