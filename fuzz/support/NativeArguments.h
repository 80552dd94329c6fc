// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <gui/Surface.h>
#include <jni.h>

#include <string>
#include <type_traits>

#include "support/PlayerMachine.h"
#include "support/Words.h"

namespace orvfuzz {

// Makes the arguments of a native method from words, each as its type and its
// place in the method's signature say.
class NativeArguments {
public:
    // surface: what every android.view.Surface among them is.
    NativeArguments(PlayerMachine& machine, Words& words, const char* signature,
                    const android::sp<android::Surface>& surface)
        : mMachine(machine), mWords(words), mRest(signature + 1), mSurface(surface) {}

    template <typename T>
    T next() {
        const std::string type = takeType();
        if constexpr (std::is_same_v<T, jstring>) {
            return string();
        } else if constexpr (std::is_same_v<T, jobjectArray>) {
            return strings();
        } else if constexpr (std::is_pointer_v<T>) {
            return static_cast<T>(object(type));
        } else if constexpr (std::is_same_v<T, jboolean>) {
            return static_cast<jboolean>(mWords.flag());
        } else {
            return static_cast<T>(mWords.number());
        }
    }

private:
    std::string takeType();
    bool takeNull();
    jstring string();
    jobjectArray strings();
    jobject object(const std::string& type);

    PlayerMachine& mMachine;
    Words& mWords;
    const char* mRest;  // of the signature
    const android::sp<android::Surface>& mSurface;
};

}  // namespace orvfuzz
