"""What the program varnex3 promises.

VARNEX3_PROGRAM is the program, VARNEX3_SAMPLES the sample inbox.
"""

import collections
import errno
import fcntl
import json
import os
import pty
import re
import shutil
import struct
import subprocess
import sys
import tempfile
import termios
import threading
import time
import unicodedata
import unittest
from pathlib import Path

PROGRAM = os.environ["VARNEX3_PROGRAM"]
SAMPLES = Path(os.environ["VARNEX3_SAMPLES"])
SOURCE = Path(__file__).resolve().parents[2]

FINE, FINDINGS, COULD_NOT_RUN = 0, 1, 2

# Line and column of every broken sample, as an editor shows them.
BROKEN = {
    "broken-adjustment-note.xml": (58, 42),
    "broken-bad-utf-8.xml": (35, 27),
    "broken-bare-ampersand.xml": (22, 32),
    "broken-claimant-type.xml": (41, 6),
    "broken-control-character.xml": (35, 28),
    "broken-duplicate-attribute.xml": (24, 38),
    "broken-empty-file.xml": (1, 1),
    "broken-end-tag.xml": (62, 21),
    "broken-late-declaration.xml": (2, 3),
    "broken-plain-words.xml": (1, 1),
    "broken-truncated.xml": (106, 13),
    "broken-two-roots.xml": (35, 1),
    "broken-unclosed-element.xml": (65, 4),
    "broken-undeclared-entity.xml": (35, 28),
    "broken-undeclared-prefix.xml": (2, 23),
    "refused-internal-subset.xml": (2, 32),
}

Result = collections.namedtuple("Result", "status out errors")


def environment(**changes):
    kept = {name: value for name, value in os.environ.items() if name not in ("NO_COLOR", "TERM")}
    return kept | {"TERM": "xterm"} | changes


def run(*arguments, **changes):
    """Runs the program without a terminal."""
    done = subprocess.run([PROGRAM, *arguments], stdin=subprocess.DEVNULL, capture_output=True,
                          env=environment(**changes), timeout=60, check=False)
    return Result(done.returncode, done.stdout.decode("utf-8"), done.stderr.decode("utf-8"))


def json_lines(*arguments):
    return [json.loads(line) for line in run(*arguments, "--json").out.splitlines()]


class PseudoTerminal:
    """A terminal of a given width that remembers what was written to it."""

    def __init__(self, columns=80, delay=0.0):
        self.delay = delay  # before it begins to read
        self.ours, self.theirs = pty.openpty()
        fcntl.ioctl(self.theirs, termios.TIOCSWINSZ, struct.pack("HHHH", 24, columns, 0, 0))
        self.written = b""
        self.reader = threading.Thread(target=self._read)
        self.reader.start()

    def _read(self):
        time.sleep(self.delay)
        while True:
            try:
                chunk = os.read(self.ours, 65536)
            except OSError as error:
                if error.errno != errno.EIO:  # how a terminal says that nobody holds it any more
                    raise
                return
            if not chunk:
                return
            self.written += chunk

    def text(self):
        os.close(self.theirs)
        self.reader.join()
        os.close(self.ours)
        return self.written.decode("utf-8").replace("\r\n", "\n")


def run_at_terminal(*arguments, columns=80, streams=("out", "errors"), **changes):
    """Runs the program with a terminal as the named streams; each gives what was written to it."""
    terminals = {stream: PseudoTerminal(columns) for stream in streams}
    ends = {stream: terminal.theirs for stream, terminal in terminals.items()}
    done = subprocess.run([PROGRAM, *arguments], stdin=subprocess.DEVNULL,
                          stdout=ends.get("out", subprocess.PIPE), stderr=ends.get("errors", subprocess.PIPE),
                          env=environment(**changes), timeout=60, check=False)
    texts = {stream: terminal.text() for stream, terminal in terminals.items()}
    return Result(done.returncode, texts.get("out", (done.stdout or b"").decode("utf-8")),
                  texts.get("errors", (done.stderr or b"").decode("utf-8")))


def display_width(text):
    """Columns by the Unicode tables, told apart from the program's own way of counting."""
    width = 0
    for character in text:
        if unicodedata.category(character) in ("Mn", "Me", "Cf"):
            continue
        width += 2 if unicodedata.east_asian_width(character) in "WF" else 1
    return width


def message(customer="", root="Xalo_Quote", number="1", more=""):
    return (f"<{root}><MessageNo>{number}</MessageNo>{more}"
            f"<Customer><PersonalName><Surname>{customer}</Surname></PersonalName></Customer></{root}>")


class ToolTest(unittest.TestCase):
    def setUp(self):
        self.folder = Path(tempfile.mkdtemp(prefix="varnex3-"))
        self.addCleanup(shutil.rmtree, self.folder)

    def write(self, name, content):
        path = self.folder / name
        path.write_bytes(content if isinstance(content, bytes) else content.encode("utf-8"))
        return str(path)

    def assert_no_line_is_wider(self, text, columns):
        for line in text.splitlines():
            self.assertLessEqual(display_width(line), columns, line)

    def assert_no_blanks_end_a_line(self, text):
        for line in text.splitlines():
            self.assertEqual(line, line.rstrip())


