// What a late-bound host may rely on, as JScript sees it: a line for each fact, and the count of them at the end.
//
// JScript passes nothing by reference, knows no error source, and under Wine no dates of automation: hosts.vbs has these.
var passed = 0, failed = 0, faults;

function fact(words, checks) {
    faults = [];
    var before = checked;
    try {
        checks();
    } catch (error) {
        faults.push("raised " + numberOf(error) + " [" + error.description + "]");
    }
    if (checked === before)
        faults.push("checks nothing");
    if (faults.length === 0)
        ++passed;
    else
        ++failed;
    WScript.Echo((faults.length === 0 ? "ok      " : "FAILED  ") + words);
    for (var i = 0; i < faults.length; ++i)
        WScript.Echo("    " + faults[i]);
}

var checked = 0;

function equal(got, wanted) {
    ++checked;
    if (got !== wanted)
        faults.push("expected " + typeof wanted + " [" + wanted + "], got " + typeof got + " [" + got + "]");
}

function numberOf(error) { return error.number & 0xFFFF; }

function raises(number, description, action) {
    ++checked;
    try {
        action();
    } catch (error) {
        if (numberOf(error) !== number || description !== null && error.description !== description)
            faults.push("expected " + number + " [" + description + "], got " + numberOf(error) + " [" + error.description + "]");
        return;
    }
    faults.push("expected " + number + ", got no error");
}

// What is refused before it reaches the library: the status is a number of Windows, which Wine's JScript does not translate.
function refuses(number, status, action) {
    ++checked;
    try {
        action();
    } catch (error) {
        if (numberOf(error) !== number && (error.number >>> 0) !== status)
            faults.push("expected " + number + " or " + status.toString(16) + ", got " + (error.number >>> 0).toString(16));
        return;
    }
    faults.push("expected " + number + ", got no error");
}

function create(className) { return new ActiveXObject("Varnex3." + className); }

