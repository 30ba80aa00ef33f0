#include "shared/NSUserDefaults_OrvoGroup.h"

namespace orvo::OrvoGroup {

std::shared_ptr<NSUserDefaults> __orvo_groupUserDefaults() {
    return NSUserDefaults::initWithSuiteName("group.com.zentu.Orvo");
}

} // namespace orvo::OrvoGroup
