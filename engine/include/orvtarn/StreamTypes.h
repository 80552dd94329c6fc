// SPDX-License-Identifier: Apache-2.0
#pragma once

// Where an offset of IOrvStreamSource::byteSeek counts from.
enum E_Orv_Stream_Seek_Type : int {
    E_ORV_STREAM_SEEK_SET = 0,
    E_ORV_STREAM_SEEK_CUR = 1,
    E_ORV_STREAM_SEEK_END = 2,
};

enum E_Orv_Stream_Source_Type : int {
    E_ORV_STREAM_SOURCE_DEFAULT = 0,
    E_ORV_STREAM_SOURCE_EXTENDED_SEEK = 3,  // seeks go to the extended seek operation
};

// Results of IOrvStreamSource::read.
enum : int {
    ORV_STREAM_ERROR_CODE_OK = 0,
    ORV_STREAM_ERROR_CODE_NOT_OK = -1,
    ORV_STREAM_ERROR_CODE_EOF = -2,
};
