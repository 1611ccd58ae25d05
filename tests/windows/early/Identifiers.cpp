// The identifiers that the component's header declares.
#include <windows.h>

#include <ole2.h>

#include <initguid.h>

#include <Varnex3.h>
