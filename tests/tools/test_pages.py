"""The page that `varnex3 show` has for each message.

VARNEX3_PROGRAM is the program. The pages stand in the folder pages beside this file: of every message one in which all
has a value, one in which nothing has, and one of which a part cannot be read. After a change that is meant,
`test_pages.py write` writes them again; their differences are what is to be looked at.
"""

import re
import shutil
import sys
import tempfile
import unittest
from pathlib import Path
from xml.etree import ElementTree

import test_convert
import test_doctor
import test_tools as tools
from test_tools import FINDINGS, FINE, SAMPLES, SOURCE

MESSAGES = SOURCE / "tests" / "messages"
PAGES = Path(__file__).resolve().parent / "pages"

# Of each message an element, what stands in its place in the broken one, and why that cannot be read.
BROKEN = {
    "RequestForQuote": ("SumInsured", "<SumInsured>x</SumInsured>",
                        "RequestDetailsDef.ParseXML: SumInsured: 'x' is not a number (13)"),
    "Quote": ("TaxRate", "<TaxRate>x</TaxRate>", "TotalsDef.ParseXML: TaxRate: 'x' is not a number (13)"),
    "TaxInvoice": ("TotalTaxAmount", "<TotalTaxAmount>x</TotalTaxAmount>",
                   "PaymentDetailsDef.ParseXML: TotalTaxAmount: 'x' is not a number (13)"),
    "AdjustmentNote": ("SupplyDifferenceAmount", "<SupplyDifferenceAmount>x</SupplyDifferenceAmount>",
                       "AdjustmentNoteDetailsDef.SupplyDifferenceAmount: 'x' is not a number (13)"),
    "ReactivateInvoice": ("TaxRate", "<TaxRate/>", "PaymentDetailsDef.ParseXML: TaxRate: '' is not a number (13)"),
    "PaymentAuthorised": ("PayAuthorisedDate", "<PayAuthorisedDate>soon</PayAuthorisedDate>",
                          "PayAuthorityDetailsDef.ParseXML: PayAuthorisedDate: 'soon' is not a date (13)"),
    "PaymentDeclined": ("TotalPayableAmount", "<TotalPayableAmount>x</TotalPayableAmount>",
                        "PaymentDetailsDef.ParseXML: TotalPayableAmount: 'x' is not a number (13)"),
    "Declined": ("DeclinedDate", "<DeclinedDate>soon</DeclinedDate>",
                 "DeclinedDetailDef.DeclinedDate: 'soon' is not a date (13)"),
    "JobCancelled": ("AppVersion", "", "SourceDef.ParseXML: the element Source/AppVersion is missing (91)"),
    "Error": ("ExpectedMessageNo", "<ExpectedMessageNo>x</ExpectedMessageNo>",
              "ErrorDetailsDefMessageOrderError.ParseXML: ExpectedMessageNo: 'x' is not a number (13)"),
    "Image": ("ReinstatementNo", "<ReinstatementNo>x</ReinstatementNo>",
              "ClaimHeaderDef.ParseXML: ReinstatementNo: 'x' is not a number (13)"),
    "VarnexVersionChange": ("OrgType", "", "SourceDef.ParseXML: the element Source/OrgType is missing (91)"),
    "VarnexReferenceData": ("DataType", "<DataType/>",
                            "ReferenceDataDefDataType.ParseXML: the element DataType has no attribute (91)"),
}


def full(kind):
    return tools.run("new", kind).out


def empty(kind):
    """As the library writes it; but a request that it wrote would have no date, and cannot be read."""
    text = (MESSAGES / f"Xalo_{kind}-empty.xml").read_text("utf-8")
    return re.sub(r"(?s)<RequestDetails>.*</RequestDetails>", "", text)


def broken(kind):
    element, other, _ = BROKEN[kind]
    return re.sub(rf"(?s)<{element}\b.*?</{element}>", other, full(kind), count=1)


FORMS = {"full": full, "empty": empty, "broken": broken}


