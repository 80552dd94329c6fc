// SPDX-License-Identifier: Apache-2.0
#pragma once

// Argument of the player context's engine creation.
enum E_OrvPlayer_Type : int {
    E_ORV_PLAYER_TYPE_DEFAULT = 0,
    E_ORV_PLAYER_TYPE_TARN = 1,
};

// What a player is for on the screen.
enum E_Orv_Player_Role_Type : int {
    E_ORV_PLAYER_ROLE_MAIN = 0,        // picture and sound
    E_ORV_PLAYER_ROLE_SUB = 1,         // picture only, as in a picture-in-picture window
    E_ORV_PLAYER_ROLE_BACKGROUND = 2,  // sound only
};

// Argument of setABRepeat. Marks are taken at the current position.
enum E_Orv_AB_Repeat_Type : int {
    E_ORV_AB_REPEAT_OFF = 0,    // forget both marks
    E_ORV_AB_REPEAT_SET_A = 1,  // begin the section here
    E_ORV_AB_REPEAT_SET_B = 2,  // end it here and repeat it from now on
};

// Play speeds are in thousandths of the normal speed; negative plays backward.
enum : int {
    ORV_SPEED_NORMAL = 1000,
    ORV_SPEED_MAX = 32000,
    ORV_SPEED_MIN = -32000,
};

// Statuses of the engine beyond the platform's own.
enum : int {
    ORV_ERROR_UNKNOWN_HOST = -1002,     // the address names a host that is not known
    ORV_ERROR_CANNOT_CONNECT = -1003,   // the server refuses the connection
    ORV_ERROR_IO = -1004,               // the source could not be opened or read
    ORV_ERROR_CONNECTION_LOST = -1005,  // the connection broke
    ORV_ERROR_MALFORMED = -1007,        // unknown format
    ORV_ERROR_UNSUPPORTED = -1010,      // a known format without a track it can play

    ORV_ERROR_SCHEME = -1101,           // addresses of this scheme are not opened
    ORV_ERROR_LOCAL_REFERENCE = -1102,  // media that lead to a local file and must not
    ORV_ERROR_NO_ANSWER = -1103,        // the server does not answer in time
    ORV_ERROR_REDIRECTS = -1104,        // the server redirects without end
    ORV_ERROR_CERTIFICATE = -1105,      // the server's certificate is not trusted
    ORV_ERROR_CUT_SHORT = -1106,        // the server sends less than it announces
    ORV_ERROR_NEEDS_RANGES = -1107,     // a format that needs byte ranges, which the server lacks
    ORV_ERROR_EMPTY = -1108,            // not a single byte

    // A known format in which nothing can be played: this minus an E_Orv_Format.
    ORV_ERROR_NOTHING_INSIDE = -1200,
    // An HTTP status other than success: this minus that status, as in -2404.
    ORV_ERROR_HTTP = -2000,
};

// Container formats, as ORV_ERROR_NOTHING_INSIDE names them.
enum E_Orv_Format : int {
    E_ORV_FORMAT_OTHER = 0,
    E_ORV_FORMAT_MP4 = 1,
    E_ORV_FORMAT_MATROSKA = 2,
    E_ORV_FORMAT_AVI = 3,
    E_ORV_FORMAT_MPEG_TS = 4,
    E_ORV_FORMAT_MPEG_PS = 5,
    E_ORV_FORMAT_FLV = 6,
    E_ORV_FORMAT_ASF = 7,
    E_ORV_FORMAT_OGG = 8,
    E_ORV_FORMAT_WAV = 9,
    E_ORV_FORMAT_FLAC = 10,
    E_ORV_FORMAT_MP3 = 11,
    E_ORV_FORMAT_AAC = 12,
    E_ORV_FORMAT_AIFF = 13,
};
