// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <string>
#include <vector>

namespace orvtest {

// While one lives, the fakes write down all that its thread does to the world
// around the library, as one sequence: log lines, calls of the virtual machine,
// Java methods that run, operations of the engine and of the system that tests
// stand in for. The innermost one takes a step.
class Trace {
public:
    Trace();
    ~Trace();
    Trace(const Trace&) = delete;
    Trace& operator=(const Trace&) = delete;

    // What differs from run to run, or with a line that moves, is left out:
    // pointers are "%p", and the numbers of source lines "%d".
    const std::vector<std::string>& steps() const { return mSteps; }

    // By the fakes. Nothing happens on a thread without a trace.
    static void add(const std::string& kind, const std::string& text);

    // While one lives, nothing of its thread is written down: what the platform does
    // inside a function of its own is its own affair, and differs by its release.
    class Pause {
    public:
        Pause();
        ~Pause();
        Pause(const Pause&) = delete;
        Pause& operator=(const Pause&) = delete;

        // Whether one lives on the calling thread.
        static bool isOn();

    private:
        Trace* const mPaused;
    };

private:
    Trace* const mOuter;
    std::vector<std::string> mSteps;
};

}  // namespace orvtest
