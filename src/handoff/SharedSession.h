#pragma once

namespace orvo {

/// Makes the user's session known to the map application before something is handed over to it:
/// shared, and not reset.
void shareSessionWithOrvo();

} // namespace orvo
