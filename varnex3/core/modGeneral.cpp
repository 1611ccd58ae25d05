#include "varnex3/core/modGeneral.h"

#include <limits>

namespace varnex3 {

VARNEX_MODULE_DEFINE(modGeneral);

Text Indent(std::int32_t level)
{
    if (level <= 0)
        return {};
    if (level > std::numeric_limits<std::int16_t>::max())
        Raise(ErrorNumber::Overflow, "modGeneral.Indent",
              u"level: " + Quoted(ToText(Variant(level))) + u" is outside the range of a 16-bit integer");
    return Text(static_cast<std::size_t>(level), u'\t');
}

Text FormatElement(TextView name, TextView value, std::int16_t level, bool tagOnly, bool include, bool selfClose)
{
    if (!include)
        return {};
    const Text start = Indent(level) + u"<" + Text(name);
    if (tagOnly) // an end tag comes as a name with a slash in front
        return start + u">\r\n";
    if (selfClose)
        return start + u"/>\r\n";
    return start + u">" + Text(value) + u"</" + Text(name) + u">\r\n";
}

Variant GetNodeXML(const xml::Node& node, TextView path) { return node.SelectSingle(ToUtf8(path)).Xml(); }

Variant GetNodeValue(const xml::Node& node, TextView path)
{
    const xml::Node found = node.SelectSingle(ToUtf8(path));
    return found ? Variant(found.Text()) : Empty;
}

} // namespace varnex3
