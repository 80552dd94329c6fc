// SPDX-License-Identifier: Apache-2.0
#pragma once

// Marks what other libraries of the process may link to; everything else is
// hidden.
#define ORV_EXPORT __attribute__((visibility("default")))
