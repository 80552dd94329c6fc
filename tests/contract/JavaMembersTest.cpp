// SPDX-License-Identifier: Apache-2.0
// What the library needs of the Java side, as its own lookups tell it to a
// virtual machine that has whatever is asked for. The list is checked in as
// abi/java.txt, for ./orv doctor --classes; ./orv abi --accept rewrites it.

#include <stdlib.h>

#include <algorithm>
#include <fstream>
#include <iterator>
#include <string>
#include <vector>

#include "JniFixture.h"
#include "NativeMethodRows.h"
#include "dispatch/SyncToAsync.h"
#include "jni/DivxNavigation.h"
#include "jni/OrvMediaClient.h"

namespace orvtest {
namespace {

using fakejni::Class;
using fakejni::Field;
using fakejni::ObjectPtr;
using fakejni::Value;

// The lookups of one run: classes in the order they were first met, and each
// one's members.
class Needs {
public:
    void add(const std::string& path, const std::string& member) {
        auto found = std::find_if(mClasses.begin(), mClasses.end(),
                                  [&](const Entry& entry) { return entry.path == path; });
        if (found == mClasses.end()) found = mClasses.insert(mClasses.end(), Entry{path, {}});
        auto& members = found->members;
        if (std::find(members.begin(), members.end(), member) == members.end()) {
            members.push_back(member);
        }
    }

    std::string text() const {
        std::string out =
            "# What the library looks up in Java. Written by ./orv abi --accept, checked by\n"
            "# JavaMembersTest.\n";
        for (const Entry& entry : mClasses) {
            out += "class " + entry.path + "\n";
            for (const std::string& member : entry.members) out += "    " + member + "\n";
        }
        return out;
    }

private:
    struct Entry {
        std::string path;
        std::vector<std::string> members;
    };
    std::vector<Entry> mClasses;
};

struct Agreeable {
    fakejni::Vm& vm;
    JNINativeInterface original;
    Needs needs;
};
Agreeable* gAgreeable;

Class& classOf(jclass handle) { return *gAgreeable->vm.deref(handle)->reflected; }

jclass findClass(JNIEnv* env, const char* path) {
    if (gAgreeable->vm.find(path) == nullptr) gAgreeable->vm.define(path);
    return gAgreeable->original.FindClass(env, path);
}

jfieldID getFieldID(JNIEnv* env, jclass handle, const char* name, const char* signature) {
    Class& type = classOf(handle);
    gAgreeable->needs.add(type.path, std::string("field ") + name + " " + signature);
    if (type.findField(name, signature, false) == nullptr) type.field(name, signature);
    return gAgreeable->original.GetFieldID(env, handle, name, signature);
}

jmethodID getMethodID(JNIEnv* env, jclass handle, const char* name, const char* signature) {
    Class& type = classOf(handle);
    gAgreeable->needs.add(type.path, std::string("method ") + name + " " + signature);
    if (type.findMethod(name, signature, false) == nullptr) type.method(name, signature);
    return gAgreeable->original.GetMethodID(env, handle, name, signature);
}

jmethodID getStaticMethodID(JNIEnv* env, jclass handle, const char* name, const char* signature) {
    gAgreeable->needs.add(classOf(handle).path,
                          std::string("static method ") + name + " " + signature);
    return gAgreeable->original.GetStaticMethodID(env, handle, name, signature);
}

// A field read through the ID of a class is good for its subclasses alone.
const Field& fieldOf(jobject handle, jfieldID id) {
    const Field& field = *reinterpret_cast<Field*>(id);
    const std::string& type = gAgreeable->vm.deref(handle)->type->path;
    if (type != field.owner->path) gAgreeable->needs.add(type, "extends " + field.owner->path);
    return field;
}

jint getIntField(JNIEnv* env, jobject handle, jfieldID id) {
    fieldOf(handle, id);
    return gAgreeable->original.GetIntField(env, handle, id);
}

// No nested object is null.
jobject getObjectField(JNIEnv* env, jobject handle, jfieldID id) {
    const std::string& signature = fieldOf(handle, id).signature;
    const std::string path = signature.substr(1, signature.size() - 2);
    fakejni::Vm& vm = gAgreeable->vm;
    if (vm.find(path) == nullptr) vm.define(path);
    vm.deref(handle)->set(fieldOf(handle, id).name, Value::of(vm.newObject(path)));
    return gAgreeable->original.GetObjectField(env, handle, id);
}

template <typename Result, typename Receiver, typename... Arguments>
constexpr bool isStatic(Result (*)(JNIEnv*, Receiver, Arguments...)) {
    return std::is_same_v<Receiver, jclass>;
}

class JavaMembersTest : public VmFixture {
protected:
    JavaMembersTest() : agreeable{vm, *vm.env()->functions, {}}, table(agreeable.original) {
        gAgreeable = &agreeable;
        table.FindClass = findClass;
        table.GetFieldID = getFieldID;
        table.GetMethodID = getMethodID;
        table.GetStaticMethodID = getStaticMethodID;
        table.GetIntField = getIntField;
        table.GetObjectField = getObjectField;
        vm.env()->functions = &table;
    }
    ~JavaMembersTest() override { vm.env()->functions = &agreeable.original; }

