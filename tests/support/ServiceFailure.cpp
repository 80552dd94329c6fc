// SPDX-License-Identifier: Apache-2.0
#include "ServiceFailure.h"

#include "jni/media-service/OrvMediaService.h"

using android::OrvMediaService;
using android::status_t;

namespace {

status_t sStatus = android::NO_ERROR;
int sCliArgument = 0;

}  // namespace

namespace orvtest {

ServiceFailure::ServiceFailure(status_t status) { sStatus = status; }
ServiceFailure::~ServiceFailure() { sStatus = android::NO_ERROR; }

int lastCliArgument() { return sCliArgument; }

}  // namespace orvtest

// What the linker's --wrap makes of attachAuxEffect(int),
// setAuxEffectSendLevel(float) and ServiceSendCliCommand(unsigned char*, int).
extern "C" {

status_t __real__ZN7android15OrvMediaService15attachAuxEffectEi(OrvMediaService* service, int id);
status_t __real__ZN7android15OrvMediaService21setAuxEffectSendLevelEf(OrvMediaService* service,
                                                                      float level);

status_t __wrap__ZN7android15OrvMediaService15attachAuxEffectEi(OrvMediaService* service, int id) {
    const status_t status = __real__ZN7android15OrvMediaService15attachAuxEffectEi(service, id);
    return sStatus != android::NO_ERROR ? sStatus : status;
}

status_t __wrap__ZN7android15OrvMediaService21setAuxEffectSendLevelEf(OrvMediaService* service,
                                                                      float level) {
    const status_t status =
        __real__ZN7android15OrvMediaService21setAuxEffectSendLevelEf(service, level);
    return sStatus != android::NO_ERROR ? sStatus : status;
}

bool __real__ZN7android15OrvMediaService21ServiceSendCliCommandEPhi(OrvMediaService* service,
                                                                    unsigned char* cmd, int len);

bool __wrap__ZN7android15OrvMediaService21ServiceSendCliCommandEPhi(OrvMediaService* service,
                                                                    unsigned char* cmd, int len) {
    sCliArgument = len;
    const bool good =
        __real__ZN7android15OrvMediaService21ServiceSendCliCommandEPhi(service, cmd, len);
    return good && sStatus == android::NO_ERROR;
}

}  // extern "C"
