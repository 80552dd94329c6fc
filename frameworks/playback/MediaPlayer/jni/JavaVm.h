// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <jni.h>

// The process's virtual machine: null until the library is loaded, then never
// written again. Threads of the engine and of the dispatcher attach through it.
extern JavaVM* g__JavaVM;