class PageTest(tools.ToolTest):
    maxDiff = None

    def show(self, text, *arguments):
        return tools.run("show", *arguments, self.write("message.xml", text))

    def assert_page(self, kind, form, status):
        done = self.show(FORMS[form](kind))
        self.assertEqual((status, ""), (done.status, done.errors), kind)
        self.assertEqual((PAGES / f"{kind}-{form}.txt").read_text("utf-8"), done.out, kind)
        return done.out

    def test_there_is_a_page_for_every_message(self):
        """show: every type of message that there is a class for has its page"""
        self.assertEqual(set(test_convert.types()), set(BROKEN))
        self.assertEqual({f"{kind}-{form}.txt" for kind in BROKEN for form in FORMS},
                         {path.name for path in PAGES.iterdir()})

    def test_a_message_is_a_page(self):
        """show: each message by subject and in words, amounts below each other, errors and codes as tables"""
        for kind in BROKEN:
            self.assert_page(kind, "full", FINE)

    def test_a_message_without_values_is_a_short_page(self):
        """show: of a message in which nothing has a value only what it is"""
        for kind in BROKEN:
            self.assert_page(kind, "empty", FINE)

    def test_a_part_that_cannot_be_read_keeps_nothing_else_from_being_shown(self):
        """show: of a part that cannot be read what was read, why, and all that it has in the file; status 1"""
        for kind, (_, _, reason) in BROKEN.items():
            page = self.assert_page(kind, "broken", FINDINGS)
            self.assertIn(reason, re.sub(r"\n +", " ", page))
            self.assertIn("\nAlso in the message\n", page)

    def test_nothing_but_the_root(self):
        """show: a message that is only its root element"""
        for kind in BROKEN:
            done = self.show(f"<Xalo_{kind}/>")
            self.assertEqual((FINE, 2), (done.status, done.out.count("\n")), done.out)

    def test_no_value_of_a_message_is_lost(self):
        """show: every value of every example is on its page"""
        for kind in BROKEN:
            text = full(kind)
            page = tools.run_at_terminal("show", self.write("message.xml", text), columns=250, NO_COLOR="1").out
            for element in ElementTree.fromstring(text).iter():
                if len(element) == 0 and element.text:
                    self.assertIn(element.text.replace("T", " ") if element.tag == "TimeStamp" else element.text, page)

    def test_what_no_class_reads_is_shown(self):
        """show: elements that no class reads, wherever they stand, as a tree with what they stand in"""
        text = ("<Xalo_TaxInvoice><Vehicle><Make>Brolga</Make><Keys>2<!-- of 3 --></Keys></Vehicle>"
                "<Vehicle><Make>Merindah</Make></Vehicle><Survey by='web'><Stars>5</Stars></Survey></Xalo_TaxInvoice>")
        done = self.show(text)
        self.assertEqual(FINE, done.status)
        self.assertIn("\n\nVehicle\n  Make and model        Brolga\n\nAlso in the message\n"
                      "  Vehicle\n    Keys                2\n"
                      "  Vehicle\n    Make                Merindah\n"
                      "  Survey\n    @by                 web\n    Stars               5\n", done.out)
        others = tools.json_lines("show", self.write("message.xml", text))[0]["others"]
        self.assertEqual({"depth": 1, "element": "Keys", "text": "2"}, others[1])
        self.assertEqual([{"depth": 0, "element": "Survey"}, {"depth": 1, "element": "@by", "text": "web"}],
                         others[4:6])

    def test_a_file_may_be_nested_as_deep_as_it_likes(self):
        """show: elements that no class reads, 100,000 levels deep"""
        done = self.show("<Xalo_Image>" + 100_000 * "<a>" + "end" + 100_000 * "</a>" + "</Xalo_Image>")
        self.assertEqual(FINE, done.status)
        self.assert_no_line_is_wider(done.out, 80)
        self.assertRegex(done.out, r"a +end\n$")

    def test_very_many_attributes(self):
        """show: of an element with very many attributes that no class reads the first hundred, and how many more"""
        attributes = " ".join(f"a{i}='{i}'" for i in range(50_000))
        page = self.show(f"<Xalo_Image><Photo {attributes}/></Xalo_Image>").out.splitlines()
        self.assertEqual(["    @a99                99", "    @                   49900 more"], page[-2:])

    def test_a_list_that_is_longer_than_positions_reach(self):
        """show: of more than 32,768 errors or codes those that a position reaches, and that there are more"""
        errors = 32_770 * "<ErrorDetails><Severity>E</Severity></ErrorDetails>"
        page = self.show(f"<Xalo_Error>{errors}</Xalo_Error>").out.splitlines()
        self.assertEqual(["32768  E", "  More                  2"], page[-2:])
        codes = 32_770 * "<DataValue><Code>A</Code></DataValue>"
        text = (f"<Xalo_VarnexReferenceData><ReferenceData><DataType n='T'>{codes}</DataType></ReferenceData>"
                "</Xalo_VarnexReferenceData>")
        self.assertEqual("  More                  the count 32770 is outside the range of a 16-bit integer",
                         self.show(text).out.splitlines()[-1])
        shown, = tools.json_lines("show", self.write("message.xml", text))
        self.assertEqual(6, shown["sections"]["ReferenceData"]["error"]["number"])

    def test_a_narrow_terminal(self):
        """show: no page is wider than the terminal, or has a line that ends with a blank"""
        for kind in BROKEN:
            path = self.write("message.xml", full(kind))
            for columns in (20, 50, 80):
                out = tools.run_at_terminal("show", path, columns=columns, NO_COLOR="1").out
                self.assert_no_line_is_wider(out, columns)
                self.assert_no_blanks_end_a_line(out)

    def test_json_has_what_is_only_written(self):
        """show --json: sections of classes that are only written, and the values beside the sections"""
        shown, = tools.json_lines("show", str(SAMPLES / "job-4711-5-tax-invoice.xml"))
        self.assertEqual({"TaxInvoice": True, "CompletionDate": "2008-03-17T00:00:00",
                          "Description": "Repairs as authorised"}, shown["sections"]["TaxInvoiceDetail"])
        self.assertEqual(("2008-03-18", "Keys with the front desk"), (shown["TaxInvoiceDate"], shown["OpenText"]))
        self.assertNotIn("others", shown)

    def test_json_has_every_error(self):
        """show --json: all error details of a report, in one list"""
        shown, = tools.json_lines("show", str(SAMPLES / "error-four-kinds.xml"))
        items = shown["sections"]["ErrorDetails"]["ErrorItems"]
        self.assertEqual(["3", "2", "3", "1"], [item["Severity"] for item in items])
        self.assertEqual((403, "RegistrationNo"), (items[1]["MessageOrderError"]["ReceivedMessageNo"],
                                                   items[0]["DataContentError"]["ElementName"]))

    def test_expected_amounts_stand_beside_the_invoiced_ones(self):
        """show: of a declined payment what was invoiced, what was expected, and the difference"""
        out = tools.run("show", str(SAMPLES / "job-4822-6-payment-declined.xml")).out
        self.assertRegex(out, r"(?m)^ +Invoiced +Expected +Difference$")
        self.assertRegex(out, r"(?m)^  Payable +829\.05 +724\.00 +-105\.05$")

    def test_an_amount_that_was_not_read_is_not_0(self):
        """show: amounts behind one that cannot be read are left out, and so is a difference with them"""
        text = (SAMPLES / "job-4822-6-payment-declined.xml").read_text("utf-8")
        out = self.show(text.replace("<TotalIncludingTax>1474.00", "<TotalIncludingTax>x")).out
        self.assertRegex(out, r"(?m)^  Tax +143\.55 +134\.00 +-9\.55$")
        self.assertRegex(out, r"(?m)^  With tax +1579\.05$")

    def test_a_detail_of_two_kinds_and_one_of_none(self):
        """show: an error detail takes a line for each of its kinds; one without any has its severity"""
        out = self.show("<Xalo_Error><ErrorDetails><Severity>E</Severity>"
                        "<MessageTypeError><Description>Type</Description></MessageTypeError>"
                        "<MiscellaneousError><Description>Other</Description></MiscellaneousError></ErrorDetails>"
                        "<ErrorDetails><Severity>W</Severity></ErrorDetails></Xalo_Error>").out
        self.assertEqual(["Errors",
                          "No  Severity  Kind           Description",
                          " 1  E         Message type   Type",
                          "    E         Miscellaneous  Other",
                          " 2  W"], out.splitlines()[-5:])


class SeverityTest(test_doctor.DoctorTest):
    def test_a_severity_is_told_in_words(self):
        """show: the severity of an error in words, where the workshop's database answers"""
        server = test_doctor.TdsServer("--password", test_doctor.SECRET)
        self.addCleanup(server.stop)
        self.register_drivers(*test_doctor.DRIVERS)
        self.set(ServerName=f"127.0.0.1,{server.port}", SAPwd=test_doctor.SECRET)
        out = tools.run("show", self.write("message.xml", full("Error")), **self.changes).out
        self.assertRegex(out, r"(?m)^ 1  Error \(E\) +Data content ")


def write_pages():
    shutil.rmtree(PAGES, ignore_errors=True)
    PAGES.mkdir()
    for kind in BROKEN:
        for form, make in FORMS.items():
            with tempfile.TemporaryDirectory() as folder:
                path = Path(folder) / "message.xml"
                path.write_text(make(kind), "utf-8")
                (PAGES / f"{kind}-{form}.txt").write_text(tools.run("show", str(path)).out, "utf-8")


if __name__ == "__main__":
    if sys.argv[1:] == ["write"]:
        write_pages()
    else:
        unittest.main()
