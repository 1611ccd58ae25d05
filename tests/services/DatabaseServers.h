// The servers that tests of the database talk to, the settings that lead to them, and what they were sent.
#pragma once

#include <chrono>
#include <cstdlib>
#include <fstream>
#include <initializer_list>
#include <string>
#include <thread>
#include <utility>
#include <vector>

#include <fcntl.h>
#include <nlohmann/json.hpp>
#include <sys/wait.h>
#include <unistd.h>

#include "tests/services/Folder.h"
#include "varnex3/core/Text.h"
#include "varnex3/services/modDBAccess.h"

namespace varnex3::tests {

inline void WriteFile(const std::string& path, const std::string& bytes) { std::ofstream(path) << bytes; }

inline std::string ReadFile(const std::string& path)
{
    std::ifstream file(path);
    return {std::istreambuf_iterator<char>(file), {}};
}

// The drivers that this process knows: FreeTDS as SQL Server, and as SQL Native Client a library that is not there. The
// driver manager reads where they are registered once in a process.
class RegisteredDrivers
{
public:
    static void Use() { static const RegisteredDrivers drivers; }

    RegisteredDrivers(const RegisteredDrivers&) = delete;
    RegisteredDrivers& operator=(const RegisteredDrivers&) = delete;

private:
    RegisteredDrivers()
    {
        REQUIRE(mkdtemp(path.data()) != nullptr);
        WriteFile(path + "/odbcinst.ini", "[SQL Server]\nDriver=libtdsodbc.so\n"
                                          "[SQL Native Client]\nDriver=libno-such-driver.so\n");
        setenv("ODBCSYSINI", path.c_str(), 0); // unless the caller has drivers of its own
    }
    ~RegisteredDrivers() { std::filesystem::remove_all(path); }

    std::string path = "/tmp/varnex3-drivers-XXXXXX";
};

// Runs a test case that is skipped otherwise, "[child] ...", in a process with drivers of its own. Whether it passed.
inline bool PassesWithDrivers(const std::string& name, const std::string& drivers)
{
    std::string folder = "/tmp/varnex3-drivers-XXXXXX";
    REQUIRE(mkdtemp(folder.data()) != nullptr);
    WriteFile(folder + "/odbcinst.ini", drivers);
    const std::string program = std::filesystem::read_symlink("/proc/self/exe").string();
    // NOLINTNEXTLINE(cert-env33-c): the words are the test's own
    FILE* const pipe = popen(("ODBCSYSINI=" + folder + " '" + program + "' -ns -tc='" + name + "' 2>&1").c_str(), "r");
    REQUIRE(pipe != nullptr);
    std::string output;
    for (int c = fgetc(pipe); c != EOF; c = fgetc(pipe))
        output += static_cast<char>(c);
    pclose(pipe);
    std::filesystem::remove_all(folder);
    INFO(output);
    return output.find("1 passed | 0 failed") != std::string::npos;
}

// Settings of a test's own that lead to a database.
class DatabaseFolder
{
public:
    DatabaseFolder()
    {
        RegisteredDrivers::Use();
        Use({});
    }
    ~DatabaseFolder()
    {
        std::int32_t lID = 0;
        Use({{"ServerName", "127.0.0.1,1"}}); // this thread's connection ends with the test
        DBExecSP(u"none", u"", lID, true, false);
    }
    DatabaseFolder(const DatabaseFolder&) = delete;
    DatabaseFolder& operator=(const DatabaseFolder&) = delete;

    const std::string& Path() const { return settings.Path(); }

