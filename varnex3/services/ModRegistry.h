// The settings of applications: machine-wide in the registry, or else in the user's own store.
//
// No function raises: what fails ends in the empty text or False, or is ignored. The registry is the system's unless
// another one is given.
#pragma once

#include "varnex3/core/Text.h"
#include "varnex3/services/Registry.h"

namespace varnex3 {

// The setting that is kept machine-wide under SOFTWARE\sApp\sSection as value sKey; without one there (or with an
// empty one), the user's, and without that the default. Unless bNoMigrate, what came from the user or the default and
// is not empty is written to the machine-wide place. GetAppSetting(u"corvo32", u"frmsplash", u"DatabaseName",
// u"CrvSql", true) is u"CrvSql" on a machine without settings.
Text GetAppSetting(TextView sApp, TextView sSection, TextView sKey, const Text& sDefault, const bool& bNoMigrate,
                   Registry& registry = SystemRegistry());

// The key under HKEY_CURRENT_USER that holds the user's own settings of an application's section:
// Software\VB and VBA Program Settings\sApp\sSection, where SaveSetting and GetSetting of the classic hosts keep them.
Text PerUserKey(TextView sApp, TextView sSection);

// A value as text: a text of up to 1024 bytes, with the zero byte that ends it, or a 32-bit number in decimal. The
// number is read from the hexadecimal digits of its bytes, each without leading zeros: 258, whose bytes are 2, 1, 0, 0,
// is u"18". Anything else is u"".
Text QueryRegValue(RegistryRoot hRoot, TextView sKeyPath, TextView sValueName, Registry& registry = SystemRegistry());

// Writes a value of a key that is there. A new value becomes a text; one that is there keeps its type: a 32-bit number
// takes the number that the text begins with, rounded, halves to even; one that is neither text nor number is written
// back as the 1024 bytes of the buffer it was read into. False when that fails, and when the old value is longer than
// 1024 bytes.
bool SetRegValue(RegistryRoot hRoot, TextView sKeyPath, TextView sValueName, TextView sValue,
                 Registry& registry = SystemRegistry());

void CreateRegKey(RegistryRoot hRoot, TextView sKeyPath, Registry& registry = SystemRegistry());

void DeleteRegKey(RegistryRoot hRoot, TextView sKeyPath, Registry& registry = SystemRegistry());

} // namespace varnex3
