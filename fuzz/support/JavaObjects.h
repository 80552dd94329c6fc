// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <string>

#include "FakeJni/Vm.h"
#include "support/Words.h"

namespace orvfuzz {

// The value classes that native methods read, with the fields of the real ones,
// and the player's methods that hand records to Java.
void defineValueClasses(fakejni::Vm& vm);
void defineCallbacks(fakejni::Class& player);

// An object of that class whose fields, and those of the objects in them, are
// the next words.
fakejni::ObjectPtr newFilledObject(fakejni::Vm& vm, const std::string& path, Words& words);

}  // namespace orvfuzz
