"""What `varnex3 convert` and `varnex3 new` promise.

VARNEX3_PROGRAM is the program, VARNEX3_SAMPLES the sample inbox.
"""

import json
import re
import sys
import unittest
from pathlib import Path
from xml.etree import ElementTree

import test_tools as tools
from test_tools import COULD_NOT_RUN, FINDINGS, FINE, SAMPLES, SOURCE

MESSAGES = SOURCE / "tests" / "messages"
QUOTE = str(SAMPLES / "job-4711-2-quote.xml")


def types():
    """The types of messages, as the program lists them."""
    listed = tools.run("new", "bogus").errors.replace("\n   ", "")
    return re.search(r"; there are (.*) \(error 5\)", listed)[1].split(", ")


def is_broken(text):
    try:
        ElementTree.fromstring(text)
    except ElementTree.ParseError:
        return True
    return False


class ConvertTest(tools.ToolTest):
    def convert(self, *arguments):
        return tools.run("convert", *map(str, arguments))

    def json_of(self, path):
        done = self.convert(path, "--to", "json")
        self.assertEqual((FINE, ""), (done.status, done.errors), path)
        return json.loads(done.out)

    def edited(self, change, path=QUOTE):
        """A message as a file of JSON, after a change."""
        message = self.json_of(path)
        change(next(iter(message.values())))
        return self.write("edited.json", json.dumps(message))

    def refusal(self, path):
        """Why a file is not converted: a finding, and nothing is written."""
        target = self.folder / "target"
        target.write_text("as it was")
        done = self.convert(path, "-o", target)
        self.assertEqual((FINDINGS, "", "as it was"), (done.status, done.out, target.read_text()))
        self.assertEqual(["target"], [p.name for p in self.folder.iterdir() if p.name.startswith("target")])
        return done.errors.replace("\n   ", "")

    def refusal_of_change(self, change, path=QUOTE):
        return self.refusal(self.edited(change, path))

    def assert_comes_back(self, path):
        """From XML to JSON to XML gives what writing the message again gives. Tells whether the message can be read."""
        again = self.convert(path, "--to", "xml")
        done = self.convert(path, "--to", "json")
        if again.out == "":
            self.assertEqual((FINDINGS, FINDINGS, ""), (again.status, done.status, done.out), path)
            return False
        self.assertEqual((FINE, ""), (done.status, done.errors), path)
        back = self.convert(self.write("message.json", done.out))
        self.assertEqual((again.status, again.out), (back.status, back.out), path)
        self.assertEqual(is_broken(back.out), back.status == FINDINGS, path)
        return True

    def test_every_golden_message_comes_back_from_json(self):
        """Every message of the tests that can be read comes back from JSON as it would be written again"""
        read = {path.name.split("-")[0] for path in sorted(MESSAGES.glob("Xalo_*.xml")) if self.assert_comes_back(path)}
        self.assertLessEqual({"Xalo_RequestForQuote", "Xalo_Quote"}, read)
        full = [path for path in MESSAGES.glob("Xalo_*-full.xml") if path.name.split("-")[0] in read]
        self.assertEqual(len(read), len([path for path in full if self.assert_comes_back(path)]))

    def test_every_sample_comes_back_from_json(self):
        """The same of the sample inbox, whatever the encoding and layout"""
        samples = [path for path in SAMPLES.iterdir() if path.suffix.lower() == ".xml"]
        self.assertGreater(len([path for path in samples if self.assert_comes_back(path)]), 10)

    def test_the_xml_of_a_written_message_is_the_file_itself(self):
        """A quote that this library wrote comes back from JSON to the byte"""
        target = self.folder / "quote.json"
        self.assertEqual((FINE, "", ""), self.convert(QUOTE, "-o", target))
        back = self.folder / "quote.xml"
        self.assertEqual((FINE, "", ""), self.convert(target, "-o", back))
        self.assertEqual(Path(QUOTE).read_bytes(), back.read_bytes())

    def test_json_has_the_class_and_its_properties(self):
        """The JSON names the class; its children are those that show tells"""
        message = self.json_of(QUOTE)
        self.assertEqual(["Xalo_Quote"], list(message))
        shown = tools.json_lines("show", QUOTE)[0]["sections"]
        quote = message["Xalo_Quote"]
        for section in ("Source", "Vehicle", "QuoteItems", "Totals", "Customer"):
            self.assertEqual(shown[section], quote[f"{section}Field"])
        self.assertEqual("Q004711", quote["QuoteNoField"])

    def test_a_message_can_be_written_again(self):
        """--to xml of XML: what the library writes of the message, in its own layout"""
        done = self.convert(SAMPLES / "syntax-one-line.xml", "--to", "xml")
        self.assertEqual((FINE, ""), (done.status, done.errors))
        self.assertIn("\n\t<Version>\n\t\t<XaloVersion>", done.out.replace("\r\n", "\n"))

    def test_json_may_be_short(self):
        """JSON need not name every property; what it leaves out is as in a new message"""
        path = self.write("short.json", '\ufeff \n{"Xalo_Quote": {"QuoteNoField": "Q1"}}')
        done = self.convert(path)
        self.assertEqual((FINE, ""), (done.status, done.errors))
        self.assertIn("<QuoteNo>Q1</QuoteNo>", done.out)

    def test_what_is_changed_in_json_is_changed_in_xml(self):
        """A changed value, and an item more, come back in the XML"""
        def change(quote):
            quote["VehicleField"]["Make"] = "Zürich Söhne"
            quote["QuoteItemsField"]["QuoteItems"].append({"ItemNo": 9, "QuoteItemType": "QuoteItemTowing"})
        done = self.convert(self.edited(change))
        self.assertEqual(FINE, done.status)
        self.assertIn("<Make>Zürich Söhne</Make>", done.out)
        self.assertIn("<ItemNo>9</ItemNo>", done.out)

    def test_an_unknown_property_is_named_by_its_path(self):
        """A property that the class does not have: path, class and name, and nothing is written"""
        def change(quote):
            quote["QuoteItemsField"]["QuoteItems"][2]["Desciption"] = ""
        self.assertIn("edited.json: Xalo_Quote.QuoteItemsField.QuoteItems[2]: QuoteItem has no property 'Desciption'",
                      self.refusal_of_change(change))

    def test_a_value_of_a_wrong_type_is_named_by_its_path(self):
        """A value that the property cannot have: path, value and what was wanted, and nothing is written"""
        def change(quote):
            quote["QuoteItemsField"]["QuoteItems"][0]["RemoveReplace"]["Hours"] = "two"
        self.assertIn("Xalo_Quote.QuoteItemsField.QuoteItems[0].RemoveReplace.Hours: 'two' is not a number",
                      self.refusal_of_change(change))
        self.assertIn("Xalo_Quote.SourceField.TimeStamp: 'soon' is not a date",
                      self.refusal_of_change(lambda quote: quote["SourceField"].update(TimeStamp="soon")))

    def test_broken_json_is_told_with_its_place(self):
        """A text that is not JSON: line and column, and nothing is written"""
        path = self.write("a.json", '{"Xalo_Quote": {\n "QuoteNoField": Q1}}')
        self.assertIn("line 2, column 18", self.refusal(path))
        self.assertIn("is no object of one name", self.refusal(self.write("b.json", "{}")))
        self.assertIn("there is no class 'VersionDef'", self.refusal(self.write("c.json", '{"VersionDef": {}}')))

    def test_what_keeps_a_message_from_being_written_is_told(self):
        """A part from the vehicle's maker needs a number: without one nothing is written"""
        def change(quote):
            quote["QuoteItemsField"]["QuoteItems"][4]["Part"]["PartSource"]["PartNumber"] = ""
        self.assertIn('OEM "PartNumber" attribute is required field.', self.refusal_of_change(change))

    def test_broken_xml_is_told_with_its_place(self):
        """XML that is not well-formed: line, column and reason, and nothing is written"""
        self.assertIn("broken-bare-ampersand.xml: line 22, column 32: ",
                      self.refusal(SAMPLES / "broken-bare-ampersand.xml"))

    def test_a_message_that_cannot_be_read_is_told(self):
        """A message without what its class needs, of a class that only writes, or of none: a finding"""
        empty = self.write("quote.xml", "<Xalo_Quote/>")
        self.assertRegex(self.refusal(empty), r"quote\.xml: .*Source")
        self.assertIn("a message of the type Xalo_TaxInvoice can only be written",
                      self.refusal(SAMPLES / "job-4711-5-tax-invoice.xml"))
        self.assertIn("the root element 'Xalo_DeliveryNotice' is no message's",
                      self.refusal(self.write("other.xml", "<Xalo_DeliveryNotice/>")))

    def test_xml_that_is_not_well_formed_is_written_and_told(self):
        """Some texts are not escaped: the message is written as every host writes it, and the fault told"""
        path = self.edited(lambda quote: quote["VehicleField"].update(Make="Salt & Sons"))
        target = self.folder / "quote.xml"
        done = self.convert(path, "-o", target)
        self.assertEqual((FINDINGS, ""), (done.status, done.out))
        self.assertRegex(done.errors, r"^varnex3: what was written is not well-formed: line 4\d, column \d+: ")
        self.assertIn(b"<Make>Salt & Sons</Make>", target.read_bytes())

    def test_files_that_cannot_be_read_or_written_end_with_two(self):
        """A file that is not there, a folder that is not there: status 2, and a message"""
        for arguments in ((self.folder / "none.xml",), (QUOTE, "-o", self.folder / "none" / "a.json"),
                          (QUOTE, "--to", "yaml"), (), (QUOTE, QUOTE)):
            done = self.convert(*arguments)
            self.assertEqual((COULD_NOT_RUN, ""), (done.status, done.out), arguments)
            self.assertTrue(done.errors.startswith("varnex3: "), done.errors)


