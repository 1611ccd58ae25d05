// Writes a record as XML, reads it back, and meets an error.
// Late binding: csc /platform:x86 record.cs. With a reference to the type library the types are known while you type.
using System;

static class RecordSample
{
    [STAThread]
    static void Main()
    {
        dynamic source = Create("SourceDef");
        source.OrgType = "REP";
        source.AppName = "Workshop";
        source.AppVersion = "2.1";
        source.TimeStamp = new DateTime(2004, 3, 15, 14, 5, 9);
        string xml = source.Serialise();
        Console.Write(xml);

        dynamic copy = Create("SourceDef");
        copy.ParseXML(xml);
        Console.WriteLine("Read back: {0} {1} {2}", copy.OrgType, copy.AppName, copy.AppVersion);

        try
        {
            copy.ParseXML(xml.Replace("2004-03-15T14:05:09", "soon"));
        }
        catch (Exception error) // some numbers become exceptions of .NET's own (6 OverflowException): HResult tells
        {
            Console.WriteLine("Error {0} from {1}: {2}", error.HResult & 0xFFFF, error.Source, error.Message);
        }
    }

    static dynamic Create(string name)
    {
        return Activator.CreateInstance(Type.GetTypeFromProgID("Varnex3." + name, true));
    }
}
