#include "CommandLine.h"

#include <CLI/CLI.hpp>
#include <functional>
#include <string>
#include <vector>

#include "DisplayText.h"
#include "IdentifyCommand.h"
#include "ScanCommand.h"
#include "ScanReport.h"
#include "ShowCommand.h"
#include "varnex3/core/Error.h"
#include "varnex3/xml/Files.h"

namespace varnex3::tool {

namespace {

constexpr const char* kJsonHelp = "Write JSON, one object a line";

constexpr const char* kExitStatus = "Exit status: 0 fine, 1 something is wrong with a file, 2 could not run.";

constexpr const char* kScanExamples = R"(Examples:
  varnex3 scan inbox
  varnex3 scan inbox --sort claim
  varnex3 scan inbox --json | jq -r 'select(.error) | .FileName')";

constexpr const char* kIdentifyExamples = R"(Examples:
  varnex3 identify job-4711-2-quote.xml
  varnex3 identify inbox/*.xml
  varnex3 identify --json inbox/*.xml | jq -r .MessageType | sort | uniq -c)";

constexpr const char* kShowExamples = R"(Examples:
  varnex3 show inbox/job-4711-2-quote.xml
  varnex3 show broken.xml
  varnex3 show --json quote.xml | jq .sections.Vehicle)";

std::vector<std::string> SortKeys()
{
    std::vector<std::string> keys;
    for (const ScanColumn& column : ScanColumns())
        keys.emplace_back(column.key);
    return keys;
}

std::string InWords(const std::vector<std::string>& keys)
{
    std::string words;
    for (const std::string& key : keys)
        words += (words.empty() ? "" : ", ") + key;
    return words;
}

// The subcommands with their options, and the one that was chosen.
class CommandLine
{
public:
    explicit CommandLine(const Console& console) : console(console)
    {
        app.require_subcommand(1);
        app.set_version_flag("--version", "varnex3 " VARNEX3_VERSION);
        app.failure_message([](const CLI::App*, const CLI::Error& error) {
            return "varnex3: " + Printable(xml::FromNativePath(error.what())) + "\nTry: varnex3 --help\n";
        });
        app.footer(std::string("Try: varnex3 SUBCOMMAND --help\n\n") + kExitStatus);
        app.get_formatter()->column_width(20);
        app.get_formatter()->label("REQUIRED", "");
        AddScan();
        AddIdentify();
        AddShow();
    }

    Status Run(int argumentCount, const char* const* arguments)
    {
        try {
            app.parse(argumentCount, arguments);
        } catch (const CLI::ParseError& error) {
            const bool isHelpOrVersion = app.exit(error, console.out.Stream(), console.errors.Stream()) == 0;
            return isHelpOrVersion ? Status::Fine : Status::CouldNotRun;
        }
        return chosen();
    }

private:
    CLI::App* AddCommand(const char* name, const char* description, const char* examples)
    {
        CLI::App* const command = app.add_subcommand(name, description);
        command->footer(std::string(examples) + "\n\n" + kExitStatus);
        return command;
    }

    void AddScan()
    {
        CLI::App* const command = AddCommand("scan", "List the messages of an inbox, and what is wrong", kScanExamples);
        command->add_option("FOLDER", scan.folder, "The inbox; its files with the extension xml")
            ->required()
            ->type_name("");
        command
            ->add_option("--sort", scan.sort, "The order of the files; by name unless given:\n" + InWords(SortKeys()))
            ->check(CLI::IsMember(SortKeys()).description(""))
            ->type_name("KEY");
        command->add_flag("--json", scan.isJson, kJsonHelp);
        command->callback([this] { chosen = [this] { return Scan(scan, console); }; });
    }

    void AddIdentify()
    {
        CLI::App* const command =
            AddCommand("identify", "Tell the type of files by their root tags alone", kIdentifyExamples);
        command->add_option("FILE", identify.files, "The files")->required()->type_name("");
        command->add_flag("--json", identify.isJson, kJsonHelp);
        command->callback([this] { chosen = [this] { return Identify(identify, console); }; });
    }

    void AddShow()
    {
        CLI::App* const command = AddCommand("show", "Show what a message says, or where it is broken", kShowExamples);
        command->add_option("FILE", show.file, "The message")->required()->type_name("");
        command->add_flag("--json", show.isJson, kJsonHelp);
        command->callback([this] { chosen = [this] { return Show(show, console); }; });
    }

    const Console& console;
    CLI::App app{"Reads Xalo messages.", "varnex3"};
    ScanOptions scan;
    IdentifyOptions identify;
    ShowOptions show;
    std::function<Status()> chosen;
};

} // namespace

Status Run(int argumentCount, const char* const* arguments, const Console& console)
{
    try {
        return CommandLine(console).Run(argumentCount, arguments);
    } catch (...) {
        const Error error = CurrentError("varnex3");
        console.errors.Line("varnex3: " + Printable(error.Description()) + " (error " + std::to_string(error.Number())
                            + ")");
        return Status::CouldNotRun;
    }
}

} // namespace varnex3::tool
