' What a late-bound host may rely on, as VBScript sees it: a line for each fact, and the count of them at the end.
'
' A fact holds when all its checks do and nothing was raised that the fact does not name. Plain ASCII: Chr(233) is e acute.
Option Explicit

Dim passed, failed, fact, checks, faults
passed = 0
failed = 0

Sub Fact_(words)
    If fact <> "" Then
        If Err.Number <> 0 Then faults = faults & vbLf & "    raised " & ErrorText
        If checks = 0 Then faults = faults & vbLf & "    checks nothing"
        If faults = "" Then
            passed = passed + 1
            WScript.Echo "ok      " & fact
        Else
            failed = failed + 1
            WScript.Echo "FAILED  " & fact & faults
        End If
    End If
    Err.Clear
    fact = words
    checks = 0
    faults = ""
End Sub

Function ErrorText
    ErrorText = Err.Number & " [" & Err.Source & "] [" & Err.Description & "]"
End Function

Sub Holds(condition)
    checks = checks + 1
    If Not condition Then faults = faults & vbLf & "    check " & checks & " does not hold"
End Sub

Sub Equal(ByVal got, ByVal wanted)
    checks = checks + 1
    If VarType(got) = VarType(wanted) Then
        If got = wanted Then Exit Sub
    End If
    faults = faults & vbLf & "    check " & checks & ": expected [" & wanted & "] of type " & VarType(wanted) & ", got [" & _
        got & "] of type " & VarType(got)
End Sub

' The error of the statement before, with every word of its source and description.
Sub Raised(number, source, description)
    checks = checks + 1
    If Err.Number <> number Or Err.Source <> source Or Err.Description <> description Then
        faults = faults & vbLf & "    check " & checks & ": expected " & number & " [" & source & "] [" & description & _
            "], got " & ErrorText
    End If
    Err.Clear
End Sub

' An error that the script host words itself.
Sub RaisedNumber(number)
    checks = checks + 1
    If Err.Number <> number Then faults = faults & vbLf & "    check " & checks & ": expected " & number & ", got " & ErrorText
    Err.Clear
End Sub

Function Create(className)
    Set Create = CreateObject("Varnex3." & className)
End Function

Sub Creating
    On Error Resume Next
    Dim o
    Fact_ "An object is created by the program id of its class, and by that with the version"
    Set o = CreateObject("Varnex3.VersionDef")
    o.XaloVersion = "1.6"
    Equal o.XaloVersion, "1.6"
    Set o = CreateObject("Varnex3.VersionDef.3")
    Equal o.XaloVersion, ""
    Fact_ "Letter case does not count in a program id"
    Set o = CreateObject("VARNEX3.versiondef")
    Equal o.XaloVersion, ""
    Fact_ "A module of functions is no class"
    Set o = CreateObject("Varnex3.modFunctions")
    RaisedNumber 429
    Fact_ "A class without members can be created"
    Set o = Create("XaloBase")
    Holds IsObject(o)
    Holds Not (o Is Nothing)
    Fact_ "An object tells its class"
    Equal TypeName(Create("VersionDef")), "_VersionDef"
End Sub

