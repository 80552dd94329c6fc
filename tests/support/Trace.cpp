// SPDX-License-Identifier: Apache-2.0
#include "Trace.h"

#include <stdio.h>

#include <regex>

namespace orvtest {
namespace {

thread_local Trace* sInnermost = nullptr;
thread_local int sPauses = 0;

// One step is one line.
std::string escaped(const std::string& text) {
    std::string line;
    for (const char c : text) {
        const auto byte = static_cast<unsigned char>(c);
        char code[5];
        snprintf(code, sizeof code, "\\x%02x", byte);
        const bool isPlain = byte >= ' ' && byte < 0x7f;
        line += isPlain ? std::string(1, c) : c == '\n' ? "\\n" : code;
    }
    return line;
}

std::string withoutNumbersOfThisRun(const std::string& text) {
    static const std::regex kPointer("0x[0-9a-f]{5,}");
    static const std::regex kLine("Line:[0-9]+");
    // Two DivX records pass arguments that do not fit the signature: what Java makes of
    // them differs by the machine's word, or is an address.
    static const std::regex kMisfits("(setDivx(DisplayInfo|LastMemoryFilePosition)Prm)\\(.*");
    std::string steady = std::regex_replace(text, kPointer, "%p");
    steady = std::regex_replace(steady, kLine, "Line:%d");
    return std::regex_replace(steady, kMisfits, "$1");
}

}  // namespace

Trace::Trace() : mOuter(sInnermost) { sInnermost = this; }

Trace::~Trace() { sInnermost = mOuter; }

void Trace::add(const std::string& kind, const std::string& text) {
    if (sInnermost == nullptr) return;
    sInnermost->mSteps.push_back(kind + " " + withoutNumbersOfThisRun(escaped(text)));
}

Trace::Pause::Pause() : mPaused(sInnermost) {
    sInnermost = nullptr;
    sPauses++;
}

Trace::Pause::~Pause() {
    sInnermost = mPaused;
    sPauses--;
}

bool Trace::Pause::isOn() { return sPauses > 0; }

}  // namespace orvtest
