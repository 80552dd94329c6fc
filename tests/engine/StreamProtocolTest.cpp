// SPDX-License-Identifier: Apache-2.0
// What mpv does with the bytes of a source, in an order of its own.
#include <dlfcn.h>
#include <fcntl.h>
#include <gtest/gtest.h>
#include <mpv/stream_cb.h>

#include "TestMedia.h"
#include "source/StreamProtocol.h"

namespace {

mpv_stream_cb_open_ro_fn gOpen = nullptr;
void* gProtocol = nullptr;

}  // namespace

// In the place of mpv's own, to which it goes on.
extern "C" int mpv_stream_cb_add_ro(mpv_handle* mpv, const char* name, void* protocol,
                                    mpv_stream_cb_open_ro_fn open) {
    gOpen = open;
    gProtocol = protocol;
    const auto real =
        reinterpret_cast<decltype(&mpv_stream_cb_add_ro)>(dlsym(RTLD_NEXT, "mpv_stream_cb_add_ro"));
    return real(mpv, name, protocol, open);
}

namespace orvtarn {
namespace {

class StreamProtocolTest : public testing::Test {
protected:
    void SetUp() override {
        ASSERT_TRUE(mProtocol.install(mMpv));
        const int file = open(orvtest::mediaPath("silent.mp4").c_str(), O_RDONLY | O_CLOEXEC);
        ASSERT_GE(file, 0);
        mProtocol.setSource(std::make_shared<FdMediaSource>(file, 0, INT64_MAX));
    }
    ~StreamProtocolTest() override { mpv_terminate_destroy(mMpv); }

    mpv_stream_cb_info openStream() {
        mpv_stream_cb_info info = {};
        EXPECT_EQ(0, gOpen(gProtocol, nullptr, &info));
        return info;
    }
    static int64_t readFrom(const mpv_stream_cb_info& stream) {
        char bytes[16];
        return stream.read_fn(stream.cookie, bytes, sizeof(bytes));
    }

private:
    mpv_handle* const mMpv = mpv_create();
    StreamProtocol mProtocol;
};

TEST_F(StreamProtocolTest, ACancelledStreamReadsNoMore) {
    const mpv_stream_cb_info stream = openStream();
    EXPECT_EQ(16, readFrom(stream));
    stream.cancel_fn(stream.cookie);
    EXPECT_EQ(-1, readFrom(stream));
    stream.close_fn(stream.cookie);
}

// mpv's threads may cancel a stream when another one of them has closed it.
TEST_F(StreamProtocolTest, ACancelAfterTheCloseIsOfNoStream) {
    const mpv_stream_cb_info closed = openStream();
    closed.close_fn(closed.cookie);
    const mpv_stream_cb_info next = openStream();
    closed.cancel_fn(closed.cookie);
    EXPECT_EQ(16, readFrom(next));
    EXPECT_EQ(-1, readFrom(closed));
    next.close_fn(next.cookie);
}

}  // namespace
}  // namespace orvtarn
