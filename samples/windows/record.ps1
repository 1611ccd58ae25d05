# Writes a record as XML, reads it back, and meets an error: powershell -File record.ps1
$source = New-Object -ComObject Varnex3.SourceDef
$source.OrgType = 'REP'
$source.AppName = 'Workshop'
$source.AppVersion = '2.1'
$source.TimeStamp = [datetime]'2004-03-15T14:05:09'
$xml = $source.Serialise()
$xml

$copy = New-Object -ComObject Varnex3.SourceDef
[void]$copy.ParseXML($xml)
"Read back: $($copy.OrgType) $($copy.AppName) $($copy.AppVersion)"

try {
    [void]$copy.ParseXML($xml.Replace('2004-03-15T14:05:09', 'soon'))
} catch {
    $fault = $_.Exception.GetBaseException()
    "Error $($fault.HResult -band 0xFFFF) from $($fault.Source): $($fault.Message)"
}
