// SPDX-License-Identifier: Apache-2.0
#include "DivxService.h"

#include "jni/media-service/OrvMediaService.h"

namespace {

using Service = android::OrvMediaService*;

orvtest::DivxService* sService = nullptr;

template <typename... Int>
void note(const std::string& operation, Int... arguments) {
    std::string list;
    ((list += (list.empty() ? "" : ", ") + std::to_string(arguments)), ...);
    sService->calls.push_back(operation + "(" + list + ")");
}

template <typename T>
void fill(T& record, T& received, const T& answer) {
    received = record;
    record = answer;
}

}  // namespace

namespace orvtest {

DivxService::DivxService() {
    clearText(display.mText1);
    clearText(display.mText2);
    sService = this;
}
DivxService::~DivxService() { sService = nullptr; }

}  // namespace orvtest

// What the linker's --wrap makes of one operation, named as it is mangled.
#define OPERATION(mangled, parameters, arguments, ...)                                          \
    bool __real__ZN7android15OrvMediaService##mangled parameters;                               \
    bool __wrap__ZN7android15OrvMediaService##mangled parameters {                              \
        if (sService == nullptr) return __real__ZN7android15OrvMediaService##mangled arguments; \
        __VA_ARGS__;                                                                            \
        return true;                                                                            \
    }

extern "C" {

OPERATION(16getDivxTitleInfoEiR13DivxTitleInfo, (Service s, int a, DivxTitleInfo& r), (s, a, r),
          note("getDivxTitleInfo", a), fill(r, sService->receivedTitle, sService->title))
OPERATION(15getDivxChapInfoEiiiR12DivxChapInfo, (Service s, int a, int b, int c, DivxChapInfo& r),
          (s, a, b, c, r), note("getDivxChapInfo", a, b, c),
          fill(r, sService->receivedChapter, sService->chapter))
OPERATION(19getDivxPlayListInfoEiiR12DivxChapInfo, (Service s, int a, int b, DivxPlayListInfo& r),
          (s, a, b, r), note("getDivxPlayListInfo", a, b),
          fill(r, sService->receivedChapter, sService->chapter))
OPERATION(19getDivxPositionInfoER13DivxTitleInfo, (Service s, DivxPositionInfo& r), (s, r),
          note("getDivxPositionInfo"), fill(r, sService->receivedTitle, sService->title))
OPERATION(18getDivxDisplayInfoEiiiiiR15DivxDisplayInfo,
          (Service s, int a, int b, int c, int d, int e, DivxDisplayInfo& r), (s, a, b, c, d, e, r),
          note("getDivxDisplayInfo", a, b, c, d, e),
          fill(r, sService->receivedDisplay, sService->display))
OPERATION(29getDivxLastMemoryFilePositionER26DivxLastMemoryFilePosition,
          (Service s, DivxLastMemoryFilePosition& r), (s, r), note("getDivxLastMemoryFilePosition"),
          fill(r, sService->receivedPosition, sService->position))
OPERATION(15getDivxTitleNumERi, (Service s, int& n), (s, n), note("getDivxTitleNum"),
          n = sService->number)
OPERATION(23getDivxLastMemoryFileIDERi, (Service s, int& n), (s, n),
          note("getDivxLastMemoryFileID"), n = sService->number)
OPERATION(16setDivxTitleInfoEiii, (Service s, int a, int b, int c), (s, a, b, c),
          note("setDivxTitleInfo", a, b, c))
OPERATION(15setDivxChapInfoEiiii, (Service s, int a, int b, int c, int d), (s, a, b, c, d),
          note("setDivxChapInfo", a, b, c, d))
OPERATION(19setDivxPlayListInfoEiiii, (Service s, int a, int b, int c, int d), (s, a, b, c, d),
          note("setDivxPlayListInfo", a, b, c, d))
OPERATION(14setDivxBtnInfoEii, (Service s, int a, int b), (s, a, b), note("setDivxBtnInfo", a, b))
OPERATION(19setDivxFilePositionEii, (Service s, int a, int b), (s, a, b),
          note("setDivxFilePosition", a, b))
OPERATION(29setDivxLastMemoryFilePositionE26DivxLastMemoryFilePosition,
          (Service s, DivxLastMemoryFilePosition r), (s, r), note("setDivxLastMemoryFilePosition"),
          sService->receivedPosition = r)

}  // extern "C"

#undef OPERATION
