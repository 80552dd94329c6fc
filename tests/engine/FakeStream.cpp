// SPDX-License-Identifier: Apache-2.0
#include "FakeStream.h"

#include <string.h>

#include <algorithm>
#include <fstream>
#include <iterator>
#include <utility>

namespace orvtest {
namespace {

std::vector<uint8_t> contentOf(const std::string& path) {
    std::ifstream file(path, std::ios::binary);
    return {std::istreambuf_iterator<char>(file), std::istreambuf_iterator<char>()};
}

class TakenStream : public IOrvStreamSource {
public:
    explicit TakenStream(FakeStream& stream) : mStream(stream) {}
    ~TakenStream() override {
        mStream.mDeletedOn = std::this_thread::get_id();
        mStream.mDeletes++;
    }

    int read(char* buffer, int len, int& readLen) override {
        return mStream.read(buffer, len, readLen);
    }
    long long byteSeek(E_Orv_Stream_Seek_Type type, long long offset) override {
        return mStream.byteSeek(type, offset);
    }
    uint32_t getFileLength() override { return mStream.getFileLength(); }
    long long getCurrentPosition() override { return mStream.getCurrentPosition(); }
    bool isValid() override { return mStream.isValid(); }
    void setInvalid() override { mStream.setInvalid(); }
    void lock() override { mStream.lock(); }
    void unlock() override { mStream.unlock(); }
    int getDataSourceType() override { return mStream.getDataSourceType(); }
    bool isSeekable() override { return mStream.isSeekable(); }
    void setThreadSelf() override { mStream.setThreadSelf(); }
    bool isThreadSelf() override { return mStream.isThreadSelf(); }
    void cancelRead() override { mStream.cancelRead(); }
    void closeStream() override { mStream.closeStream(); }
    long long timeSeek(long long first, long long second) override {
        return mStream.timeSeek(first, second);
    }
    int getSeekType() override { return mStream.getSeekType(); }
    bool isStallingSupport() override { return mStream.isStallingSupport(); }
    uint32_t getDuration() override { return mStream.getDuration(); }

private:
    FakeStream& mStream;
};

}  // namespace

IOrvStreamSource* FakeStream::forEngine() { return new TakenStream(*this); }

FakeStream::FakeStream(const std::string& path)
    : mContent(contentOf(path)), mDelivered(mContent.size()) {}

void FakeStream::blockAt(int64_t position) {
    std::lock_guard<std::mutex> lock(mMutex);
    mBlocksAt = position;
}

void FakeStream::letGo() {
    std::lock_guard<std::mutex> lock(mMutex);
    mBlocksAt = INT64_MAX;
    mChanged.notify_all();
}

bool FakeStream::waitUntilBlocked() {
    std::unique_lock<std::mutex> lock(mMutex);
    return mChanged.wait_for(lock, std::chrono::seconds(10), [this] { return mBlocked; });
}

std::chrono::steady_clock::time_point FakeStream::unblockedAt() const {
    std::lock_guard<std::mutex> lock(mMutex);
    return mUnblockedAt;
}

void FakeStream::cancelRead() {
    std::lock_guard<std::mutex> lock(mMutex);
    mCancels++;
    mCancelled = mBlocked;
    mChanged.notify_all();
}

bool FakeStream::awaitGo(std::unique_lock<std::mutex>& lock) {
    if (mPosition < mBlocksAt) return true;
    mBlocked = true;
    mChanged.notify_all();
    mChanged.wait(lock, [this] { return mCancelled || mPosition < mBlocksAt; });
    mBlocked = false;
    mUnblockedAt = std::chrono::steady_clock::now();
    return !std::exchange(mCancelled, false);
}

int FakeStream::read(char* buffer, int len, int& readLen) {
    std::unique_lock<std::mutex> lock(mMutex);
    mReads++;
    readLen = 0;
    if (!mValid) return ORV_STREAM_ERROR_CODE_EOF;
    if (!awaitGo(lock)) return ORV_STREAM_ERROR_CODE_NOT_OK;
    const int64_t position = mPosition;
    const int64_t end =
        std::min<int64_t>({static_cast<int64_t>(mContent.size()), mEndsAt, mEndsAtNow});
    if (position >= mFailsAt) return ORV_STREAM_ERROR_CODE_NOT_OK;
    if (position >= end) return ORV_STREAM_ERROR_CODE_EOF;
    const int64_t count =
        std::min<int64_t>({len, mLongestRead, end - position, mFailsAt - position});
    memcpy(buffer, &mContent[position], static_cast<size_t>(count));
    memcpy(&mDelivered[position], buffer, static_cast<size_t>(count));
    const bool over = mOverreport > 0 && count == len;
    readLen = static_cast<int>(count) + (over ? mOverreport : 0);
    mPosition = std::min<int64_t>(position + readLen, mContent.size());
    return ORV_STREAM_ERROR_CODE_OK;
}

long long FakeStream::byteSeek(E_Orv_Stream_Seek_Type type, long long offset) {
    std::lock_guard<std::mutex> lock(mMutex);
    mSeeks++;
    if (!mSeekable || mSeeksFail || !mValid) return -1;
    long long target = offset;
    if (type == E_ORV_STREAM_SEEK_CUR) target += mPosition;
    if (type == E_ORV_STREAM_SEEK_END) target += static_cast<long long>(mContent.size());
    if (target < 0 || target > static_cast<long long>(mContent.size())) return -1;
    mPosition = target;
    return target;
}

uint32_t FakeStream::getFileLength() {
    return mHasLength ? static_cast<uint32_t>(mContent.size()) : 0xFFFFFFFF;
}

std::vector<uint8_t> FakeStream::delivered() const {
    std::lock_guard<std::mutex> lock(mMutex);
    return mDelivered;
}

}  // namespace orvtest