class ScanTest(ToolTest):
    def test_a_row_for_each_message_file_with_type_and_number(self):
        """scan: each message file has a row with its type and number; other files have none"""
        out = run("scan", str(SAMPLES)).out
        self.assertRegex(out, r"(?m)^declined\.xml +Declined Repair +403 ")
        self.assertRegex(out, r"(?m)^UPPER\.XML +Request For Quote +512  DGH88M   CL-2008-005003$")
        self.assertNotIn("ignored", out)

    def test_values_stand_below_their_titles(self):
        """scan: a value stands below its title, whether the cells before it are empty or not"""
        titles, *rows = run("scan", str(SAMPLES)).out.split("\n\n")[0].splitlines()
        for row in rows:
            if "CL-" in row:
                self.assertEqual(titles.index("Claim"), display_width(row[:row.index("CL-")]), row)

    def test_no_line_is_wider_than_eighty_columns_without_a_terminal(self):
        """scan: without a terminal no line takes more than 80 columns, and the table uses most of them"""
        out = run("scan", str(SAMPLES)).out
        self.assert_no_line_is_wider(out, 80)
        self.assertGreater(max(map(display_width, out.splitlines())), 74)

    def test_the_table_follows_the_width_of_the_terminal(self):
        """scan: a wide terminal shows all columns, a narrow one the important ones, none a line too wide"""
        wide = run_at_terminal("scan", str(SAMPLES), columns=140, NO_COLOR="1").out
        self.assertIn("Corella Tourer", wide)
        for columns in (20, 33, 50, 79, 100, 140):
            out = run_at_terminal("scan", str(SAMPLES), columns=columns, NO_COLOR="1").out
            self.assert_no_line_is_wider(out, columns)
            self.assertTrue(out.startswith("File"), out[:80])

    def test_east_asian_and_combining_characters_are_counted_as_shown(self):
        """scan: wide characters take two columns and combining ones none, so that columns stay in line"""
        self.write("a.xml", message("李小龍" * 20, more="<QuoteNo/>"))
        self.write("b.xml", message("e\u0301" * 12))
        self.write("日本.xml", message("plain"))
        out = run("scan", str(self.folder)).out
        self.assert_no_line_is_wider(out, 80)
        rows = [line for line in out.splitlines() if ".xml" in line]
        for column in ("Quote", " 1 "):
            self.assertEqual(1, len({display_width(row[:row.index(column)]) for row in rows}), out)
        self.assertIn("…", rows[0])
        self.assertIn("e\u0301" * 12, rows[1])

    def test_each_broken_file_is_marked_and_explained_below(self):
        """scan: a broken file is marked in its row; below the table stand its true line and column"""
        out = run("scan", str(SAMPLES)).out
        table, below = out.split("\n\n", 1)
        self.assertEqual(len(BROKEN), len(re.findall(r"(?m) broken$", table)))
        for name, (line, column) in BROKEN.items():
            self.assertRegex(below, rf"(?m)^{re.escape(name)}:{line}:{column}: \w")

    def test_the_reason_is_the_files_own(self):
        """scan: the reason is that of the file, not that of an empty document"""
        path = self.write("x.xml", "<a>\r\n\t<b></c></a>")
        self.assertIn("x.xml:2:7: The end tag 'c' does not match the start tag 'b'", run("scan", str(self.folder)).out)
        self.assertIn("There is no root element", json_lines("scan", str(self.folder))[0]["ErrorMessage"])
        self.assertIn("'c'", json_lines("show", path)[0]["error"]["reason"])

    def test_totals_by_type_add_up(self):
        """scan: the totals by type add up to the files that are fine"""
        out = run("scan", str(SAMPLES)).out
        totals = dict(re.findall(r"(?m)^([A-Z][A-Za-z ]+?) +(\d+)$", out.rsplit("\n\n", 2)[1]))
        self.assertEqual("13", totals["Quote"])
        self.assertEqual(71 - len(BROKEN), sum(map(int, totals.values())))
        self.assertTrue(out.endswith("\n71 message files, 16 broken\n"))

    def test_no_line_ends_with_a_blank(self):
        """scan: no line ends with a blank"""
        self.assert_no_blanks_end_a_line(run("scan", str(SAMPLES)).out)

    def test_an_empty_folder_is_fine(self):
        """scan: an empty folder has no messages, and that is fine"""
        self.assertEqual(Result(FINE, "0 message files\n", ""), run("scan", str(self.folder)))
        self.assertEqual(Result(FINE, "", ""), run("scan", "--json", str(self.folder)))

    def test_a_folder_without_findings_is_fine(self):
        """scan: status 0 when all files are fine"""
        self.write("one.xml", message())
        self.assertEqual(FINE, run("scan", str(self.folder)).status)

    def test_a_broken_file_is_a_finding(self):
        """scan: status 1 when a file is broken, as a table and as JSON"""
        self.assertEqual(FINDINGS, run("scan", str(SAMPLES)).status)
        self.assertEqual(FINDINGS, run("scan", "--json", str(SAMPLES)).status)

    def test_a_missing_folder_cannot_be_scanned(self):
        """scan: a missing folder ends with status 2 and the message of error 30030 on the error stream"""
        missing = str(self.folder / "missing")
        expected = f"varnex3: Folder '{missing}' does not exist. (error 30030)\n"
        self.assertEqual(Result(COULD_NOT_RUN, "", expected), run("scan", missing))
        self.assertEqual(Result(COULD_NOT_RUN, "", expected), run("scan", missing, "--json"))

    def test_a_file_is_no_folder(self):
        """scan: a file in the place of the folder is a missing folder"""
        self.assertEqual(COULD_NOT_RUN, run("scan", self.write("one.xml", message())).status)

    def test_an_unreadable_file_is_a_finding_and_the_rest_is_read(self):
        """scan: an unreadable file is named with its reason, and the files after it are read"""
        self.write("a.xml", message())
        os.symlink(self.folder / "nowhere", self.folder / "b.xml")
        os.symlink("c.xml", self.folder / "c.xml")
        self.write("d.xml", message())
        done = run("scan", str(self.folder))
        self.assertEqual(FINDINGS, done.status)
        self.assertRegex(done.out, r"(?m)^b\.xml +unreadable$")
        self.assertIn("\nb.xml: file not found\n", done.out)
        self.assertIn("\nc.xml: Too many levels of symbolic links\n", done.out)
        self.assertRegex(done.out, r"(?m)^d\.xml +Quote ")
        self.assertIn("4 message files, 2 unreadable", done.out)

    @unittest.skipIf(os.geteuid() == 0, "the superuser may read every file")
    def test_a_file_without_permission_is_a_finding(self):
        """scan: a file that we may not read is named with its reason"""
        os.chmod(self.write("a.xml", message()), 0)
        self.assertIn("\na.xml: permission denied\n", run("scan", str(self.folder)).out)

    def test_files_are_listed_in_name_order(self):
        """scan: files stand in name order unless another order is asked for"""
        names = [entry["FileName"] for entry in json_lines("scan", str(SAMPLES))]
        self.assertEqual(sorted(names), names)
        self.assertEqual(71, len(names))

    def test_numbers_are_ordered_as_numbers(self):
        """scan --sort number: 9 before 10, those without a number last"""
        for name, number in (("a", "10"), ("b", ""), ("c", "9"), ("d", "x")):
            self.write(f"{name}.xml", message(number=number))
        names = [entry["FileName"] for entry in json_lines("scan", str(self.folder), "--sort", "number")]
        self.assertEqual(["c.xml", "a.xml", "d.xml", "b.xml"], names)

    def test_each_key_orders_the_files(self):
        """scan --sort: each key orders by its column, files without a value last, equal ones by name"""
        columns = {"name": "FileName", "type": "MessageDescription", "registration": "Registration",
                   "claim": "ClaimNo", "customer": "Customer", "vehicle": "VehicleDesciption"}
        for key, column in columns.items():
            entries = json_lines("scan", str(SAMPLES), "--sort", key)
            values = [("" if "error" in entry and key != "name" else entry[column], entry["FileName"])
                      for entry in entries]
            self.assertEqual(sorted(values, key=lambda value: (value[0] == "", *value)), values, key)

    def test_table_and_json_have_the_same_order(self):
        """scan --sort: the table stands in the same order as the JSON lines"""
        self.write("a.xml", message("Zimmer"))
        self.write("b.xml", message("Abel"))
        out = run("scan", str(self.folder), "--sort", "customer").out
        self.assertLess(out.index("b.xml"), out.index("a.xml"))

    def test_an_unknown_key_is_a_wrong_argument(self):
        """scan --sort: an unknown key ends with status 2 and names the keys"""
        done = run("scan", str(SAMPLES), "--sort", "colour")
        self.assertEqual((COULD_NOT_RUN, ""), (done.status, done.out))
        self.assertIn("registration", done.errors)

    def test_json_has_the_properties_of_the_summary(self):
        """scan --json: a line has the properties of the message summary, name and path among them"""
        entry = {e["FileName"]: e for e in json_lines("scan", str(SAMPLES))}["job-4711-2-quote.xml"]
        self.assertEqual("Xalo_Quote", entry["MessageTypeID"])
        self.assertEqual("Niamh Abernathy", entry["Customer"])
        self.assertEqual(str(SAMPLES / "job-4711-2-quote.xml"), entry["FilePath"])
        self.assertNotIn("error", entry)

    def test_json_of_a_broken_file_has_its_true_place(self):
        """scan --json: each broken file has name, path, true line, column and reason"""
        entries = {entry["FileName"]: entry for entry in json_lines("scan", str(SAMPLES))}
        found = {name: entry["error"] for name, entry in entries.items() if "error" in entry}
        self.assertEqual(BROKEN, {name: (error["line"], error["column"]) for name, error in found.items()})
        for name, error in found.items():
            self.assertEqual("broken", error["kind"])
            self.assertTrue(error["reason"])
            self.assertEqual(str(SAMPLES / name), entries[name]["FilePath"])

    def test_json_of_an_unreadable_file_has_number_and_reason(self):
        """scan --json: an unreadable file has name, path, error number and reason"""
        os.symlink(self.folder / "nowhere", self.folder / "b.xml")
        entry, = json_lines("scan", str(self.folder))
        self.assertEqual(("b.xml", str(self.folder / "b.xml")), (entry["FileName"], entry["FilePath"]))
        self.assertEqual({"kind": "unreadable", "number": 53, "reason": "file not found"}, entry["error"])

    def test_json_is_the_same_every_time(self):
        """scan --json: two runs give the same bytes"""
        self.assertEqual(run("scan", "--json", str(SAMPLES)), run("scan", "--json", str(SAMPLES)))

    def test_json_has_text_as_utf_8(self):
        """scan --json: text is UTF-8, not escaped"""
        self.assertIn('"Customer":"Grace Müller"', run("scan", "--json", str(SAMPLES)).out)

    def test_a_name_that_is_not_utf_8_is_shown_with_a_replacement(self):
        """scan: a file name that is not UTF-8 is shown with a replacement character, and read"""
        (Path(os.fsdecode(os.fsencode(self.folder) + b"/caf\xe9.xml"))).write_text(message())
        self.assertRegex(run("scan", str(self.folder)).out, r"(?m)^caf\uFFFD\.xml +Quote")
        self.assertRegex(json_lines("scan", str(self.folder))[0]["FileName"], r"^caf\uFFFD+\.xml$")

    def test_a_reader_that_goes_away_ends_the_program_quietly(self):
        """scan: when the reader of the output goes away the program ends without a word"""
        for _ in range(200):
            self.write(f"{_}.xml", message("x" * 1000))
        command = '"$0" scan --json "$1" | head -n 1'
        done = subprocess.run(["/bin/sh", "-c", command, PROGRAM, str(self.folder)], capture_output=True, timeout=60,
                              check=False)
        self.assertEqual(b"", done.stderr)
        self.assertEqual("0.xml", json.loads(done.stdout)["FileName"])

    def test_output_that_cannot_be_written_is_reported(self):
        """scan: output that cannot be written ends with status 2 and a message"""
        with open("/dev/full", "wb") as full:
            done = subprocess.run([PROGRAM, "scan", str(self.folder)], stdout=full, stderr=subprocess.PIPE, check=False)
        self.assertEqual(COULD_NOT_RUN, done.returncode)
        self.assertIn(b"cannot be written: No space left on device", done.stderr)

    def test_a_folder_may_be_called_like_a_command(self):
        """scan: a folder may have the name of a command"""
        (self.folder / "show").mkdir()
        done = subprocess.run([PROGRAM, "scan", "show"], cwd=self.folder, capture_output=True, check=False)
        self.assertEqual((FINE, b"0 message files\n"), (done.returncode, done.stdout))