fact("An object is created by both program ids of its class", function () {
    equal(create("VersionDef").XaloVersion, "");
    equal(create("VersionDef.3").XaloVersion, "");
});
fact("A text comes back with every character, beyond ASCII too", function () {
    var version = create("VersionDef"), text = "\t\r\n <&>\"' \u00e9\u20ac\u65e5\ud83d\ude00 \u0000 end";
    version.XaloVersion = text;
    equal(version.XaloVersion, text);
});
fact("Members are found in any letter case", function () {
    var version = create("VersionDef");
    version.xaloversion = "1";
    equal(version.XALOVERSION, "1");
});
fact("An integer is a number at both ends of its type", function () {
    var claim = create("ClaimHeaderDef");
    claim.ReinstatementNo = 2147483647;
    equal(claim.ReinstatementNo, 2147483647);
    claim.ReinstatementNo = -2147483648;
    equal(claim.ReinstatementNo, -2147483648);
    claim.ReinstatementNo = " 7 ";
    equal(claim.ReinstatementNo, 7);
});
fact("undefined is Empty: 0 and the empty text", function () {
    var claim = create("ClaimHeaderDef");
    claim.ReinstatementNo = 5;
    claim.ReinstatementNo = undefined;
    equal(claim.ReinstatementNo, 0);
    claim.VehicleID = undefined;
    equal(claim.VehicleID, "");
});
fact("A number outside 32 bits raises 6, a text that is no number 13", function () {
    var claim = create("ClaimHeaderDef");
    raises(6, "'2147483648' is outside the range of a 32-bit integer", function () { claim.ReinstatementNo = 2147483648; });
    raises(13, "'12x' is not a number", function () { claim.ReinstatementNo = "12x"; });
    equal(claim.ReinstatementNo, 0);
});
fact("A Boolean is true or false", function () {
    var message = create("MessageDef");
    equal(message.ParseError, false);
    message.ParseError = true;
    equal(message.ParseError, true);
});
fact("A constant of an enumeration is a number", function () {
    var message = create("MessageDef");
    message.MessageTypeID = 4;
    equal(message.MessageTypeID, 4);
    equal(message.MessageType, "Xalo_Quote");
});
fact("A child is one object, whenever it is asked for", function () {
    var customer = create("CustomerDef");
    customer.PersonalName.Forname = "Grace";
    customer.PersonalName.Surname = "Hopper";
    equal(customer.PersonalName.FullName, "Grace Hopper");
    equal(customer.PersonalName === customer.PersonalName, true);
});
fact("= puts a child in place of another; null has it made again", function () {
    var customer = create("CustomerDef"), name = create("PersonalNameDef");
    name.Surname = "Hopper";
    customer.PersonalName = name;
    equal(customer.PersonalName === name, true);
    customer.PersonalName = null;
    equal(customer.PersonalName.Surname, "");
});
fact("An object of another class, the library's or not, raises 13", function () {
    var customer = create("CustomerDef");
    raises(13, "an object of class VersionDef is not a PersonalNameDef",
           function () { customer.PersonalName = create("VersionDef"); });
    raises(13, null, function () { customer.PersonalName = new ActiveXObject("Scripting.Dictionary"); });
    raises(13, null, function () { customer.PersonalName = "Grace"; });
});
fact("An indexed property is read and stored", function () {
    var details = create("InsurerDetailDef");
    details.Add("Phone", "1");
    equal(details.Values("Phone"), "1");
    equal(details.Values(0), "1");
    details.Values("Phone") = "2";
    equal(details.Values("Phone"), "2");
    equal(details.Fields(0), "Phone");
    equal(details.Count, 1);
});
fact("A method without a result gives undefined, and so does one that gives Empty", function () {
    equal(create("InsurerDetailDef").Add("Phone", "1"), undefined);
    equal(create("VersionDef").ParseXML("<Version/>"), undefined);
});
fact("Nothing is null", function () { equal(create("Xalo_Messages").MessageItems(0), null); });
fact("A loop over the positions of a list meets every entry", function () {
    var list = create("Xalo_Messages"), numbers = "";
    for (var i = 1; i <= 3; ++i)
        list.Add("file" + i + ".xml").MessageNo = "M" + i;
    for (i = 0; i < list.Count; ++i)
        numbers += list.MessageItems(i).MessageNo + " ";
    equal(numbers, "M1 M2 M3 ");
});
fact("An unknown key raises 424", function () {
    var list = create("Xalo_Messages");
    list.Add("a");
    raises(424, "the entry 'b' is empty", function () { list.MessageItems("b"); });
    equal(list.Count, 2);
});
fact("Optional arguments may be left out; values are taken where variables come back", function () {
    var list = create("Xalo_Messages");
    equal(list.ParseFiles("Q:\\none"), false);
    equal(list.ParseFiles("Q:\\none", 1), false);
    equal(list.ParseFiles("Q:\\none", 1, "text"), false);
});
fact("A duplicate key raises 457 with words beyond ASCII", function () {
    var details = create("InsurerDetailDef");
    details.Add("caf\u00e9 \u65e5", "1");
    raises(457, "the key 'caf\u00e9 \u65e5' is already in the list", function () { details.Add("caf\u00e9 \u65e5", "2"); });
});
fact("A member that is not there raises 438", function () {
    refuses(438, 0x80020006, function () { create("VersionDef").NoSuch(); });
    refuses(438, 0x80020006, function () { create("VersionDef").NoSuch = 1; });
});
fact("One argument too few or too many is refused", function () {
    var version = create("VersionDef");
    version.XaloVersion = "1";
    refuses(449, 0x8002000F, function () { version.ParseXML(); });
    refuses(450, 0x8002000E, function () { version.ParseXML("<Version/>", 2); });
    equal(version.XaloVersion, "1");
});

WScript.Echo(passed + " passed, " + failed + " failed");
