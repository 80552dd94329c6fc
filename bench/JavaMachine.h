// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <jni.h>

#include <string>
#include <vector>

namespace orvbench {

// The Java virtual machine of this process, of which there is one at most.

// Starts it, with options as the java command takes them. 0 or a JNI error.
jint startJava(const std::vector<std::string>& options);

// Waits for Java's threads, but for its daemons, and ends it.
void endJava();

// Null before it is started.
JavaVM* javaMachine();

// Of the calling thread, which is attached if it is not yet.
JNIEnv* javaEnv();

// What the pending exception says, which is then no longer pending; empty
// without one.
std::string takeException();

}  // namespace orvbench
