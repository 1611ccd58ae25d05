#include "CommandLine.h"

#include <CLI/CLI.hpp>
#include <functional>
#include <string>
#include <vector>

#include "ConvertCommand.h"
#include "DisplayText.h"
#include "DoctorCommand.h"
#include "IdentifyCommand.h"
#include "NewCommand.h"
#include "ScanCommand.h"
#include "ScanReport.h"
#include "SettingsCommand.h"
#include "ShowCommand.h"
#include "varnex3/core/Error.h"
#include "varnex3/xml/Files.h"

namespace varnex3::tool {

namespace {

constexpr const char* kJsonHelp = "Write JSON, one object a line";

constexpr const char* kExitStatus = "Exit status: 0 fine, 1 something is wrong, 2 could not run.";

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
  varnex3 show inbox/job-4822-6-payment-declined.xml
  varnex3 show broken.xml
  varnex3 show --json quote.xml | jq .sections.Vehicle)";

constexpr const char* kConvertExamples = R"(Examples:
  varnex3 convert quote.xml -o quote.json
  varnex3 convert quote.json -o quote.xml
  varnex3 convert quote.xml | jq .Xalo_Quote.TotalsField)";

constexpr const char* kNewExamples = R"(Examples:
  varnex3 new Quote
  varnex3 new TaxInvoice -o invoice.xml
  varnex3 new RequestForQuote --to json)";

constexpr const char* kSettingsExamples = R"(Examples:
  varnex3 settings list corvo32
  varnex3 settings get corvo32 frmsplash ServerName
  varnex3 settings set corvo32 frmsplash ServerName WORKSHOP1 --machine
  varnex3 settings set corvo32 frmsplash SAPwd < password.txt)";

constexpr const char* kDoctorExamples = R"(Examples:
  varnex3 doctor
  varnex3 doctor > page-for-support.txt
  varnex3 doctor --json | jq .database.server)";

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
        app.failure_message([this](const CLI::App*, const CLI::Error& error) { return FailureMessage(error); });
        app.footer(std::string("Try: varnex3 SUBCOMMAND --help\n\n") + kExitStatus);
        app.get_formatter()->column_width(20);
        app.get_formatter()->label("REQUIRED", "");
        AddScan();
        AddIdentify();
        AddShow();
        AddConvert();
        AddNew();
        AddSettings();
        AddDoctor();
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
    // What the parser says names the argument it stumbled over, and among those of settings may be a password.
    std::string FailureMessage(const CLI::Error& error) const
    {
        const bool mayNameArguments = !app.got_subcommand("settings");
        const std::string reason = mayNameArguments ? Printable(xml::FromNativePath(error.what()))
                                                    : "the arguments of settings are too few, too many or unknown";
        return "varnex3: " + reason + "\nTry: varnex3 " + (mayNameArguments ? "" : "settings ") + "--help\n";
    }

    CLI::App* AddCommand(const char* name, const char* description, const char* examples, CLI::App* parent = nullptr)
    {
        CLI::App* const command = (parent ? parent : &app)->add_subcommand(name, description);
        command->footer(std::string(examples) + "\n\n" + kExitStatus);
        return command;
    }

    template <class Options, class Action>
    void SetAction(CLI::App* command, Options& options, Action action)
    {
        command->callback(
            [this, &options, action] { chosen = [this, &options, action] { return action(options, console); }; });
    }

    // What every command has that tells something: the option for JSON, and an action.
    template <class Options, class Action>
    void Finish(CLI::App* command, Options& options, Action action)
    {
        command->add_flag("--json", options.isJson, kJsonHelp);
        SetAction(command, options, action);
    }

    // What every command has that writes a message: in which form, where to, and an action.
    template <class Options, class Action>
    void FinishMessage(CLI::App* command, Options& options, const char* formHelp, Action action)
    {
        command->add_option("--to", options.to, formHelp)
            ->check(CLI::IsMember({"json", "xml"}).description(""))
            ->type_name("FORM");
        command->add_option("-o", options.output, "The file to write; the standard output without it")
            ->type_name("FILE");
        SetAction(command, options, action);
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
        Finish(command, scan, Scan);
    }

    void AddIdentify()
    {
        CLI::App* const command =
            AddCommand("identify", "Tell the type of files by their root tags alone", kIdentifyExamples);
        command->add_option("FILE", identify.files, "The files")->required()->type_name("");
        Finish(command, identify, Identify);
    }

    void AddShow()
    {
        CLI::App* const command = AddCommand("show", "Show what a message says, or where it is broken", kShowExamples);
        command->add_option("FILE", show.file, "The message")->required()->type_name("");
        Finish(command, show, Show);
    }

    void AddConvert()
    {
        CLI::App* const command = AddCommand("convert", "Convert a message to JSON, or back to XML", kConvertExamples);
        command->add_option("FILE", convert.file, "The message, as XML or as JSON")->required()->type_name("");
        FinishMessage(command, convert, "json or xml; without it, what the file is not", Convert);
    }

    void AddNew()
    {
        CLI::App* const command = AddCommand("new", "Write an example of a message", kNewExamples);
        command->add_option("TYPE", newMessage.type, "The type, such as Quote")->required()->type_name("");
        FinishMessage(command, newMessage, "json or xml; xml without it", NewMessage);
    }

    void AddSettings()
    {
        CLI::App* const group =
            AddCommand("settings", "Read and write the settings of applications", kSettingsExamples);
        group->require_subcommand(1);
        AddSettingsGet(AddCommand("get", "Print the value that is in force", kSettingsExamples, group));
        AddSettingsSet(AddCommand("set", "Write a value", kSettingsExamples, group));
        AddSettingsList(AddCommand("list", "List the values, the user's and the machine's", kSettingsExamples, group));
    }

    void AddSettingName(CLI::App* command)
    {
        command->add_option("APP", settings.application, "The application, such as corvo32")->required()->type_name("");
        command->add_option("SECTION", settings.section, "The section, such as frmsplash")->required()->type_name("");
        command->add_option("KEY", settings.key, "The key, such as ServerName")->required()->type_name("");
    }

    void AddSettingsGet(CLI::App* command)
    {
        AddSettingName(command);
        Finish(command, settings, GetSetting);
    }

    void AddSettingsSet(CLI::App* command)
    {
        AddSettingName(command);
        command->add_option("VALUE", settings.value, "The value; without it, a line of the\nstandard input")
            ->type_name("");
        CLI::Option* const user =
            command->add_flag("--user", settings.isForUser, "Write it for this user; this is the default");
        command->add_flag("--machine", settings.isMachineWide, "Write it for every user")->excludes(user);
        Finish(command, settings, SetSetting);
    }

    void AddSettingsList(CLI::App* command)
    {
        command->add_option("APP", settings.application, "The application; all without it")->type_name("");
        Finish(command, settings, ListSettings);
    }

    void AddDoctor()
    {
        Finish(AddCommand("doctor", "Tell whether the database answers, and why not", kDoctorExamples), doctor, Doctor);
    }

    const Console& console;
    CLI::App app{"Reads Xalo messages, and sees to settings and database.", "varnex3"};
    ScanOptions scan;
    IdentifyOptions identify;
    ShowOptions show;
    ConvertOptions convert;
    NewOptions newMessage;
    SettingsOptions settings;
    DoctorOptions doctor;
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