    // The settings under frmsplash, in place of those before.
    void Use(const std::vector<std::pair<std::string, std::string>>& values) const
    {
        std::string text =
            "Windows Registry Editor Version 5.00\n\n[HKEY_LOCAL_MACHINE\\SOFTWARE\\corvo32\\frmsplash]\n";
        for (const auto& [name, value] : values) {
            std::string escaped;
            for (const char c : value)
                escaped += c == '\\' || c == '"' ? std::string{'\\', c} : std::string(1, c);
            text += "\"" + name + "\"=\"" + escaped + "\"\n";
        }
        settings.Write("machine.reg", text);
    }
    void UsePort(int port, const std::string& password = "x") const
    {
        Use({{"ServerName", "127.0.0.1," + std::to_string(port)}, {"SAPwd", password}});
    }

private:
    SettingsFolder settings;
};

// A program of tests/database, until the end of the test.
class ServerProgram
{
public:
    ServerProgram(const std::string& folder, const std::string& name, std::vector<std::string> words,
                  std::chrono::seconds longestStart = std::chrono::seconds(20))
        : ready(folder + "/" + name + ".ready"), log(folder + "/" + name + ".log")
    {
        const std::string program = VARNEX3_SOURCE_DIR "/tests/database/" + name;
        words.insert(words.begin(), {"python3", program, "--port-file", ready});
        Start(words);
        const auto end = std::chrono::steady_clock::now() + longestStart;
        while (access(ready.c_str(), R_OK) != 0 && std::chrono::steady_clock::now() < end && IsRunning())
            std::this_thread::sleep_for(std::chrono::milliseconds(5));
        facts = nlohmann::json::parse(ReadFile(ready), nullptr, false);
        REQUIRE_FALSE(facts.is_discarded());
    }
    ~ServerProgram() { Stop(); }
    ServerProgram(const ServerProgram&) = delete;
    ServerProgram& operator=(const ServerProgram&) = delete;

    void Stop()
    {
        if (process <= 0)
            return;
        kill(process, SIGTERM);
        waitpid(process, nullptr, 0);
        process = 0;
    }

    nlohmann::json facts; // what it tells once it is ready

protected:
    std::string ready;
    std::string log;

private:
    bool IsRunning() { return waitpid(process, nullptr, WNOHANG) == 0; }

    void Start(const std::vector<std::string>& words)
    {
        std::vector<char*> arguments;
        for (const std::string& word : words)
            arguments.push_back(const_cast<char*>(word.c_str()));
        arguments.push_back(nullptr);
        process = fork();
        if (process != 0)
            return;
        dup2(open("/dev/null", O_WRONLY), STDOUT_FILENO);
        execvp(arguments[0], arguments.data());
        _exit(127);
    }

    pid_t process = 0;
};

class TdsServer : public ServerProgram
{
public:
    explicit TdsServer(const DatabaseFolder& folder, std::vector<std::string> words = {})
        : ServerProgram(folder.Path(), "tds_server.py", Complete(folder, std::move(words)))
    {}

    int Port() const { return facts.get<int>(); }

    // What it was sent, an object each: see tds_server.py.
    std::vector<nlohmann::json> Logged(const std::string& event) const
    {
        std::vector<nlohmann::json> found;
        std::ifstream file(log);
        for (std::string line; std::getline(file, line);)
            if (auto entry = nlohmann::json::parse(line); entry.at("event") == event)
                found.push_back(std::move(entry));
        return found;
    }
    std::size_t Count(const std::string& event) const { return Logged(event).size(); }

    // What the inputs of the last call were, as `int(4)=12 nvarchar(2)="AB" nvarchar(1)=null`.
    std::string LastInputs() const
    {
        std::string inputs;
        const nlohmann::json call = Logged("rpc").back();
        for (const auto& parameter : call.at("parameters"))
            if (!parameter.at("output").get<bool>())
                inputs += (inputs.empty() ? "" : " ") + parameter.at("type").get<std::string>() + "("
                          + parameter.at("size").dump() + ")=" + parameter.at("value").dump();
        return inputs;
    }

private:
    static std::vector<std::string> Complete(const DatabaseFolder& folder, std::vector<std::string> words)
    {
        words.insert(words.end(), {"--log", folder.Path() + "/tds_server.py.log", "--end-with-parent"});
        return words;
    }
};

// Drivers and settings that lead to a running server.
struct TdsDatabase
{
    explicit TdsDatabase(const std::vector<std::string>& words = {}) : server(folder, words)
    {
        folder.UsePort(server.Port());
    }

    DatabaseFolder folder;
    TdsServer server;
};

// Runs a procedure; -1 is the lID before the call.
struct Called
{
    explicit Called(TextView procedure, TextView texts = {}, bool reconnects = false, bool isUpdatable = false)
        : rowSet(DBExecSP(procedure, texts, lID, reconnects, isUpdatable))
    {}

    std::int32_t lID = -1;
    std::shared_ptr<RowSet> rowSet;
};

} // namespace varnex3::tests
