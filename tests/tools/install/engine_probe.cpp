// SPDX-License-Identifier: Apache-2.0
// engine_probe FILE: prepares the media on the installed engine and prints their
// duration in milliseconds.
#include <orvtarn/TarnPlayer.h>
#include <stdio.h>

int main(int, char** arguments) {
    const android::sp<android::TarnPlayer> player = new android::TarnPlayer(-1);
    int duration = -1;
    android::status_t status = player->setDataSource(arguments[1], nullptr);
    if (status == 0) status = player->prepare();
    if (status == 0) status = player->getDuration(&duration);
    player->release();
    printf("%d %d\n", status, duration);
    return status == 0 ? 0 : 1;
}