Sub Values
    On Error Resume Next
    Dim c, m, text, i
    Set c = Create("ClaimHeaderDef")
    Fact_ "Members are found in any letter case"
    c.vehicleid = "V-17"
    Equal c.VEHICLEID, "V-17"
    Fact_ "A text comes back with every character"
    text = ""
    For i = 1 To 255
        text = text & Chr(i)
    Next
    c.VehicleID = text
    Equal c.VehicleID, text
    Equal Len(c.VehicleID), CLng(255)
    Fact_ "A text may hold the character 0"
    c.VehicleID = "a" & Chr(0) & "b"
    Equal Len(c.VehicleID), CLng(3)
    Fact_ "A number is stored as its text, with a full stop"
    c.VehicleID = 1.5
    Equal c.VehicleID, "1.5"
    Fact_ "Empty is the empty text, 0 and False"
    c.VehicleID = Empty
    Equal c.VehicleID, ""
    c.ReinstatementNo = 5
    c.ReinstatementNo = Empty
    Equal c.ReinstatementNo, CLng(0)
    Fact_ "Null is no value"
    c.VehicleID = "kept"
    c.VehicleID = Null
    RaisedNumber 13
    Equal c.VehicleID, "kept"
    Fact_ "An array is no value"
    c.VehicleID = Array(1, 2)
    RaisedNumber 13
    Equal c.VehicleID, "kept"
    Fact_ "A 32-bit integer is a Long at both ends"
    c.ReinstatementNo = 2147483647
    Equal c.ReinstatementNo, CLng(2147483647)
    c.ReinstatementNo = -2147483647 - 1
    Equal c.ReinstatementNo, CLng(-2147483647 - 1)
    Fact_ "A text that is a number is taken for one, halves rounded to even"
    c.ReinstatementNo = " 1e2 "
    Equal c.ReinstatementNo, CLng(100)
    c.ReinstatementNo = "2.5"
    Equal c.ReinstatementNo, CLng(2)
    Fact_ "A text that is no number raises 13 and names property and value; what was stored stays"
    c.ReinstatementNo = "12x"
    Raised 13, "ClaimHeaderDef.ReinstatementNo", "'12x' is not a number"
    Equal c.ReinstatementNo, CLng(2)
    Fact_ "A number outside 32 bits raises 6"
    c.ReinstatementNo = 2147483648
    Raised 6, "ClaimHeaderDef.ReinstatementNo", "'2147483648' is outside the range of a 32-bit integer"
    Fact_ "A count is an Integer"
    Equal Create("InsurerDetailDef").Count, CInt(0)
    Fact_ "A Boolean is a Boolean, and takes numbers and texts"
    Set m = Create("MessageDef")
    Equal m.ParseError, False
    m.ParseError = True
    Equal m.ParseError, True
    m.ParseError = 0
    Equal m.ParseError, False
    m.ParseError = "true"
    Equal m.ParseError, True
    m.ParseError = "yes"
    Raised 13, "MessageDef.ParseError", "'yes' is not a Boolean"
    Fact_ "A constant of an enumeration is a Long; one that is not defined is kept"
    m.MessageTypeID = 4
    Equal m.MessageTypeID, CLng(4)
    Equal m.MessageType, "Xalo_Quote"
    m.MessageTypeID = 77
    Equal m.MessageTypeID, CLng(77)
    Fact_ "A property that is read-only cannot be stored"
    Create("VersionDef").DLLVersion = "4.0"
    RaisedNumber 438
End Sub

Sub Dates
    On Error Resume Next
    Dim s
    Set s = Create("SourceDef")
    Fact_ "A date is a Date, to the second"
    s.TimeStamp = #3/15/2004 2:05:09 PM#
    Equal s.TimeStamp, #3/15/2004 2:05:09 PM#
    Fact_ "Of a new object it is the zero date"
    Equal Create("SourceDef").TimeStamp, CDate(0)
    Fact_ "A date made by DateSerial and TimeSerial is taken"
    s.TimeStamp = DateSerial(2004, 3, 15) + TimeSerial(14, 5, 9)
    Equal Year(s.TimeStamp), 2004
    Equal Month(s.TimeStamp), 3
    Equal Day(s.TimeStamp), 15
    Equal Hour(s.TimeStamp), 14
    Equal Minute(s.TimeStamp), 5
    Equal Second(s.TimeStamp), 9
    Fact_ "A number is the date of that serial; below zero the time counts forward from the day"
    s.TimeStamp = 38061.5
    Equal s.TimeStamp, CDate(38061.5)
    s.TimeStamp = -1.25
    Equal CDbl(s.TimeStamp), -1.25
    Fact_ "A text is a date in the order year, month, day, whatever the host's locale"
    s.TimeStamp = "2004-03-05 14:05"
    Equal s.TimeStamp, #3/5/2004 2:05:00 PM#
    Fact_ "Any other text is none"
    s.TimeStamp = "05/03/2004"
    Raised 13, "SourceDef.TimeStamp", "'05/03/2004' is not a date"
    Fact_ "A date is stored in a text as year, month, day"
    s.AppName = #3/15/2004 2:05:09 PM#
    Equal s.AppName, "2004-03-15 14:05:09"
    Fact_ "A date outside the years 100 to 9999 raises 6"
    s.TimeStamp = 2958466
    Raised 6, "SourceDef.TimeStamp", "a date outside the years 100 to 9999"
End Sub

