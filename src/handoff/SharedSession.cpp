#include "handoff/SharedSession.h"

#include "platform/geoservices/UserSession.h"

namespace orvo {

void shareSessionWithOrvo() {
    UserSession::sharedInstance()
        ->orvoSessionEntityWithCallback_shareSessionIDWithOrvo_resetSession({}, true, false);
}

} // namespace orvo
