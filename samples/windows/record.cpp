// Writes a record as XML, reads it back, and meets an error.
#include "early.h"

static std::wstring Serialised(const Object<_SourceDef>& source)
{
    Text xml;
    Check(source->Serialise(xml.Out()));
    return {xml, SysStringLen(xml)};
}

static void Parse(const Object<_SourceDef>& source, const std::wstring& xml)
{
    VARIANT nothing;
    Check(source->ParseXML(Text(xml), &nothing));
}

static DATE MomentOf(SYSTEMTIME moment)
{
    DATE date = 0;
    SystemTimeToVariantTime(&moment, &date);
    return date;
}

static void WriteRecord()
{
    const Object<_SourceDef> source(__uuidof(SourceDef));
    Check(source->put_OrgType(Text(L"REP")));
    Check(source->put_AppName(Text(L"Workshop")));
    Check(source->put_AppVersion(Text(L"2.1")));
    Check(source->put_TimeStamp(MomentOf({2004, 3, 0, 15, 14, 5, 9, 0})));
    std::wstring xml = Serialised(source);
    std::cout << Text(xml);

    const Object<_SourceDef> copy(__uuidof(SourceDef));
    Parse(copy, xml);
    Text type, name, version;
    Check(copy->get_OrgType(type.Out()));
    Check(copy->get_AppName(name.Out()));
    Check(copy->get_AppVersion(version.Out()));
    std::cout << "Read back: " << type << ' ' << name << ' ' << version << '\n';

    const std::wstring time = L"2004-03-15T14:05:09";
    xml.replace(xml.find(time), time.size(), L"soon");
    Parse(copy, xml);
}

int main()
try {
    const Apartment apartment;
    WriteRecord();
} catch (const Failure& failure) {
    Print(failure);
}
