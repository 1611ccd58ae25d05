Attribute VB_Name = "Varnex3Samples"
' For VB6 and VBA. Early binding: set a reference to "Varnex3" (Project > References, in VBA Tools > References).
' Without one, declare As Object and create by CreateObject("Varnex3.SourceDef"): the rest stays as it is.
Option Explicit

' Lists an inbox folder, a line a message.
Public Sub ListInbox(ByVal sFolder As String)
    Dim objMessages As Varnex3.Xalo_Messages
    Dim objMessage As Varnex3.MessageDef
    Dim lNumber As Long
    Dim sWords As String
    Dim bWhole As Boolean
    Dim i As Integer

    Set objMessages = New Varnex3.Xalo_Messages
    bWhole = objMessages.ParseFiles(sFolder, lNumber, sWords)
    For i = 0 To objMessages.Count - 1
        Set objMessage = objMessages.MessageItems(i)
        If objMessage.ParseError Then
            Debug.Print objMessage.ErrorMessage
        Else
            Debug.Print objMessage.MessageNo & ", " & objMessage.MessageDescription & ", " & _
                        objMessage.Registration & ", " & objMessage.ClaimNo
        End If
    Next i
    Debug.Print objMessages.Count & " messages"
    If Not bWhole Then Debug.Print "Error " & lNumber & ": " & sWords
End Sub

' Writes a record as XML, reads it back, and meets an error.
Public Sub WriteRecord()
    Dim objSource As Varnex3.SourceDef
    Dim objCopy As Varnex3.SourceDef
    Dim sXML As String

    Set objSource = New Varnex3.SourceDef
    objSource.OrgType = "REP"
    objSource.AppName = "Workshop"
    objSource.AppVersion = "2.1"
    objSource.TimeStamp = DateSerial(2004, 3, 15) + TimeSerial(14, 5, 9)
    sXML = objSource.Serialise
    Debug.Print sXML

    Set objCopy = New Varnex3.SourceDef
    objCopy.ParseXML sXML
    Debug.Print "Read back: " & objCopy.OrgType & " " & objCopy.AppName & " " & objCopy.AppVersion

    On Error GoTo Failed
    objCopy.ParseXML Replace(sXML, "2004-03-15T14:05:09", "soon")
    Exit Sub
Failed:
    Debug.Print "Error " & Err.Number & " from " & Err.Source & ": " & Err.Description
End Sub
