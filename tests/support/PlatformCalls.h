// SPDX-License-Identifier: Apache-2.0
#pragma once

namespace orvtest {

// Whether this release of the platform compiles its helpers into what calls them, as from
// Android 14 on. Then traces have their calls of the virtual machine in the place of one
// step.
bool platformHelpersAreInline();

}  // namespace orvtest
