"""Writes a record as XML, reads it back, and meets an error, through the component. Needs the package pywin32."""

from datetime import datetime

import pythoncom
import win32com.client

source = win32com.client.Dispatch("Varnex3.SourceDef")
source.OrgType = "REP"
source.AppName = "Workshop"
source.AppVersion = "2.1"
source.TimeStamp = datetime(2004, 3, 15, 14, 5, 9)
xml = source.Serialise()
print(xml, end="")

copy = win32com.client.Dispatch("Varnex3.SourceDef")
copy.ParseXML(xml)
print("Read back:", copy.OrgType, copy.AppName, copy.AppVersion)

try:
    copy.ParseXML(xml.replace("2004-03-15T14:05:09", "soon"))
except pythoncom.com_error as error:
    _, name, description, _, _, number = error.excepinfo
    print(f"Error {number & 0xFFFF} from {name}: {description}")
