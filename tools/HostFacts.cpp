#include "HostFacts.h"

#include <cstdlib>
#include <initializer_list>
#include <locale.h>
#include <sys/utsname.h>

#include "DisplayText.h"
#include "varnex3/services/ConnectionSettings.h"

namespace varnex3::tool {

namespace {

// Of the variables that may name the locale of a category the first one that does counts.
std::string LocaleOf(const char* category)
{
    for (const char* variable : {"LC_ALL", category, "LANG"})
        if (const char* const value = std::getenv(variable); value && *value)
            return Printable(ToUtf16(value));
    return "C";
}

std::string LocaleInWords()
{
    std::string characters = LocaleOf("LC_CTYPE");
    const std::string numbers = LocaleOf("LC_NUMERIC");
    const std::string dates = LocaleOf("LC_TIME");
    if (characters == numbers && numbers == dates)
        return characters;
    return characters + ", numbers " + numbers + ", dates " + dates;
}

bool IsLocaleInstalled()
{
    const locale_t locale = newlocale(LC_ALL_MASK, "", nullptr);
    if (!locale)
        return false;
    freelocale(locale);
    return true;
}

std::string SystemInWords()
{
    utsname names{};
    if (uname(&names) != 0)
        return "unknown";
    return std::string(names.sysname) + " " + names.release + " " + names.machine;
}

} // namespace

HostFacts ReadHostFacts()
{
    constexpr int kBits = static_cast<int>(sizeof(void*)) * 8;
    return {SystemInWords(), GetLocalComputerName(), kBits, LocaleInWords(), IsLocaleInstalled()};
}

} // namespace varnex3::tool
