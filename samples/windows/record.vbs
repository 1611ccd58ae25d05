' Writes a record as XML, reads it back, and meets an error: cscript //nologo record.vbs
Option Explicit
Dim source, copy, xml

Set source = CreateObject("Varnex3.SourceDef")
source.OrgType = "REP"
source.AppName = "Workshop"
source.AppVersion = "2.1"
source.TimeStamp = DateSerial(2004, 3, 15) + TimeSerial(14, 5, 9)
xml = source.Serialise()
WScript.Echo xml

Set copy = CreateObject("Varnex3.SourceDef")
copy.ParseXML xml
WScript.Echo "Read back: " & copy.OrgType & " " & copy.AppName & " " & copy.AppVersion

On Error Resume Next
copy.ParseXML Replace(xml, "2004-03-15T14:05:09", "soon")
If Err.Number <> 0 Then WScript.Echo "Error " & Err.Number & " from " & Err.Source & ": " & Err.Description
