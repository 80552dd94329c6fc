// SPDX-License-Identifier: Apache-2.0
#include "LogReader.h"

#include <android/log.h>
#include <jni.h>
#include <string.h>

#include <algorithm>
#include <chrono>
#include <new>
#include <vector>

#include "NativeHandle.h"

namespace android {
namespace {

constexpr size_t kMostLines = 4096;
constexpr size_t kMostText = 2048;

// The open readers, and the priority that the terminal's lines have at least.
// Never destroyed: other threads may log while the process ends.
struct Readers {
    std::mutex mutex;
    std::vector<LogReader*> open;
    int terminalPriority = ANDROID_LOG_WARN;
};

Readers& readers() {
    static Readers* const all = new Readers;
    return *all;
}

void enter(LogReader* reader) {
    Readers& all = readers();
    std::lock_guard<std::mutex> lock(all.mutex);
    all.open.push_back(reader);
    if (all.open.size() > 1) return;
    all.terminalPriority = __android_log_get_minimum_priority();
    __android_log_set_minimum_priority(ANDROID_LOG_VERBOSE);
}

void leave(LogReader* reader) {
    Readers& all = readers();
    std::lock_guard<std::mutex> lock(all.mutex);
    all.open.erase(std::remove(all.open.begin(), all.open.end(), reader), all.open.end());
    if (all.open.empty()) __android_log_set_minimum_priority(all.terminalPriority);
}

int64_t nowMs() {
    const auto now = std::chrono::system_clock::now().time_since_epoch();
    return std::chrono::duration_cast<std::chrono::milliseconds>(now).count();
}

void append(std::string& line, const char* text) {
    if (text != nullptr) line.append(text, strnlen(text, kMostText));
    line.push_back('\0');
}

}  // namespace

bool giveToLogReaders(int priority, const char* tag, const char* text) {
    Readers& all = readers();
    std::lock_guard<std::mutex> lock(all.mutex);
    for (LogReader* reader : all.open) reader->add(priority, tag, text);
    return all.open.empty() || priority >= all.terminalPriority;
}

LogReader::LogReader() { enter(this); }

LogReader::~LogReader() { leave(this); }

void LogReader::add(int priority, const char* tag, const char* text) {
    std::string line;
    append(line, std::to_string(priority).c_str());
    append(line, std::to_string(nowMs()).c_str());
    append(line, tag);
    append(line, text);
    std::lock_guard<std::mutex> lock(mMutex);
    if (mLines.size() == kMostLines) {
        mLines.pop_front();
        mLost++;
    }
    mLines.push_back(std::move(line));
}

std::string LogReader::take() {
    std::deque<std::string> lines;
    {
        std::lock_guard<std::mutex> lock(mMutex);
        lines.swap(mLines);
    }
    std::string all;
    for (const std::string& line : lines) all += line;
    return all;
}

int64_t LogReader::lost() const {
    std::lock_guard<std::mutex> lock(mMutex);
    return mLost;
}

}  // namespace android

using namespace android;

#define LOG_METHOD(type, name) \
    extern "C" JNIEXPORT type JNICALL Java_com_quintora_mmp_desktop_LogReader_##name

LOG_METHOD(jlong, nativeOpen)(JNIEnv*, jclass) {
    return toHandle(new (std::nothrow) android::LogReader);
}

LOG_METHOD(void, nativeClose)(JNIEnv*, jclass, jlong reader) {
    delete fromHandle<android::LogReader>(reader);
}

LOG_METHOD(jbyteArray, nativeTake)(JNIEnv* env, jclass, jlong reader) {
    const std::string lines = fromHandle<android::LogReader>(reader)->take();
    const auto size = static_cast<jsize>(lines.size());
    jbyteArray bytes = env->NewByteArray(size);
    if (bytes == nullptr) return nullptr;
    env->SetByteArrayRegion(bytes, 0, size, reinterpret_cast<const jbyte*>(lines.data()));
    return bytes;
}

LOG_METHOD(jlong, nativeLost)(JNIEnv*, jclass, jlong reader) {
    return static_cast<jlong>(fromHandle<android::LogReader>(reader)->lost());
}
