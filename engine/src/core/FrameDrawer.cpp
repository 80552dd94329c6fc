// SPDX-License-Identifier: Apache-2.0
#include "core/FrameDrawer.h"

namespace orvtarn {

void FrameDrawer::skip() {
    int yes = 1;
    mpv_render_param parameters[] = {
        {MPV_RENDER_PARAM_SKIP_RENDERING, &yes},
        {MPV_RENDER_PARAM_INVALID, nullptr},
    };
    mpv_render_context_render(context(), parameters);
}

}  // namespace orvtarn
