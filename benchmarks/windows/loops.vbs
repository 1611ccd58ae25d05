' What the component costs a script, against Scripting.Dictionary: cscript //nologo loops.vbs INBOX
'
' Prints a line for each figure: what is done, by whom, its nanoseconds, those of the loop among them.
Option Explicit
Const kGets = 1000000, kObjects = 10000, kScans = 100
Dim inbox, claim, dictionary, x, i, start

inbox = WScript.Arguments(0)
Set claim = CreateObject("Varnex3.ClaimHeaderDef")
Set dictionary = CreateObject("Scripting.Dictionary")
claim.ReinstatementNo = 7
claim.VehicleID = "twenty characters ok"
dictionary.Add "VehicleID", "twenty characters ok"

Sub Tell(what, whom, count, seconds)
    WScript.Echo what & vbTab & whom & vbTab & CLng(seconds / count * 1000000000)
End Sub

start = Timer
For i = 1 To kGets
    x = claim.ReinstatementNo
Next
Tell "get a number", "VBScript", kGets, Timer - start

start = Timer
For i = 1 To kGets
    x = dictionary.Count
Next
Tell "get a number", "Dictionary, VBScript", kGets, Timer - start

start = Timer
For i = 1 To kGets
    x = claim.VehicleID
Next
Tell "get a text", "VBScript", kGets, Timer - start

start = Timer
For i = 1 To kGets
    x = dictionary.Item("VehicleID")
Next
Tell "get a text", "Dictionary, VBScript", kGets, Timer - start

start = Timer
For i = 1 To kObjects
    Set x = CreateObject("Varnex3.ClaimHeaderDef")
Next
Tell "make an object", "VBScript", kObjects, Timer - start

start = Timer
For i = 1 To kObjects
    Set x = CreateObject("Scripting.Dictionary")
Next
Tell "make an object", "Dictionary, VBScript", kObjects, Timer - start

start = Timer
For i = 1 To kScans
    Set x = CreateObject("Varnex3.Xalo_Messages")
    If Not x.ParseFiles(inbox) Then WScript.Quit 1
Next
Tell "scan the sample inbox", "VBScript", kScans, Timer - start
