// Where errors leave the library for automation hosts.
#pragma once

#include <windows.h>

#include <oleauto.h>

#include "varnex3/core/Text.h"

namespace varnex3::server {

// The exception in flight, as the thread's error object (source, description and the interface that was called) and as
// the HRESULT that hosts make an error number of: 0x800A0000 and the number. An error without a source was raised by
// this member of this class. Precondition: called from a catch block.
HRESULT Raised(Name className, Name member) noexcept;

// The thread's error object, taken from it and told the way IDispatch tells of errors. Gives DISP_E_EXCEPTION.
HRESULT Told(HRESULT status, EXCEPINFO* exception) noexcept;

} // namespace varnex3::server
