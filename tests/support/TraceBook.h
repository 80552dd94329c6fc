// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <string>
#include <vector>

namespace orvtest {

// The expected order of effects, as text: a file for each test suite, a page for
// each of its tests, a paragraph for each call that the test observed. At the end
// of each test its page must be what the file has. With ORV_ACCEPT_TRACES=1 in the
// environment the pages are written instead, to be read before they are committed.

// Adds a paragraph to the page of the running test.
void addToTracePage(const std::string& call, const std::vector<std::string>& steps);

}  // namespace orvtest
