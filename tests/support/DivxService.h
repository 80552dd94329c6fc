// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <orvtarn/DivxRecords.h>

#include <string>
#include <vector>

namespace orvtest {

// While one lives, it answers DivX navigation in the media service's place:
// every operation is written down as text, such as "getDivxChapInfo(1, 2, 3)",
// and succeeds. The service itself never does with a player, so nothing behind
// its success could be seen otherwise. The test program's linker leads the
// service's callers here. One at a time, on one thread.
class DivxService {
public:
    DivxService();
    ~DivxService();
    DivxService(const DivxService&) = delete;
    DivxService& operator=(const DivxService&) = delete;

    // What the getters hand out. Pairs of the same shape share one.
    DivxTitleInfo title;
    DivxChapInfo chapter;
    DivxDisplayInfo display;
    DivxLastMemoryFilePosition position;
    int number = 0;

    // What came in; the records as they were before they were filled.
    std::vector<std::string> calls;
    DivxTitleInfo receivedTitle;
    DivxChapInfo receivedChapter;
    DivxDisplayInfo receivedDisplay;
    DivxLastMemoryFilePosition receivedPosition;
};

}  // namespace orvtest