class NewTest(tools.ToolTest):
    def new(self, name, *more):
        done = tools.run("new", name, *more)
        self.assertEqual((FINE, ""), (done.status, done.errors), name)
        return done.out

    def test_every_type_has_an_example(self):
        """The example of every type is well-formed, of that type, and the same every time"""
        self.assertGreaterEqual(len(types()), 9)
        for name in types():
            example = self.new(name)
            self.assertEqual(f"Xalo_{name}", ElementTree.fromstring(example).tag)
            self.assertEqual(example, self.new(name))

    def test_an_example_has_a_value_in_every_place(self):
        """No property of an example is empty, but what its kind leaves to other kinds"""
        for name in types():
            with self.subTest(name):
                message = json.loads(self.new(name, "--to", "json"))[f"Xalo_{name}"]
                empty = [key for key, value in message.items() if value in ("", 0, "1899-12-30T00:00:00")]
                self.assertEqual(["OpenTextField"] if name == "AdjustmentNote" else [], empty)

    def test_an_example_can_be_read_and_shown(self):
        """Every example can be shown without a finding; of those that are read, all comes back that is ever read"""
        for name in types():
            with self.subTest(name):
                path = str(self.folder / f"{name}.xml")
                self.assertEqual("", self.new(name, "-o", path))
                self.assertEqual(FINE, tools.run("show", path).status)
                done = tools.run("convert", path, "--to", "xml")
                if "can only be written" in done.errors.replace("\n   ", ""):
                    continue
                written = Path(path).read_bytes().decode()
                kept = re.sub(r"\t+<(InspectionReqested|TaxInvoiceDate)\b.*\r\n", "", written)  # which no class reads
                self.assertEqual((FINE, kept), (done.status, done.out))

    def test_an_example_as_json_converts_to_the_example(self):
        """--to json: the same message"""
        for name in types():
            path = self.write(f"{name}.json", self.new(name, "--to", "json"))
            self.assertEqual(self.new(name), tools.run("convert", path).out)

    def test_the_quote_has_an_item_of_every_kind_and_adds_up(self):
        """The example of a quote: eight kinds of item, whose values are the total"""
        quote = ElementTree.fromstring(self.new("Quote"))
        items = quote.findall("QuoteItems/QuoteItem")
        kinds = {child.tag for item in items for child in item}
        self.assertLessEqual({"RemoveReplace", "Repair", "PaintLabour", "PaintMaterials", "Part", "Miscellaneous",
                              "Mechanical", "Towing"}, kinds)
        total = sum(round(float(item.findtext("QuoteItemValue")) * 100) for item in items)
        self.assertEqual(f"{total / 100:.2f}", quote.findtext("Totals/GrandTotalExTax"))

    def test_a_type_may_be_typed_as_one_likes(self):
        """The type with or without Xalo_, in any letter case"""
        for name in ("quote", "QUOTE", "Xalo_Quote", "xalo_quote"):
            self.assertEqual(self.new("Quote"), self.new(name))

    def test_a_wrong_type_lists_those_that_there_are(self):
        """A type that is none: status 2 and the list of types, nothing is written"""
        done = tools.run("new", "Messages", "-o", str(self.folder / "a.xml"))
        self.assertEqual((COULD_NOT_RUN, "", []), (done.status, done.out, list(self.folder.iterdir())))
        for name in ("'Messages'", "RequestForQuote", "Quote"):
            self.assertIn(name, done.errors)


class HelpTest(tools.ToolTest):
    def test_help_has_examples(self):
        """--help of both commands: examples, exit status, no line wider than 80 columns"""
        for command in ("convert", "new"):
            done = tools.run(command, "--help")
            self.assertEqual((FINE, ""), (done.status, done.errors))
            self.assertIn(f"Examples:\n  varnex3 {command} ", done.out)
            self.assertIn("Exit status: 0 fine", done.out)
            self.assert_no_line_is_wider(done.out, 80)
            self.assertIn(f"\n  {command} ", tools.run("--help").out)

    def test_the_manual_names_both_commands(self):
        """The manual page has both commands with their options"""
        manual = (SOURCE / "tools" / "varnex3.1").read_text()
        for command in ("convert", "new"):
            self.assertIn(f".B varnex3 {command}\n", manual)
            self.assertIn(f".B {command} ", manual)
        self.assertIn('.BI \\-\\-to " FORM"', manual)
        self.assertIn('.BI \\-o " FILE"', manual)


if __name__ == "__main__":
    sys.exit(unittest.main(verbosity=2))
