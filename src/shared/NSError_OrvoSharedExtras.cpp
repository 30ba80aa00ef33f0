#include "shared/NSError_OrvoSharedExtras.h"

namespace orvo::OrvoSharedExtras {

std::shared_ptr<NSError> _orvo_cancellationError() {
    return NSError::errorWithDomain_code_userInfo(
        NSCocoaErrorDomain, NSUserCancelledError, nullptr);
}

bool _orvo_isCancellation(const std::shared_ptr<NSError>& self) {
    return _orvo_isErrorOfDomain_code(self, NSCocoaErrorDomain, NSUserCancelledError);
}

bool _orvo_isErrorOfDomain_code(const std::shared_ptr<NSError>& self,
                                const std::string& domain,
                                std::int64_t code) {
    return self && self->domain() == domain && self->code() == code;
}

} // namespace orvo::OrvoSharedExtras
