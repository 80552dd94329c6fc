// SPDX-License-Identifier: Apache-2.0
#include "NativeArguments.h"

#include <string.h>

#include "FakeJni/ModifiedUtf8.h"
#include "support/JavaObjects.h"

namespace orvfuzz {

using fakejni::ObjectPtr;

std::string NativeArguments::takeType() {
    const char* start = mRest;
    while (*mRest == '[') mRest++;
    mRest = *mRest == 'L' ? strchr(mRest, ';') + 1 : mRest + 1;
    return std::string(start, mRest);
}

bool NativeArguments::takeNull() {
    Words ahead = mWords;
    if (ahead.next() != "null") return false;
    mWords = ahead;
    return true;
}

jstring NativeArguments::string() {
    if (takeNull()) return nullptr;
    std::u16string text;
    fakejni::fromModifiedUtf8(mWords.text().c_str(), &text);
    return mMachine.vm.local<jstring>(mMachine.vm.newString(text));
}

jobjectArray NativeArguments::strings() {
    if (takeNull()) return nullptr;
    std::vector<ObjectPtr> texts;
    for (int count = mWords.below(4); count > 0; count--) {
        texts.push_back(mMachine.vm.deref(string()));
    }
    return mMachine.vm.local<jobjectArray>(mMachine.vm.newArray("java/lang/String", texts));
}

// Value classes are always given: the native methods read them unchecked, and the
// Java half passes no null there.
jobject NativeArguments::object(const std::string& type) {
    std::string path = type.substr(1, type.size() - 2);
    // The class whose fields are read is another than the signature's.
    if (path == "com/quintora/SubtitleAttr") path = "com/quintora/mmp/util/SubtitleAttr";
    fakejni::Vm& vm = mMachine.vm;
    if (path.rfind("com/quintora/", 0) == 0) {
        return vm.local(newFilledObject(vm, path, mWords));
    }
    if (path == "java/lang/Object") return vm.local(vm.newObject("java/lang/ref/WeakReference"));
    if (takeNull()) return nullptr;
    if (path == "android/view/Surface") return vm.local(orvtest::newJavaSurface(vm, mSurface));
    if (path == "java/io/FileDescriptor") {
        return vm.local(orvtest::newFileDescriptor(vm, mWords.int32()));
    }
    return vm.local(vm.newObject(path));
}

}  // namespace orvfuzz
