// What COM creates the objects of a class with: one for each class, there as long as the component is loaded.
#pragma once

#include <windows.h>

#include <unknwn.h>

#include "varnex3/server/Coclass.h"

namespace varnex3::server {

// An interface of the class's factory, with a reference for the caller.
HRESULT FindFactory(const Coclass& coclass, REFIID iid, void** result);

} // namespace varnex3::server
