// SPDX-License-Identifier: Apache-2.0
// The environment's function table. What the library has no use for is there
// too, and stops the test program with its name.
#include <stdio.h>
#include <stdlib.h>

#include "FakeJni/EnvSupport.h"

namespace fakejni {

namespace {

[[noreturn]] void stop(const char* function) {
    fprintf(stderr, "fakejni: %s is not part of the fake environment\n", function);
    abort();
}

}  // namespace

void installMissing(JNINativeInterface& table) {
#define MISSING(Name) table.Name = reinterpret_cast<decltype(table.Name)>(+[]() { stop(#Name); })
    MISSING(DefineClass);
    MISSING(FromReflectedMethod);
    MISSING(FromReflectedField);
    MISSING(ToReflectedField);
    MISSING(ExceptionDescribe);
    MISSING(FatalError);
    MISSING(PushLocalFrame);
    MISSING(PopLocalFrame);
    MISSING(UnregisterNatives);
    MISSING(GetStringRegion);
    MISSING(GetStringUTFRegion);
    MISSING(GetPrimitiveArrayCritical);
    MISSING(ReleasePrimitiveArrayCritical);
    MISSING(GetStringCritical);
    MISSING(ReleaseStringCritical);
    MISSING(NewDirectByteBuffer);
    MISSING(GetDirectBufferAddress);
    MISSING(GetDirectBufferCapacity);
#define MISSING_CALLS(Name)                 \
    MISSING(CallNonvirtual##Name##Method);  \
    MISSING(CallNonvirtual##Name##MethodV); \
    MISSING(CallNonvirtual##Name##MethodA)
    MISSING_CALLS(Object);
    MISSING_CALLS(Boolean);
    MISSING_CALLS(Byte);
    MISSING_CALLS(Char);
    MISSING_CALLS(Short);
    MISSING_CALLS(Int);
    MISSING_CALLS(Long);
    MISSING_CALLS(Float);
    MISSING_CALLS(Double);
    MISSING_CALLS(Void);
#define MISSING_ARRAY(Name)                \
    MISSING(New##Name##Array);             \
    MISSING(Get##Name##ArrayElements);     \
    MISSING(Release##Name##ArrayElements); \
    MISSING(Get##Name##ArrayRegion);       \
    MISSING(Set##Name##ArrayRegion)
    MISSING_ARRAY(Boolean);
    MISSING_ARRAY(Char);
    MISSING_ARRAY(Short);
    MISSING_ARRAY(Int);
    MISSING_ARRAY(Long);
    MISSING_ARRAY(Float);
    MISSING_ARRAY(Double);
#undef MISSING_ARRAY
#undef MISSING_CALLS
#undef MISSING
}

const JNINativeInterface* envTable() {
    static const JNINativeInterface table = [] {
        JNINativeInterface made = {};
        installClasses(made);
        installFields(made);
        installMethods(made);
        installStrings(made);
        installArrays(made);
        installReferences(made);
        installExceptions(made);
        installMissing(made);
        return made;
    }();
    return &table;
}

}  // namespace fakejni
