program inbox;
// Lists an inbox folder, a line a message: inbox [FOLDER]. Delphi, or Free Pascal with -Mdelphi.
{$APPTYPE CONSOLE}

uses
  ActiveX, ComObj, Variants;

procedure ListInbox(const Folder: WideString);
var
  Messages, Message: OleVariant;
  Number, I: Integer;
  Words: WideString;
  IsWhole: Boolean;
begin
  Messages := CreateOleObject('Varnex3.Xalo_Messages');
  Number := 0;
  Words := '';
  IsWhole := Messages.ParseFiles(Folder, Number, Words);
  for I := 0 to Integer(Messages.Count) - 1 do
  begin
    Message := Messages.MessageItems[I];
    if Message.ParseError then
      WriteLn(Message.ErrorMessage)
    else
      WriteLn(Message.MessageNo, ', ', Message.MessageDescription, ', ', Message.Registration, ', ', Message.ClaimNo);
  end;
  WriteLn(Messages.Count, ' messages');
  if not IsWhole then
    WriteLn('Error ', Number, ': ', Words);
end;

begin
  CoInitialize(nil);
  if ParamCount > 0 then
    ListInbox(ParamStr(1))
  else
    ListInbox('samples\inbox');
end.
