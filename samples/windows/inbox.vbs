' Lists an inbox folder, a line a message: cscript //nologo inbox.vbs [FOLDER]
Option Explicit
Dim folder, messages, message, i, number, words, isWhole

folder = "samples\inbox"
If WScript.Arguments.Count > 0 Then folder = WScript.Arguments(0)

Set messages = CreateObject("Varnex3.Xalo_Messages")
number = 0
words = ""
isWhole = messages.ParseFiles(folder, number, words)

For i = 0 To messages.Count - 1
    Set message = messages.MessageItems(i)
    If message.ParseError Then
        WScript.Echo message.ErrorMessage
    Else
        WScript.Echo message.MessageNo & ", " & message.MessageDescription & ", " & message.Registration & ", " & message.ClaimNo
    End If
Next
WScript.Echo messages.Count & " messages"
If Not isWhole Then WScript.Echo "Error " & number & ": " & words
