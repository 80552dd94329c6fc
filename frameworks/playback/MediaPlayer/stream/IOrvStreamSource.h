// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <orvtarn/StreamTypes.h>
#include <stdint.h>

// A source of media bytes that the engine pulls from, on threads of its own.
// The slot order is the contract with the engine library. Whether a call
// blocks is the source's affair: read and the seeks may, the rest should not.
class IOrvStreamSource {
public:
    virtual ~IOrvStreamSource() = default;

    // Reads up to len bytes. 0 with the count in readLen (a source may report
    // more than len, but never writes more), or ORV_STREAM_ERROR_CODE_NOT_OK,
    // or ORV_STREAM_ERROR_CODE_EOF.
    virtual int read(char* buffer, int len, int& readLen) = 0;
    // The new position in bytes, negative when the seek failed.
    virtual long long byteSeek(E_Orv_Stream_Seek_Type type, long long offset) = 0;
    // Bytes; 0xFFFFFFFF when unknown, the low 32 bits of a longer length.
    virtual uint32_t getFileLength() = 0;
    virtual long long getCurrentPosition() = 0;  // bytes from the start
    virtual bool isValid() = 0;
    // From here on reads end and seeks fail without reaching the source.
    virtual void setInvalid() = 0;
    // A lock for the engine's own use.
    virtual void lock() = 0;
    virtual void unlock() = 0;
    virtual int getDataSourceType() = 0;  // an E_Orv_Stream_Source_Type
    virtual bool isSeekable() = 0;
    virtual void setThreadSelf() = 0;
    virtual bool isThreadSelf() = 0;
    // Asks a read that blocks on another thread to end.
    virtual void cancelRead() = 0;
    virtual void closeStream() = 0;
    virtual long long timeSeek(long long first, long long second) = 0;
    virtual int getSeekType() = 0;
    // Whether the source may pause in mid-stream and go on later.
    virtual bool isStallingSupport() = 0;
    virtual uint32_t getDuration() = 0;  // milliseconds, low 32 bits
};
