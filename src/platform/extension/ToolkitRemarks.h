#pragma once

namespace orvo {

/// From now on what the toolkit has to remark on its surroundings goes to the log, category
/// `Toolkit`: it is nothing for a person who asked for rows. What ends the process is said on
/// standard error besides. Main thread.
void logToolkitRemarks();

} // namespace orvo
