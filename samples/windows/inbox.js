// Lists an inbox folder, a line a message: cscript //nologo inbox.js [FOLDER]
// JScript passes nothing by reference: ParseFiles says that it failed, but not why.
var folder = WScript.Arguments.length > 0 ? WScript.Arguments(0) : "samples\\inbox";
var messages = new ActiveXObject("Varnex3.Xalo_Messages");
var isWhole = messages.ParseFiles(folder);
for (var i = 0; i < messages.Count; i++) {
    var message = messages.MessageItems(i);
    if (message.ParseError)
        WScript.Echo(message.ErrorMessage);
    else
        WScript.Echo([message.MessageNo, message.MessageDescription, message.Registration, message.ClaimNo].join(", "));
}
WScript.Echo(messages.Count + " messages");
if (!isWhole)
    WScript.Echo("Error: the folder could not be read to its end");