class IdentifyTest(ToolTest):
    def test_the_type_by_the_root_tag(self):
        """identify: the type of each file by its root tag, in the order given"""
        files = [str(SAMPLES / name) for name in ("job-4711-2-quote.xml", "declined.xml", "unknown.xml")]
        entries = json_lines("identify", *files)
        self.assertEqual(["Quote", "Declined Repair", "Unknown"], [e["MessageDescription"] for e in entries])
        self.assertEqual(["Xalo_Quote", "Xalo_Declined", "Xalo_Unknown"], [e["MessageType"] for e in entries])
        self.assertEqual(files, [e["FilePath"] for e in entries])
        self.assertEqual(FINE, run("identify", *files).status)

    def test_every_encoding_the_library_reads(self):
        """identify: every encoding the library reads, with a mark or a declaration"""
        files = sorted(str(path) for path in SAMPLES.glob("encoding-*.xml"))
        self.assertEqual(5, len(files))
        for entry in json_lines("identify", *files):
            self.assertEqual("Request For Quote", entry["MessageDescription"], entry)
        for encoding in ("utf-16-le", "utf-16-be"):
            path = self.write(f"{encoding}.xml", message().encode(encoding))
            self.assertEqual("Quote", json_lines("identify", path)[0]["MessageDescription"])

    def test_agrees_with_the_full_load_about_every_sample(self):
        """identify: what loads has the type that a scan gives it"""
        for entry in json_lines("scan", str(SAMPLES)):
            if "error" not in entry:
                found, = json_lines("identify", entry["FilePath"])
                self.assertEqual(entry["MessageType"], found["MessageType"])
                if found["isMessage"]:
                    self.assertEqual(entry["MessageTypeID"], found["MessageTypeID"])

    def test_what_stands_before_the_root_is_passed_over(self):
        """identify: declarations, comments, instructions and a DOCTYPE before the root are passed over"""
        prolog = ('<?xml version="1.0"?>\r\n<!-- <Xalo_Image> -->\n<?note <Xalo_Image>?>'
                  '<!DOCTYPE Xalo_Quote SYSTEM "a>b.dtd">\n')
        path = self.write("x.xml", prolog + "<Xalo_Quote/>")
        self.assertEqual("Xalo_Quote", json_lines("identify", path)[0]["MessageType"])

    def test_the_root_tag_may_lie_across_any_boundary(self):
        """identify: a root tag is found wherever the first read ends within it"""
        for length in range(4096 - 40, 4096 + 2):
            path = self.write("x.xml", ("<!--" + "x" * (length % 2) + "é" * 2048)[:(length + 4) // 2] + "--><Xalo_Quote>")
            self.assertEqual("Xalo_Quote", json_lines("identify", path)[0]["MessageType"], length)

    def test_a_comment_of_any_length_is_passed_over(self):
        """identify: a megabyte of comment before the root is passed over"""
        path = self.write("x.xml", "<!--" + "long " * 200_000 + "--><Xalo_Image/>")
        self.assertEqual("Xalo_Image", json_lines("identify", path)[0]["MessageType"])

    def test_only_the_beginning_is_read(self):
        """identify: four kilobytes are enough; nothing behind them is waited for"""
        path = str(self.folder / "pipe.xml")
        os.mkfifo(path)
        writer = os.open(path, os.O_RDWR)  # held open: whoever reads on never meets the end
        self.addCleanup(os.close, writer)
        os.write(writer, b"<Xalo_Quote>".ljust(4096))
        self.assertEqual("Xalo_Quote", json_lines("identify", path)[0]["MessageType"])

    def test_what_is_no_message_is_said_to_be_none(self):
        """identify: another root, text, nothing, an unknown encoding: no message, the reason, status 1"""
        cases = {
            "other.xml": ("<DeliveryNotice/>", "The root element is not that of a message"),
            "old-name.xml": ("<Xalo_DeclinedRepair/>", "The root element is not that of a message"),
            "words.txt": ("Quote to follow", "There is text where the root element should start"),
            "empty.xml": ("", "There is no root element"),
            "comment.xml": ("<!-- only -->", "There is no root element"),
            "cut.xml": ("<Xalo_Quo", "There is no root element"),
            "tag.xml": ("<1/>", "The root tag has no proper name"),
            "subset.xml": ("<!DOCTYPE a [<!ENTITY b 'c'>]><Xalo_Quote/>",
                           "The DOCTYPE has declarations of its own, which are refused"),
            "koi8.xml": ('<?xml version="1.0" encoding="KOI8-R"?><Xalo_Quote/>',
                         "The encoding 'KOI8-R' is not known"),
        }
        for name, (content, reason) in cases.items():
            path = self.write(name, content)
            entry, = json_lines("identify", path)
            self.assertFalse(entry["isMessage"])
            self.assertEqual({"kind": "no message", "reason": reason}, entry["error"], name)
            done = run("identify", path)
            self.assertEqual(FINDINGS, done.status)
            self.assertIn("no message", done.out)

    def test_a_broken_message_is_identified_all_the_same(self):
        """identify: a message that is broken further on is identified"""
        entry, = json_lines("identify", str(SAMPLES / "broken-truncated.xml"))
        self.assertEqual("Quote", entry["MessageDescription"])

    def test_an_unreadable_file_is_a_finding_and_the_rest_is_read(self):
        """identify: an unreadable file is named with its reason, and the files after it are read"""
        done = run("identify", str(self.folder / "none.xml"), str(self.folder), str(SAMPLES / "declined.xml"))
        self.assertEqual((FINDINGS, ""), (done.status, done.errors))
        self.assertIn("none.xml: file not found", done.out.replace("\n    ", " "))
        self.assertIn(": is a folder", done.out.replace("\n    ", " "))
        self.assertIn("Declined Repair", done.out)

    def test_the_table_keeps_to_the_width(self):
        """identify: no line takes more than 80 columns or ends with a blank"""
        out = run("identify", *sorted(str(path) for path in SAMPLES.iterdir())).out
        self.assert_no_line_is_wider(out, 80)
        self.assert_no_blanks_end_a_line(out)

    def test_a_file_is_needed(self):
        """identify: without a file status 2"""
        self.assertEqual(COULD_NOT_RUN, run("identify").status)


class ShowTest(ToolTest):
    REQUEST = str(SAMPLES / "job-4711-1-request.xml")
    QUOTE = str(SAMPLES / "job-4711-2-quote.xml")
    WITHOUT_CLASS = str(SAMPLES / "total-loss.xml")  # a type that there is no page for

    def test_the_summary_and_every_section_that_has_a_class(self):
        """show: of another message the summary, then each section with its properties by name and value"""
        done = run("show", self.WITHOUT_CLASS)
        self.assertEqual((FINE, ""), (done.status, done.errors))
        self.assertRegex(done.out, r"(?m)^Type +Total Loss$")
        self.assertEqual(["Version", "Source", "Destination", "Insurer", "Repairer", "ClaimHeader", "Vehicle",
                          "Customer", "Also in the message"], re.findall(r"(?m)^\n(\w+(?: \w+)*)$", done.out))
        self.assertRegex(done.out, r"(?m)^  Make +Merindah$")
        self.assertRegex(done.out, r"(?m)^  RepairerDetails\n    Suburb +Upper Tarrago\n    Phone +\(02\) 5550 2124$")
        self.assertRegex(done.out, r"(?m)^  TotalLossDetails\n    DeterminedDate +2008-09-29$")

    def test_values_stand_below_each_other(self):
        """show: all values start in the same column"""
        for path in (self.WITHOUT_CLASS, self.REQUEST):
            out = run("show", path).out
            names = re.findall(r"(?m)^ *\w+(?: \w+)*  +", out)
            self.assertGreater(len(names), 25)
            self.assertEqual({24}, set(map(len, names)))

    def test_a_property_without_a_value_is_listed(self):
        """show: a property without a value is listed with a hyphen"""
        self.assertRegex(run("show", self.WITHOUT_CLASS).out, r"(?m)^  EquipmentLevel +-$")

    def assert_facts(self, out, part, facts):
        """The part has these facts, in this order, and no others."""
        lines = re.search(rf"(?m)^\n{part}\n((?:  .+\n)+)", out).group(1).splitlines()
        self.assertEqual(facts, [tuple(re.split(r"  +", line.strip(), maxsplit=1)) for line in lines])

    def test_a_request_is_a_page(self):
        """show: a request by subject, in words, damaged areas one a line; what has no value is left out"""
        done = run("show", self.REQUEST)
        self.assertEqual((FINE, ""), (done.status, done.errors))
        self.assertEqual(["Message", "Insurer", "Repairer", "Claim", "Customer", "Vehicle", "Request"],
                         re.findall(r"(?m)^\n(\w+)$", done.out))
        self.assert_facts(done.out, "Request", [
            ("Kind", "Assessed (A)"), ("Requested", "2008-03-03"), ("Quote expected", "2008-03-07"),
            ("Incident", "2008-02-29 08:15"), ("What happened", "Hit a kangaroo at dusk, front left"),
            ("Damaged areas", "Front bumper"), ("Left front guard",), ("Left headlamp",), ("Windscreen",),
            ("Towed", "yes"), ("Hire car", "yes"), ("Claimant", "the insured"), ("Claim status", "Open"),
            ("Policy", "Comprehensive"), ("Sum insured", "24500.00"), ("Claim threshold", "12000.00"),
            ("Excess to collect", "500.00")])
        self.assert_facts(done.out, "Customer", [
            ("Name", "Ms Niamh Abernathy"), ("Home", "(02) 5550 0138"), ("Mobile", "0491 570 006")])

    def test_a_new_request_has_little_to_tell(self):
        """show: a request with nothing but what is always there"""
        path = self.write("x.xml", "<Xalo_RequestForQuote><RequestDetails><RequestType>X</RequestType>"
                                   "<RequestDate>2008-03-03</RequestDate><ClaimantType><OtherParty/></ClaimantType>"
                                   "<EstimatedQuoteDate>2008-03-07</EstimatedQuoteDate></RequestDetails>"
                                   "<VehicleMods><VehicleMod>Tow bar</VehicleMod><VehicleMod>Rack</VehicleMod>"
                                   "</VehicleMods></Xalo_RequestForQuote>")
        out = run("show", path).out
        self.assert_facts(out, "Request", [("Kind", "X"), ("Requested", "2008-03-03"), ("Quote expected", "2008-03-07"),
                                           ("Claimant", "the other party"), ("Excess to collect", "0.00")])
        self.assert_facts(out, "Vehicle", [("Modifications", "Tow bar"), ("Rack",)])

    def test_a_quote_is_a_page(self):
        """show: a quote by subject, in words, with what it comes to"""
        done = run("show", self.QUOTE)
        self.assertEqual((FINE, ""), (done.status, done.errors))
        self.assertRegex(done.out, r"(?m)^Quote no +Q004711$")
        self.assertEqual(["Message", "Insurer", "Repairer", "Claim", "Customer", "Vehicle", "Quote", "Hourly rates",
                          "Items", "Items by kind", "Totals"], re.findall(r"(?m)^\n(\w+(?: \w+)*)$", done.out))
        self.assert_facts(done.out, "Message", [
            ("From", "REP, Workshop Desk 3.2.1"), ("Sent", "2008-03-05 10:40:12"), ("To", "INS"),
            ("Language version", "2.1"), ("Quote date", "2008-03-05"), ("Images", "1")])
        self.assert_facts(done.out, "Quote", [
            ("Kind", "Assessing (A)"), ("Quoted by", "D. Halloran"), ("Repair begins", "2008-03-10"),
            ("Repair ends", "2008-03-15"), ("Excess to collect", "500.00"),
            ("Remarks", "Radiator support to be checked once the bumper is off")])
        self.assertRegex(done.out, r"(?m)^  Odometer +56409 km$")
        self.assert_facts(done.out, "Totals", [("Without tax", "2100.65"), ("Tax", "210.07"), ("Tax rate", "10.00"),
                                               ("With tax", "2310.72")])

    def test_the_items_of_a_quote_are_a_table(self):
        """show: an item a line, with hours and rate or the amount of its kind; empty columns are left out"""
        out = run("show", self.QUOTE).out
        title, *rows = re.search(r"(?m)^Items\n((?:.+\n)+)", out).group(1).splitlines()
        self.assertEqual(["No", "Code", "Description", "Kind", "Hours", "Rate", "Amount", "Value"], title.split())
        self.assertEqual(8, len(rows))
        self.assertRegex(rows[1], r"^ 2  1022  Repair left front guard +Repair +4\.00 +85\.00 +340\.00$")
        self.assertRegex(rows[4], r"^ 5  3150  Headlamp, left +Part +412\.75 +412\.75$")
        self.assert_no_line_is_wider(out, 80)
        wide = run_at_terminal("show", self.QUOTE, columns=160, NO_COLOR="1").out
        self.assertRegex(wide, r"(?m)^ 5 .*412\.75  1 pc, Left, OEM BR-81150-204$")
        self.assertRegex(wide, r"(?m)^ 6 .*385\.00  Glass, Upper Tarrago Glass$")
        self.assertRegex(wide, r"(?m)^ 2 .*340\.00 +Crease along the swage line$")

    def test_the_items_of_a_quote_are_summed_by_kind(self):
        """show: items, hours and value of each kind that there is, and of all"""
        self.assert_facts(run("show", self.QUOTE).out, "Items by kind", [
            ("Remove, replace", "1 item, 2.50 hours, 212.50"), ("Repair", "1 item, 4.00 hours, 340.00"),
            ("Paint labour", "1 item, 3.50 hours, 315.00"), ("Paint materials", "1 item, 186.40"),
            ("Part", "1 item, 412.75"), ("Miscellaneous", "1 item, 385.00"),
            ("Mechanical", "1 item, 0.80 hours, 84.00"), ("Towing", "1 item, 165.00"),
            ("All", "8 items, 10.80 hours, 2100.65")])

    def test_a_quote_without_items_has_no_table(self):
        """show: a quote without items"""
        self.assertNotIn("\nItems", run("show", str(SAMPLES / "quote-no-items.xml")).out)

    def test_an_item_of_two_kinds_is_told(self):
        """show: an item of more than one kind"""
        self.assertIn("has more than one kind: the last one counts",
                      run("show", str(SAMPLES / "quote-item-of-two-kinds.xml")).out)

    def test_a_status_is_told_in_words(self):
        """show: a status in words with its code, and why; an unknown one as it is"""
        path = self.write("x.xml", "<Xalo_Quote><VarnexStatus><Status>awh</Status><Reason>No photos</Reason>"
                                   "</VarnexStatus></Xalo_Quote>")
        out = run("show", path).out
        self.assertRegex(out, r"(?m)^Status +Authority Withheld \(awh\)$")
        self.assertRegex(out, r"(?m)^  Reason of status +No photos$")
        self.assertRegex(run("show", str(SAMPLES / "quote-status-quoted.xml")).out, r"(?m)^Status +QR$")

    def test_an_inspection_is_told(self):
        """show: the reason of an inspection, although no class reads it back"""
        self.assertRegex(run("show", str(SAMPLES / "job-4822-2-quote-inspection.xml")).out,
                         r"(?m)^  Inspection for +\S+")

    def test_a_value_that_a_quote_cannot_read_is_a_finding(self):
        """show: a date or an image count that the quote's class cannot read; status 1"""
        for element, error in (("QuoteDate", "'soon' is not a date (13)"), ("ImageCount", "'soon' is not a number (13)")):
            path = self.write("x.xml", f"<Xalo_Quote><{element}>soon</{element}><Vehicle/></Xalo_Quote>")
            done = run("show", path)
            self.assertEqual(FINDINGS, done.status)
            self.assertIn(f"Xalo_Quote.ParseXML: {element}: {error}", done.out)
            shown, = json_lines("show", path)
            self.assertEqual(("soon", 13), (shown[element], shown["error"]["number"]))

    def test_an_absent_section_is_not_shown(self):
        """show: a section that the message does not have is not shown"""
        self.assertNotIn("\nVehicle\n", run("show", str(SAMPLES / "job-cancelled.xml")).out)

    def test_a_section_that_its_class_cannot_read_is_a_finding(self):
        """show: what keeps a class from reading its section is told, with what was read before; status 1"""
        path = self.write("x.xml", "<Xalo_TotalLoss><Source><OrgType>REP</OrgType></Source>"
                                   "<Vehicle><Make>Brolga</Make></Vehicle></Xalo_TotalLoss>")
        done = run("show", path)
        self.assertEqual((FINDINGS, ""), (done.status, done.errors))
        self.assertRegex(done.out, r"(?m)^  OrgType +REP$")
        self.assertIn("SourceDef.ParseXML: the element Source/AppVersion is missing (91)", done.out)
        self.assertRegex(done.out, r"(?m)^  Make +Brolga$")
        self.assertEqual({"number": 91, "source": "SourceDef.ParseXML",
                          "reason": "the element Source/AppVersion is missing"},
                         json_lines("show", path)[0]["sections"]["Source"]["error"])
        page = run("show", self.write("x.xml", "<Xalo_Quote><Totals><GrandTotalExTax>5</GrandTotalExTax><TaxRate>x"
                                               "</TaxRate></Totals></Xalo_Quote>"))
        self.assertEqual(FINDINGS, page.status)
        self.assertRegex(page.out, r"(?m)^  Without tax +5\.00$")
        self.assertIn("TotalsDef.ParseXML: TaxRate: 'x' is not a number (13)", page.out)

    def test_a_broken_file_shows_the_line_and_a_caret_under_the_column(self):
        """show: a broken file shows reason, line and a caret under the column"""
        path = self.write("x.xml", "<a>\r\n\té日本<b></c></a>")
        done = run("show", path)
        self.assertEqual((FINDINGS, ""), (done.status, done.errors))
        self.assertIn("x.xml:2:10: The end tag 'c' does not match", done.out.replace("\n    ", " "))
        self.assertTrue(done.out.endswith("\n\n2 |  é日本<b></c></a>\n  | " + 11 * " " + "^\n"), done.out)

    def test_the_caret_stands_under_the_place_in_every_broken_sample(self):
        """show: in every broken sample the caret stands under the character of the true column"""
        for name, (line, column) in BROKEN.items():
            done = run("show", str(SAMPLES / name))
            source, caret = done.out.splitlines()[-2:]
            written = (SAMPLES / name).read_bytes().decode("utf-8", "replace").splitlines()
            before = (written[line - 1] if written else "")[:column - 1]
            self.assertTrue(source.startswith(f"{line} |"), source)
            self.assertEqual(len(f"{line} | ") + display_width(before), caret.index("^"), name)
            self.assert_no_line_is_wider(done.out, 80)

    def test_a_long_line_is_cut_around_the_place(self):
        """show: of a long line the part around the place is shown, in any encoding"""
        for encoding in ("utf-8", "utf-16"):
            path = self.write("x.xml", ("<a>" + "日本語" * 500 + "</b>" + "x" * 500).encode(encoding))
            out = run("show", path).out
            source, caret = out.splitlines()[-2:]
            self.assert_no_line_is_wider(out, 80)
            before = source[:source.index("b>")]
            self.assertTrue(before.endswith("語</"))
            self.assertEqual(display_width(before), caret.index("^"))

    def test_json_has_summary_and_sections(self):
        """show --json: one object with the summary and the sections"""
        shown, = json_lines("show", self.QUOTE)
        self.assertEqual("Q004711", shown["QuoteNo"])
        self.assertEqual("Ridge", shown["sections"]["Vehicle"]["ModelID"])
        self.assertEqual("Abernathy", shown["sections"]["Customer"]["PersonalName"]["Surname"])
        self.assertEqual(["Suburb", "Phone"], shown["sections"]["Repairer"]["RepairerDetails"]["Fields"])
        items = shown["sections"]["QuoteItems"]["QuoteItems"]
        self.assertEqual("BR-81150-204", items[4]["Part"]["PartSource"]["PartNumber"])
        self.assertEqual((8, 2100.65), (len(items), shown["sections"]["Totals"]["GrandTotalExTax"]))
        self.assertEqual(("2008-03-05", "1"), (shown["QuoteDate"], shown["ImageCount"]))
        request, = json_lines("show", self.REQUEST)
        self.assertEqual(4, request["sections"]["RequestDetails"]["DamagedAreas"]["Count"])
        self.assertEqual("Insured", request["sections"]["RequestDetails"]["ClaimantType"]["ClaimantType"])

    def test_json_of_a_broken_file_has_its_true_place(self):
        """show --json: each broken sample has its true line and column; status 1"""
        for name, place in BROKEN.items():
            done = run("show", "--json", str(SAMPLES / name))
            error = json.loads(done.out)["error"]
            self.assertEqual((FINDINGS, place), (done.status, (error["line"], error["column"])), name)

    def test_a_missing_file_cannot_be_shown(self):
        """show: a missing file ends with status 2 and a message on the error stream"""
        path = str(self.folder / "none.xml")
        self.assertEqual(Result(COULD_NOT_RUN, "", f"varnex3: '{path}': file not found (error 53)\n"),
                         run("show", path))

    def test_a_long_value_is_wrapped(self):
        """show: a long value goes on below itself, no line is too wide or ends with a blank"""
        path = self.write("x.xml", message("word " * 40 + "x" * 200))
        for columns in (20, 40, 80):
            out = run_at_terminal("show", path, columns=columns, NO_COLOR="1").out
            self.assert_no_line_is_wider(out, columns)
            self.assert_no_blanks_end_a_line(out)
            self.assertEqual(40, len(re.findall("word", out)))  # the name of the customer


class TerminalTest(ToolTest):
    ESCAPE = "\x1b"

    def test_colours_at_a_terminal_only(self):
        """Colours are used when the output is a terminal, and then only"""
        for arguments in (("scan", str(SAMPLES)), ("show", str(SAMPLES / "declined.xml")),
                          ("identify", str(SAMPLES / "declined.xml"))):
            self.assertIn(self.ESCAPE + "[1m", run_at_terminal(*arguments, streams=("out",)).out)
            self.assertNotIn(self.ESCAPE, run(*arguments).out)
            self.assertNotIn(self.ESCAPE, run_at_terminal(*arguments, streams=("errors",)).out)

    def test_no_colour_when_it_is_refused(self):
        """NO_COLOR keeps colours away, and so does a terminal that has none"""
        for refusal in ({"NO_COLOR": "1"}, {"TERM": "dumb"}):
            self.assertNotIn(self.ESCAPE, run_at_terminal("scan", str(SAMPLES), streams=("out",), **refusal).out)

    def test_json_has_no_colours(self):
        """JSON has no colours, at a terminal either"""
        out = run_at_terminal("scan", "--json", str(SAMPLES)).out
        self.assertNotIn(self.ESCAPE, out)
        self.assertEqual(71, len([json.loads(line) for line in out.splitlines()]))

    def test_colours_take_no_room(self):
        """The lines at a terminal are those without one, but for the colours"""
        coloured = run_at_terminal("scan", str(SAMPLES), streams=("out",)).out
        self.assertEqual(run("scan", str(SAMPLES)).out, re.sub(r"\x1b\[\d*m", "", coloured))

    def scan_that_must_wait(self, errors):
        """Scans with a reader that lets the program wait: the pipe holds less than there is to write."""
        with subprocess.Popen([PROGRAM, "scan", "--json", str(SAMPLES)], stdin=subprocess.DEVNULL,
                              stdout=subprocess.PIPE, stderr=errors, env=environment()) as scan:
            time.sleep(0.6)
            out, written = scan.communicate(timeout=60)
        self.assertGreater(len(out), 2 * 65536)
        return written

    def test_a_long_scan_shows_its_progress_on_the_error_terminal(self):
        """A long scan shows a progress bar on the error stream if that is a terminal, and takes it away at the end"""
        for columns in (30, 80, 200):
            terminal = PseudoTerminal(columns)
            self.scan_that_must_wait(terminal.theirs)
            written = terminal.text()
            self.assertRegex(written, r"^\r\x1b\[K\[#+\.+\] \d+ of 71 files")
            self.assertTrue(written.endswith("files\r\x1b[K"), repr(written))
            for drawn in written.split("\r\x1b[K"):
                self.assertLess(len(drawn), columns)

    def test_no_progress_among_the_lines_of_json(self):
        """A long scan that writes JSON to the terminal shows no progress bar there"""
        terminal = PseudoTerminal(delay=0.6)
        subprocess.run([PROGRAM, "scan", "--json", str(SAMPLES)], stdin=subprocess.DEVNULL, stdout=terminal.theirs,
                       stderr=terminal.theirs, env=environment(), timeout=60, check=False)
        self.assertEqual(71, len([json.loads(line) for line in terminal.text().splitlines()]))

    def test_no_progress_without_a_terminal(self):
        """A long scan shows nothing on an error stream that is no terminal"""
        self.assertEqual(b"", self.scan_that_must_wait(subprocess.PIPE))

    def test_no_progress_in_a_short_scan(self):
        """A short scan writes nothing to the error stream"""
        self.assertEqual("", run_at_terminal("scan", str(SAMPLES)).errors)

    def test_no_control_character_of_a_value_reaches_the_terminal(self):
        """Control characters in values and names are escaped, in the table, in the tree and in JSON"""
        self.write("evil\x1b[2Jname.xml", message("A&#x9;&#xD;&#xA;&#x7F;&#x9B;31m\u202eB\u2028"))
        self.write("broken.xml", "<a>\u0090\x1b[31m</a>")
        paths = [str(self.folder / name) for name in ("evil\x1b[2Jname.xml", "broken.xml")]
        for arguments in (["scan", str(self.folder)], ["show", paths[0]], ["show", paths[1]], ["identify", *paths],
                          ["show", "none\x1b[2J"], ["scan", "none\x1b[2J"], ["scan", "--\x1b[2J"]):
            for form in ([], ["--json"]):
                done = run_at_terminal(*arguments, *form, columns=200, NO_COLOR="1")
                self.assertNotRegex(done.out + done.errors, "[^\n -~\u00a0-\u2027\u2030-\u2065\u2070-\uffff]")
        self.assertIn(r"A\t\r\n\u{7F}\u{9B}31m\u{202E}B\u{2028}", run("show", paths[0]).out)
        self.assertEqual("A\t\r\n\x7f\x9b31m\u202eB\u2028", json_lines("show", paths[0])[0]["Customer"])


class ProgramTest(ToolTest):
    def test_help_of_each_command_has_examples(self):
        """--help: every command has one with examples, no line wider than 80 columns, status 0"""
        for command in ("scan", "identify", "show"):
            done = run(command, "--help")
            self.assertEqual((FINE, ""), (done.status, done.errors))
            self.assertIn(f"Examples:\n  varnex3 {command} ", done.out)
            self.assertIn("--json", done.out)
            self.assert_no_line_is_wider(done.out, 80)
            self.assertIn(f"\n  {command} ", run("--help").out)

    def test_version(self):
        """--version: name and version, the same as the manual's"""
        done = run("--version")
        self.assertRegex(done.out, r"^varnex3 \d+\.\d+\.\d+\n$")
        manual = (SOURCE / "tools" / "varnex3.1").read_text()
        self.assertIn(f'"{done.out.strip()}"', manual.splitlines()[0])

    def test_wrong_arguments_end_with_two(self):
        """Wrong arguments end with status 2 and a message on the error stream"""
        for arguments in ((), ("bogus",), ("scan",), ("scan", "a", "b"), ("show",), ("show", "a", "b"),
                          ("scan", "--bogus", "."), ("identify", "--sort", "name", "x")):
            done = run(*arguments)
            self.assertEqual((COULD_NOT_RUN, ""), (done.status, done.out), arguments)
            self.assertTrue(done.errors.startswith("varnex3: "), done.errors)

    def test_a_file_name_may_start_with_a_hyphen(self):
        """A file whose name starts with a hyphen is given behind two hyphens"""
        self.write("-x.xml", message())
        done = subprocess.run([PROGRAM, "show", "--", "-x.xml"], cwd=self.folder, capture_output=True, check=False)
        self.assertEqual((FINE, b""), (done.returncode, done.stderr))

    def test_the_locale_of_the_host_plays_no_part(self):
        """The output is the same in every locale"""
        self.assertEqual(run("scan", str(SAMPLES)), run("scan", str(SAMPLES), LC_ALL="C"))

    @unittest.skipUnless(shutil.which("man"), "there is no man to check the manual with")
    def test_the_manual_has_no_faults(self):
        """The manual page is formatted without a warning and names every option"""
        done = subprocess.run(["man", "--warnings", "-l", str(SOURCE / "tools" / "varnex3.1")], capture_output=True,
                              env=environment(LC_ALL="C.UTF-8", MANWIDTH="80"), check=False)
        self.assertEqual((0, b""), (done.returncode, done.stderr))
        for option in set(re.findall(r"--[a-z]+", "".join(run(c, "--help").out for c in ("scan", "identify", "show")))):
            self.assertIn(option.encode(), done.stdout)


if __name__ == "__main__":
    sys.exit(unittest.main(verbosity=2))
