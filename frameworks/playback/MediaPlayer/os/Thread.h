// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <pthread.h>

#include <string>

#include "os/Export.h"

namespace os {

// A named thread whose body is Run. Destroy it only after Wait has returned;
// the thread itself is neither joined nor detached.
class ORV_EXPORT Thread {
public:
    explicit Thread(const std::string& name);
    virtual ~Thread();
    Thread(const Thread&) = delete;
    Thread& operator=(const Thread&) = delete;

    virtual void Run() = 0;

    // Starts Run on a new thread, once. Failures are printed; Run then never
    // begins and Wait never returns.
    void Start();
    // Blocks until Run has returned. 0, or -1.
    int Wait();
    // Sleeps on the calling thread; an interrupted sleep is not resumed.
    static void sleep(const int& ms);

private:
    class Implmentation;

    static void* start(void* arg);

    std::string mName;
    pthread_t mHandle;
    pthread_attr_t* mAttributes;
    Implmentation* mImplmentation;
};

}  // namespace os
