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
    ORV_ERROR_IO = -1004,           // the source could not be opened or read
    ORV_ERROR_MALFORMED = -1007,    // no media format that the engine knows
    ORV_ERROR_UNSUPPORTED = -1010,  // a known format without a track it can play
};
