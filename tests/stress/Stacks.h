// SPDX-License-Identifier: Apache-2.0
#pragma once

namespace stress {

// Before there are threads that are to be shown.
void prepareStacks();
// Where each thread of the process stands, to stderr: by gdb where it is installed and
// may attach, else by a signal to each thread and addr2line. A thread that does not
// answer the signal within five seconds is named so.
void printStacks();

}  // namespace stress
