// Writes a record as XML, reads it back, and meets an error.
#include <iostream>
#include <varnex3/varnex3.h>

using namespace varnex3;

int main()
{
    const auto source = New<SourceDef>();
    source->OrgType(u"REP");
    source->AppName(u"Workshop");
    source->AppVersion(u"2.1");
    source->TimeStamp(*DateFrom({2004, 3, 15, 14, 5, 9}));
    Text xml = source->Serialise();
    std::cout << ToUtf8(xml);

    const auto copy = New<SourceDef>();
    copy->ParseXML(xml);
    std::cout << "Read back: " << ToUtf8(copy->OrgType()) << ' ' << ToUtf8(copy->AppName()) << ' '
              << ToUtf8(copy->AppVersion()) << '\n';

    const TextView time = u"2004-03-15T14:05:09";
    xml.replace(xml.find(time), time.size(), u"soon");
    try {
        copy->ParseXML(xml);
    } catch (const Error& error) {
        std::cout << "Error " << error.Number() << " from " << ToUtf8(error.Source()) << ": "
                  << ToUtf8(error.Description()) << '\n';
    }
}
