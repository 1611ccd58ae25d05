// The smallest program against the installed library.
#include <iostream>
#include <varnex3/varnex3.h>

int main()
{
    const auto vehicle = varnex3::New<varnex3::VehicleDef>();
    vehicle->RegistrationNo(u"ABC 123");
    std::cout << varnex3::ToUtf8(vehicle->Serialise());
}