Sub Objects
    On Error Resume Next
    Dim a, b, name, dictionary
    Set a = Create("CustomerDef")
    Set b = Create("CustomerDef")
    Fact_ "A child is one object, whenever it is asked for"
    Holds a.PersonalName Is a.PersonalName
    Holds Not (a.PersonalName Is b.PersonalName)
    Fact_ "Set puts a child in place of another; two owners may share it"
    Set name = Create("PersonalNameDef")
    Set a.PersonalName = name
    Set b.PersonalName = name
    name.Surname = "Hopper"
    Holds a.PersonalName Is name
    Equal b.PersonalName.Surname, "Hopper"
    Fact_ "A child outlives its owner"
    Set a = Nothing
    Set b = Nothing
    Equal name.Surname, "Hopper"
    Fact_ "After Set to Nothing the child is made again, with its defaults"
    Set a = Create("CustomerDef")
    Set a.PersonalName = name
    Set a.PersonalName = Nothing
    Equal a.PersonalName.Surname, ""
    Holds Not (a.PersonalName Is name)
    Fact_ "An object of another class raises 13 and names both; the child stays"
    Set name = a.PersonalName
    Set a.PersonalName = Create("VersionDef")
    Raised 13, "CustomerDef.PersonalName", "an object of class VersionDef is not a PersonalNameDef"
    Holds a.PersonalName Is name
    Fact_ "An object that is not the library's raises 13"
    Set dictionary = CreateObject("Scripting.Dictionary")
    Set a.PersonalName = dictionary
    RaisedNumber 13
    Holds a.PersonalName Is name
    Fact_ "A text for a child raises 13"
    a.PersonalName = "Grace"
    RaisedNumber 13
    Holds a.PersonalName Is name
    Fact_ "An object for a text raises 13"
    a.Fax = name
    Raised 13, "CustomerDef.Fax", "an object is not a text"
    a.Fax = dictionary
    RaisedNumber 13
    Fact_ "A child that is read-only cannot be set"
    Set Create("InsurerDef").InsurerDetail = Create("InsurerDetailDef")
    RaisedNumber 438
    Fact_ "With gives an object's members without its name"
    With a.PersonalName
        .Forname = "Grace"
        .Surname = "Hopper"
        Equal .FullName, "Grace Hopper"
    End With
    Fact_ "An object can be kept in a dictionary and taken out again"
    dictionary.Add "name", name
    Holds dictionary.Item("name") Is name
End Sub

Sub Calls
    On Error Resume Next
    Dim v, d, x, m, result, number, text, newNumber, newText
    Set v = Create("VersionDef")
    Fact_ "A method is called with and without parentheses, as a statement and for its result"
    v.XaloVersion = "1.6"
    Equal v.Serialise, v.Serialise()
    Holds Len(v.Serialise) > 0
    v.ParseXML "<Version><XaloVersion>1</XaloVersion></Version>"
    Equal v.XaloVersion, "1"
    v.ParseXML("<Version><XaloVersion>2</XaloVersion></Version>")
    Equal v.XaloVersion, "2"
    Call v.ParseXML("<Version><XaloVersion>3</XaloVersion></Version>")
    Equal v.XaloVersion, "3"
    Fact_ "The result of ParseXML is Empty"
    result = v.ParseXML("<Version/>")
    Holds IsEmpty(result)
    Fact_ "A member that is not there raises 438"
    v.NoSuch
    RaisedNumber 438
    v.NoSuch = 1
    RaisedNumber 438
    result = v.NoSuch
    RaisedNumber 438
    Fact_ "One argument too few raises 449, one too many 450"
    v.ParseXML
    RaisedNumber 449
    v.ParseXML "<Version/>", 2
    RaisedNumber 450
    result = v.Serialise(1)
    RaisedNumber 450
    result = v.XaloVersion(1)
    RaisedNumber 450
    Set d = Create("InsurerDetailDef")
    Fact_ "An indexed property is read and stored by name, and read by position"
    d.Add "Phone", "1"
    d.Add "Fax", "2"
    Equal d.Values("Phone"), "1"
    d.Values("Phone") = "3"
    Equal d.Values("Phone"), "3"
    Equal d.Values(1), "2"
    Equal d.Fields(1), "Fax"
    number = "Fax"
    d.Values(number) = 42
    Equal d.Values(number), "42"
    Fact_ "An indexed property without its index raises 449"
    result = d.Fields
    RaisedNumber 449
    Set x = Create("Xalo_Messages")
    Fact_ "Variables by reference come back: Empty ones and new ones with the type of the parameter"
    Equal x.ParseFiles("Q:\none", newNumber, newText), False
    Equal newNumber, CLng(30030)
    Equal newText, "Folder 'Q:\none' does not exist."
    number = Empty
    text = Empty
    result = x.ParseFiles("Q:\none", number, text)
    Equal number, CLng(30030)
    Equal text, "Folder 'Q:\none' does not exist."
    Fact_ "Variables by reference come back: Long and String"
    number = CLng(7)
    text = "before"
    result = x.ParseFiles("Q:\none", number, text)
    Equal number, CLng(30030)
    Equal text, "Folder 'Q:\none' does not exist."
    Fact_ "A variable that nothing comes back in stays as it was, its type too"
    number = "7"
    text = "path"
    Set m = Create("MessageDef")
    m.ParseXML "<Xalo_Quote/>", number, text
    Equal number, "7"
    Equal text, "path"
    Fact_ "A variable by reference that does not convert raises 13"
    number = "many"
    result = x.ParseFiles("Q:\none", number)
    Raised 13, "Xalo_Messages.ParseFiles", "'many' is not a number"
    Fact_ "Literals and expressions are taken where variables come back"
    Equal x.ParseFiles("Q:\none", 1, "a" & "b"), False
    Fact_ "Optional arguments may be left out, from the end or between others"
    Equal x.ParseFiles("Q:\none"), False
    number = 0
    Equal x.ParseFiles("Q:\none", number), False
    Equal number, CLng(30030)
    text = ""
    Equal x.ParseFiles("Q:\none", , text), False
    Equal text, "Folder 'Q:\none' does not exist."
    Fact_ "An argument that is not optional cannot be left out between others"
    m.ParseXML "<Xalo_Quote/>", , text
    RaisedNumber 449
