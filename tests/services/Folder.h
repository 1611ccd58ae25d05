// A folder of a test's own, in which the settings are for as long as it lives.
#pragma once

#include <doctest/doctest.h>

#include <cstdlib>
#include <filesystem>
#include <string>

#include <sys/stat.h>

#include "varnex3/core/Text.h"
#include "varnex3/xml/Files.h"

namespace varnex3::tests {

class SettingsFolder
{
public:
    SettingsFolder()
    {
        REQUIRE(mkdtemp(path.data()) != nullptr);
        REQUIRE(chmod(path.c_str(), 0755) == 0); // others may read, as in /etc
        setenv("VARNEX3_SETTINGS_DIR", path.c_str(), 1);
    }
    ~SettingsFolder()
    {
        unsetenv("VARNEX3_SETTINGS_DIR");
        std::filesystem::remove_all(path);
    }
    SettingsFolder(const SettingsFolder&) = delete;
    SettingsFolder& operator=(const SettingsFolder&) = delete;

    const std::string& Path() const { return path; }

    void Write(const std::string& name, const std::string& bytes) const
    {
        xml::WriteFileAtomically(ToUtf16(path + "/" + name), bytes);
    }
    std::string Read(const std::string& name) const { return xml::ReadFile(ToUtf16(path + "/" + name)); }
    bool Has(const std::string& name) const { return std::filesystem::exists(path + "/" + name); }

private:
    std::string path = "/tmp/varnex3-settings-XXXXXX";
};

} // namespace varnex3::tests
