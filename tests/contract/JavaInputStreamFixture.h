// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <memory>
#include <string>
#include <utility>
#include <vector>

#include "JniFixture.h"
#include "stream/JavaInputStream.h"

namespace orvtest {

constexpr char kConstructor[] = "JavaInputStream::JavaInputStream";

// A Java player that is a source of media bytes, and the stream over it.
class JavaInputStreamFixture : public JniFixture {
protected:
    void TearDown() override {
        stream.reset();
        JniFixture::TearDown();
    }

    // On the Java thread; an earlier stream goes first.
    Outcome make() {
        stream.reset();
        jobject thiz = vm.local(player);
        return observeAction([=] { stream = std::make_unique<JavaInputStream>(vm.env(), thiz); });
    }

    // On a thread of the engine's kind: native and not attached.
    Outcome onEngine(const std::function<void()>& body) {
        Outcome outcome;
        vm.onNativeThread([&] { outcome = observeAction(body); });
        return outcome;
    }

    // Gives a method of the Java player a body, before the stream is made.
    void replace(const std::string& name, const std::string& signature,
                 fakejni::Implementation body) {
        playerClass.remove(name);
        playerClass.method(name, signature, std::move(body));
        initClass();
    }
    void answer(const std::string& name, const std::string& signature, fakejni::Value value) {
        replace(name, signature, [=](const fakejni::Invocation&) { return value; });
    }

    std::unique_ptr<JavaInputStream> stream;
};

}  // namespace orvtest