End Sub

Sub Lists
    On Error Resume Next
    Dim x, m, i, last, names
    Set x = Create("Xalo_Messages")
    Fact_ "A loop over the positions of a list meets every entry in its order"
    For i = 1 To 3
        Set m = x.Add("file" & i & ".xml")
        m.MessageNo = "M" & i
    Next
    names = ""
    last = x.Count - 1 ' not in the loop's head: under Wine an error there makes a loop without end
    For i = 0 To last
        names = names & x.MessageItems(i).MessageNo & " "
    Next
    Equal names, "M1 M2 M3 "
    Fact_ "An entry is found by its key and by its position: the same object"
    Holds x.MessageItems("file2.xml") Is x.MessageItems(1)
    Fact_ "A position that no entry has gives Nothing"
    Holds x.MessageItems(3) Is Nothing
    Holds x.MessageItems(-1) Is Nothing
    Fact_ "An unknown key raises 424 and leaves an empty entry"
    Set m = x.MessageItems("none.xml")
    Raised 424, "Xalo_Messages.MessageItems", "the entry 'none.xml' is empty"
    Equal x.Count, CInt(4)
    Fact_ "An entry can be changed in the list itself"
    x.MessageItems(0).QuoteNo = "Q77"
    Equal x.MessageItems("file1.xml").QuoteNo, "Q77"
    Fact_ "Remove closes the gap"
    x.Remove "file1.xml"
    x.Remove 2
    Equal x.Count, CInt(2)
    Equal x.MessageItems(0).MessageNo, "M2"
End Sub

Sub Errors
    On Error Resume Next
    Dim d, s, cafe
    Set d = Create("InsurerDetailDef")
    cafe = "caf" & Chr(233)
    Fact_ "An error has the library's number, the operation as its source, and words that name the value"
    d.Add "Phone", "1"
    d.Add "Phone", "2"
    Raised 457, "InsurerDetailDef.Add", "the key 'Phone' is already in the list"
    Fact_ "Words beyond ASCII arrive as they are"
    d.Add cafe, "1"
    d.Add cafe, "2"
    Raised 457, "InsurerDetailDef.Add", "the key '" & cafe & "' is already in the list"
    Fact_ "The source is the operation that raised the error, unchanged on its way up"
    Set s = Create("SourceDef")
    s.ParseXML "<Source><OrgType/><AppVersion/><AppName/><TimeStamp>2004+03-15T14:05:09</TimeStamp></Source>"
    Holds Err.Source = "modFunctions.SplitDateTime"
    RaisedNumber 5
    Fact_ "An element that is missing raises 91"
    s.ParseXML "<Source/>"
    Raised 91, "SourceDef.ParseXML", "the element Source/OrgType is missing"
    Fact_ "A position outside a list raises 9, a name that is no position 13"
    Holds d.Fields(99) = ""
    Raised 9, "InsurerDetailDef.Fields", "Index: '99' is outside the list of 2"
    Holds d.Fields("Phone") = ""
    Raised 13, "InsurerDetailDef.Fields", "Index: 'Phone' is not a number"
    Fact_ "An unknown key raises 32811, a number beyond 16 bits"
    Set s = Create("Xalo_Messages")
    s.Add "a"
    s.Remove "b"
    Raised 32811, "Xalo_Messages.Remove", "the key 'b' is not in the list"
    Fact_ "After an error the object is of use"
    d.Add "Email", "3"
    Equal d.Count, CInt(3)
    Fact_ "An error does not come back with the next call"
    d.Add "Phone", "2"
    Err.Clear
    Equal d.Count, CInt(3)
    Equal Err.Number, CLng(0)
End Sub

Creating
Values
Dates
Objects
Calls
Lists
Errors
Fact_ ""
WScript.Echo passed & " passed, " & failed & " failed"
