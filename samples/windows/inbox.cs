// Lists an inbox folder, a line a message: inbox.exe [FOLDER]
// Late binding: csc /platform:x86 inbox.cs. With a reference to the type library the types are known while you type.
using System;

static class Inbox
{
    [STAThread]
    static int Main(string[] arguments)
    {
        string folder = arguments.Length > 0 ? arguments[0] : @"samples\inbox";
        dynamic messages = Activator.CreateInstance(Type.GetTypeFromProgID("Varnex3.Xalo_Messages", true));
        int number = 0;
        string words = "";
        bool isWhole = messages.ParseFiles(folder, ref number, ref words);
        for (int i = 0; i < messages.Count; i++)
            Console.WriteLine(Line(messages.MessageItems(i)));
        Console.WriteLine("{0} messages", messages.Count);
        if (!isWhole)
            Console.WriteLine("Error {0}: {1}", number, words);
        return isWhole ? 0 : 1;
    }

    static string Line(dynamic message)
    {
        if (message.ParseError)
            return message.ErrorMessage;
        return message.MessageNo + ", " + message.MessageDescription + ", " + message.Registration + ", " + message.ClaimNo;
    }
}
