// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <string>

#include "FakeJni/Vm.h"

namespace stress {

// Gives the machine all that the library looks up in Java, as listed in abi/java.txt,
// beyond what it has already.
void defineJavaMembers(fakejni::Vm& vm, const std::string& list);

}  // namespace stress
