#include "NewCommand.h"

#include "Example.h"
#include "MessageOutput.h"
#include "varnex3/core/Error.h"

namespace varnex3::tool {

namespace {

Text NamesOfTypes()
{
    Text names;
    for (const ClassInfo* const info : MessageClasses())
        names += (names.empty() ? u"" : u", ") + ToText(ShortNameOf(*info));
    return names;
}

} // namespace

Status NewMessage(const NewOptions& options, const Console& console)
{
    const ClassInfo* const info = FindMessageClassLike(options.type);
    if (!info)
        Raise(ErrorNumber::InvalidArgument, "new",
              u"there is no message type " + Quoted(ToUtf16(options.type)) + u"; there are " + NamesOfTypes());
    const MessageFormat format = MessageFormatNamed(options.to);
    return WriteMessage(BytesOf(*ExampleOf(*info), format), format, options.output, console);
}

} // namespace varnex3::tool
