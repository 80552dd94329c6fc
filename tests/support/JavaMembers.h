// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <string>

#include "FakeJni/Vm.h"

namespace orvtest {

// Gives the machine all classes and members that the library looks up, as that list
// (abi/java.txt) names them; natives are declared by definePlayerClasses.
void defineJavaMembers(fakejni::Vm& vm, const std::string& list);

// An object whose int fields are 1 and whose nested objects are there, too.
fakejni::ObjectPtr newFilledObject(fakejni::Vm& vm, const std::string& path);

}  // namespace orvtest
