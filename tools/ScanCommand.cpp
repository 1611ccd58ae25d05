#include "ScanCommand.h"

#include <optional>

#include "MessageFile.h"
#include "ProgressBar.h"
#include "ScanReport.h"
#include "varnex3/xml/Files.h"

namespace varnex3::tool {

namespace {

// Reads one file at a time, in name order. The person who waits, if any, sees how far it has come.
template <class Action>
Status ForEachFile(InboxFolder& inbox, Terminal* waiting, Action action)
{
    const std::vector<Text> names = inbox.FileNames();
    std::optional<ProgressBar> progress;
    if (waiting)
        progress.emplace(*waiting, names.size());
    Status status = Status::Fine;
    for (const Text& name : names) {
        const MessageFile file = ReadMessageFile(inbox, name);
        if (!file.IsFine())
            status = Status::Findings;
        action(file);
        if (progress)
            progress->Step();
    }
    return status;
}

// Name order needs no waiting for the last file, and no memory.
Status StreamJson(InboxFolder& inbox, const Console& console)
{
    Terminal* const waiting = console.out.IsTerminal() ? nullptr : &console.errors; // the bar would lie among the lines
    return ForEachFile(inbox, waiting, [&](const MessageFile& file) { console.out.Line(JsonLineOf(file)); });
}

} // namespace

Status Scan(const ScanOptions& options, const Console& console)
{
    InboxFolder inbox(xml::FromNativePath(options.folder));
    if (options.isJson && options.sort == "name")
        return StreamJson(inbox, console);

    ScanReport report(options.isJson ? ScanReport::Form::Json : ScanReport::Form::Table, options.sort);
    const Status status = ForEachFile(inbox, &console.errors, [&](const MessageFile& file) { report.Add(file); });
    report.Sort();
    report.Print(console.out);
    return status;
}

} // namespace varnex3::tool