    void addNativeMethods() {
        using namespace android;
#define ROW(name, signature, function)                                                      \
    agreeable.needs.add(kPlayerClass, std::string(isStatic(&(function)) ? "static " : "") + \
                                          "native " + (name) + " " + (signature));
        ORV_NATIVE_METHODS(ROW)
#undef ROW
    }

    template <typename R = void, typename... A>
    void call(const std::string& name, const std::string& signature, const std::string& returned,
              A... arguments) {
        const Outcome outcome = callOn<R>(player, name, signature, arguments...);
        EXPECT_EQ(outcome.returned, returned) << name;
    }

    jobject newObject(const std::string& path) {
        if (vm.find(path) == nullptr) vm.define(path);
        return vm.local(vm.newObject(path));
    }

    // An object whose mask has every bit.
    jobject everySubtitleAttr() {
        vm.define("com/quintora/mmp/util/SubtitleAttr").field("mMask", "I");
        vm.define("com/quintora/SubtitleAttr", "com/quintora/mmp/util/SubtitleAttr");
        const ObjectPtr attr = vm.newObject("com/quintora/SubtitleAttr");
        attr->set("mMask", Value::ofInt(-1));
        return vm.local(attr);
    }

    void fillEngine(ScriptedEngine& engine) {
        for (const char* tracks :
             {"getVideoTrackCount", "getAudioTrackCount", "getSubtitleTrackCount"}) {
            engine.put(tracks, 1);
        }
        engine.currentVideoCodec.emplace();
        engine.videoCodecs[0];
        engine.subtitleTracks[0];
        engine.audioTracks[0];
        engine.metaDataInfo.emplace();
        engine.answer("setPCMMediaInfo", {0});
    }

    void deliverDivxRecords() {
        JNIEnv* env = vm.env();
        jobject thiz = vm.local(player);
        DivxDisplayInfo display;
        clearText(display.mText1);
        clearText(display.mText2);
        vm.tolerate("setDivxDisplayInfoPrm");
        EXPECT_TRUE(android::deliverDivxTitleInfo(env, thiz, {}));
        EXPECT_TRUE(android::deliverDivxChapInfo(env, thiz, {}));
        EXPECT_TRUE(android::deliverDivxPlayListInfo(env, thiz, {}));
        EXPECT_TRUE(android::deliverDivxPositionInfo(env, thiz, {}));
        table.CallVoidMethodV = [](JNIEnv*, jobject, jmethodID, va_list) {};
        EXPECT_TRUE(android::deliverDivxDisplayInfo(env, thiz, display));
        EXPECT_TRUE(android::deliverDivxLastMemoryFilePosition(env, thiz, {}));
    }

    Agreeable agreeable;
    JNINativeInterface table;
    ObjectPtr player;
};

TEST_F(JavaMembersTest, AreTheListOfTheDoctor) {
    ORV::SyncToAsync::getInstance();  // the first use logs more than the later ones
    addNativeMethods();
    loadLibrary();
    initClass();
    player = newPlayer();
    call("native_setup", "(Ljava/lang/Object;)V", "void", newObject("java/lang/Object"));
    fillEngine(*ScriptedEngine::last());

    call<jboolean>("native_getVideoCodecInfo", "()Z", "true");
    call<jint>("native_getAllVideoTrackInfo", "()I", "0");
    call<jint>("native_getAllAudioTrackInfo", "(Z)I", "1", jboolean(true));
    call<jboolean>("native_getSubtitleTrackInfo", "(I)Z", "true", jint(0));
    call<jint>("native_getAllSubtitleTrackInfo", "()I", "1");
    call<jboolean>("native_getMetaDataInfo", "()Z", "true");
    call("native_setSubtitleAttr", "(Lcom/quintora/SubtitleAttr;)V", "void", everySubtitleAttr());
    call<jbyteArray>("native_getThumbnailInfo", "(Lcom/quintora/mmp/util/ThumbnailInfo;)[B", "null",
                     newObject("com/quintora/mmp/util/ThumbnailInfo"));
    call("native_setPcmMediaInfo", "(Lcom/quintora/mmp/util/PcmMediaInfo;)V", "void",
         newObject("com/quintora/mmp/util/PcmMediaInfo"));
    call<jint>("native_setDivxLastMemoryFilePosition",
               "(Lcom/quintora/mmp/util/DivxLastMemoryFilePosition;)I", "-1",
               newObject("com/quintora/mmp/util/DivxLastMemoryFilePosition"));
    deliverDivxRecords();
    call("native_release", "()V", "void");

    const std::string needs = agreeable.needs.text();
    if (getenv("ORV_ACCEPT_ABI") != nullptr) std::ofstream(ORV_JAVA_MEMBERS) << needs;
    std::ifstream file(ORV_JAVA_MEMBERS);
    const std::string listed(std::istreambuf_iterator<char>(file), {});
    EXPECT_EQ(listed, needs) << "if this is meant, ./orv abi --accept writes " ORV_JAVA_MEMBERS;
}

}  // namespace
}  // namespace orvtest
