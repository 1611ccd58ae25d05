#include "varnex3/server/TypeLibraryFile.h"

#include <cwchar>
#include <utility>

extern "C" { // in the system's library, but in no header of mingw-w64
HRESULT WINAPI RegisterTypeLibForUser(ITypeLib* library, OLECHAR* path, OLECHAR* helpFolder);
HRESULT WINAPI UnRegisterTypeLibForUser(REFGUID id, WORD major, WORD minor, LCID locale, SYSKIND system);
}

namespace varnex3::server {

TypeLibraryFile::TypeLibraryFile(std::wstring path_)
    : path(std::move(path_)), status(LoadTypeLibEx(path.c_str(), REGKIND_NONE, &library))
{
    if (SUCCEEDED(status))
        status = library->GetLibAttr(&attributes);
}

TypeLibraryFile::~TypeLibraryFile()
{
    if (attributes)
        library->ReleaseTLibAttr(attributes);
    if (library)
        library->Release();
}

HRESULT TypeLibraryFile::Register(Scope scope) const
{
    const auto add = scope == Scope::User ? RegisterTypeLibForUser : RegisterTypeLib;
    return add(library, const_cast<OLECHAR*>(path.c_str()), nullptr);
}

HRESULT TypeLibraryFile::Unregister(Scope scope) const
{
    const auto remove = scope == Scope::User ? UnRegisterTypeLibForUser : UnRegisterTypeLib;
    return remove(attributes->guid, attributes->wMajorVerNum, attributes->wMinorVerNum, attributes->lcid,
                  attributes->syskind);
}

std::wstring TypeLibraryFile::OtherKey() const
{
    wchar_t version[16] = L""; // in the registry it is hexadecimal
    std::swprintf(version, std::size(version), L"%x.%x", attributes->wMajorVerNum, attributes->wMinorVerNum);
    const wchar_t* const system = attributes->syskind == SYS_WIN64 ? L"win32" : L"win64";
    return L"TypeLib\\" + ToText(attributes->guid) + L"\\" + version + L"\\0\\" + system;
}

std::wstring ToText(const GUID& id)
{
    wchar_t text[39] = L"";
    StringFromGUID2(id, text, 39);
    return text;
}

} // namespace varnex3::server
