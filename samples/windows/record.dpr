program record_sample;
// Writes a record as XML, reads it back, and meets an error. Delphi, or Free Pascal with -Mdelphi.
{$APPTYPE CONSOLE}

uses
  ActiveX, ComObj, SysUtils, Variants;

procedure WriteRecord;
var
  Source, Copy: OleVariant;
  Xml: WideString;
begin
  Source := CreateOleObject('Varnex3.SourceDef');
  Source.OrgType := 'REP';
  Source.AppName := 'Workshop';
  Source.AppVersion := '2.1';
  Source.TimeStamp := VarFromDateTime(EncodeDate(2004, 3, 15) + EncodeTime(14, 5, 9, 0));
  Xml := Source.Serialise;
  Write(Xml);

  Copy := CreateOleObject('Varnex3.SourceDef');
  Copy.ParseXML(Xml);
  WriteLn('Read back: ', Copy.OrgType, ' ', Copy.AppName, ' ', Copy.AppVersion);

  try
    Copy.ParseXML(WideString(StringReplace(Xml, '2004-03-15T14:05:09', 'soon', [])));
  except
    on E: EOleException do
      WriteLn('Error ', E.ErrorCode and $FFFF, ' from ', E.Source, ': ', E.Message);
  end;
end;

begin
  CoInitialize(nil);
  WriteRecord;
end.
