"""Writes a record as XML, reads it back, and meets an error."""

from datetime import datetime

import varnex3

source = varnex3.SourceDef()
source.OrgType = "REP"
source.AppName = "Workshop"
source.AppVersion = "2.1"
source.TimeStamp = datetime(2004, 3, 15, 14, 5, 9)
xml = source.Serialise()
print(xml, end="")

copy = varnex3.SourceDef()
copy.ParseXML(xml)
print("Read back:", copy.OrgType, copy.AppName, copy.AppVersion)

try:
    copy.ParseXML(xml.replace("2004-03-15T14:05:09", "soon"))
except varnex3.Error as error:
    print(f"Error {error.number} from {error.source}: {error.description}")
