// SPDX-License-Identifier: Apache-2.0
// service_probe FILE: the same through the library's media service.
#include <jni/media-service/OrvMediaService.h>
#include <orvtarn/TarnPlayer.h>
#include <stdio.h>

int main(int, char** arguments) {
    const android::sp<android::OrvMediaService> service = new android::OrvMediaService();
    int duration = -1;
    android::status_t status = service->attachPlayer(new android::TarnPlayer(-1));
    if (status == 0) status = service->setDataSource(arguments[1], nullptr);
    if (status == 0) status = service->prepare();
    if (status == 0) status = service->getDuration(&duration);
    service->disconnect();
    printf("%d %d\n", status, duration);
    return status == 0 ? 0 : 1;
}
