# Lists an inbox folder, a line a message: powershell -File inbox.ps1 [FOLDER]
param([string]$Folder = 'samples\inbox')

$messages = New-Object -ComObject Varnex3.Xalo_Messages
[int]$number = 0
[string]$words = ''
$isWhole = $messages.ParseFiles($Folder, [ref]$number, [ref]$words)
for ($i = 0; $i -lt $messages.Count; $i++) {
    $message = $messages.MessageItems($i)
    if ($message.ParseError) {
        $message.ErrorMessage
    } else {
        $message.MessageNo, $message.MessageDescription, $message.Registration, $message.ClaimNo -join ', '
    }
}
"$($messages.Count) messages"
if (-not $isWhole) { "Error ${number}: $words" }
