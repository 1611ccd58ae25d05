// The reasons that Windows gives, by the numbers of <cerrno>.
#pragma once

namespace varnex3::xml {

// The number that says the same on other systems; EIO for a reason that none of them has. The argument is what
// GetLastError gives.
int ErrorNumberOf(unsigned long windowsError);

} // namespace varnex3::xml
