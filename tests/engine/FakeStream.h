// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <stream/IOrvStreamSource.h>

#include <atomic>
#include <chrono>
#include <condition_variable>
#include <memory>
#include <mutex>
#include <string>
#include <thread>
#include <vector>

namespace orvtest {

// A stream source over a file that can be made to lack abilities and to fail.
class FakeStream : public IOrvStreamSource {
public:
    explicit FakeStream(const std::string& path);

    // A source for an engine to take, which leads to this one and counts its own end here.
    IOrvStreamSource* forEngine();

    // Set before use.
    bool mSeekable = true;
    bool mHasLength = true;
    bool mStalling = false;
    std::atomic<bool> mSeeksFail{false};
    int mLongestRead = 1 << 20;
    int mOverreport = 0;           // bytes that a read claims beyond what it was asked for
    int64_t mFailsAt = INT64_MAX;  // reads from there on fail
    int64_t mEndsAt = INT64_MAX;   // reads from there on say it is the end

    // From a position on, reads block until cancelRead or letGo.
    void blockAt(int64_t position);
    void letGo();
    bool waitUntilBlocked();
    // When the last read that blocked went on.
    std::chrono::steady_clock::time_point unblockedAt() const;

    int read(char* buffer, int len, int& readLen) override;
    long long byteSeek(E_Orv_Stream_Seek_Type type, long long offset) override;
    uint32_t getFileLength() override;
    long long getCurrentPosition() override { return mPosition; }
    bool isValid() override { return mValid; }
    void setInvalid() override { mValid = false; }
    void lock() override { mLock.lock(); }
    void unlock() override { mLock.unlock(); }
    int getDataSourceType() override { return E_ORV_STREAM_SOURCE_DEFAULT; }
    bool isSeekable() override { return mSeekable; }
    void setThreadSelf() override { mThreadSelf = true; }
    bool isThreadSelf() override { return mThreadSelf; }
    void cancelRead() override;
    void closeStream() override { mCloses++; }
    long long timeSeek(long long, long long) override { return -1; }
    int getSeekType() override { return 0; }
    bool isStallingSupport() override { return mStalling; }
    uint32_t getDuration() override { return 0; }

    // What the reads delivered, each byte at its place; the rest is zero.
    std::vector<uint8_t> delivered() const;
    const std::vector<uint8_t>& content() const { return mContent; }

    std::atomic<int> mReads{0};
    std::atomic<int> mSeeks{0};
    std::atomic<int> mCancels{0};
    std::atomic<int> mCloses{0};
    std::atomic<int> mDeletes{0};
    std::atomic<std::thread::id> mDeletedOn{};
    std::atomic<int> mInside{0};  // calls under way
    std::atomic<int64_t> mEndsAtNow{INT64_MAX};

private:
    bool awaitGo(std::unique_lock<std::mutex>& lock);

    std::vector<uint8_t> mContent;
    std::vector<uint8_t> mDelivered;
    std::atomic<long long> mPosition{0};
    std::atomic<bool> mValid{true};
    std::atomic<bool> mThreadSelf{false};
    std::recursive_mutex mLock;
    mutable std::mutex mMutex;
    std::condition_variable mChanged;
    int64_t mBlocksAt = INT64_MAX;
    bool mBlocked = false;
    std::chrono::steady_clock::time_point mUnblockedAt;
    bool mCancelled = false;
};

}  // namespace orvtest
