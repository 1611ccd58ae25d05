// Writes a record as XML, reads it back, and meets an error: cscript //nologo record.js
var source = new ActiveXObject("Varnex3.SourceDef");
source.OrgType = "REP";
source.AppName = "Workshop";
source.AppVersion = "2.1";
source.TimeStamp = "2004-03-15 14:05:09"; // or, of a Date: date.getVarDate()
var xml = source.Serialise();
WScript.Echo(xml);

var copy = new ActiveXObject("Varnex3.SourceDef");
copy.ParseXML(xml);
WScript.Echo("Read back: " + copy.OrgType + " " + copy.AppName + " " + copy.AppVersion);

try {
    copy.ParseXML(xml.replace("2004-03-15T14:05:09", "soon"));
} catch (error) { // JScript does not tell the source
    WScript.Echo("Error " + (error.number & 0xFFFF) + ": " + error.description);
}
