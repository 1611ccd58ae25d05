#!/usr/bin/env python3
"""The samples for C++ and Python, run; those for C#, compiled. All samples of one name print the same.

VARNEX3_SOURCE_DIR and VARNEX3_BINARY_DIR are the source and the build folder.
"""

from __future__ import annotations

import os
import pathlib
import shutil
import subprocess
import sys
import tempfile
import unittest
from xml.etree import ElementTree

SOURCE = pathlib.Path(os.environ["VARNEX3_SOURCE_DIR"])
BINARY = pathlib.Path(os.environ["VARNEX3_BINARY_DIR"])
EXPECTED_JOB = sorted((SOURCE / "tests/dist/expected/repair_job").glob("*.xml"))


def run(*command: object) -> str:
    done = subprocess.run([str(word) for word in command], cwd=SOURCE, capture_output=True, text=True, check=False)
    return done.stdout + done.stderr


class Samples(unittest.TestCase):
    def setUp(self) -> None:
        self.folder = pathlib.Path(tempfile.mkdtemp())
        self.addCleanup(shutil.rmtree, self.folder)

    def check(self, sample: str, printed: str) -> None:
        self.assertEqual(printed, (SOURCE / f"tests/dist/expected/{sample}.txt").read_text())

    def check_files(self, folder: str, expected: str) -> None:
        """Every file of one folder is in the other, with the same bytes."""
        written, wanted = ({file.name: file.read_bytes() for file in place.iterdir()}
                           for place in (self.folder / folder, SOURCE / "tests/dist/expected" / expected))
        self.assertEqual(written, wanted)

    def compile(self, sample: str) -> pathlib.Path:
        words = ["-std=c++20", "-Wall", "-Wextra", "-Werror", "-I", SOURCE, f"samples/cpp/{sample}.cpp"]
        program = self.folder / sample
        self.assertEqual(run("g++", *words, BINARY / "varnex3/libvarnex3.a", "-o", program), "")
        return program

    def test_the_python_samples_print_what_they_should(self) -> None:
        for sample in ("inbox", "record"):
            with self.subTest(sample):
                self.check(sample, run(sys.executable, "-B", SOURCE / f"samples/python/{sample}.py"))

    def test_the_cpp_samples_print_what_they_should(self) -> None:
        for sample in ("inbox", "record"):
            with self.subTest(sample):
                self.check(sample, run(self.compile(sample)))

    def check_answer(self, *sample: object) -> None:
        """The answer to a request: what is printed, and the quote to the byte."""
        (self.folder / "answer").mkdir()
        request, quote = SOURCE / "samples/messages/request.xml", self.folder / "answer/quote.xml"
        self.check("answer_request", run(*sample, request, quote))
        self.check_files("answer", "answer_request")

    def test_the_cpp_sample_answers_a_request(self) -> None:
        program = self.compile("answer_request")
        self.check_answer(program)
        self.assertIn("file", run(program, self.folder / "none.xml", self.folder / "quote.xml"))
        self.assertFalse((self.folder / "quote.xml").exists())

    def test_the_python_sample_answers_a_request(self) -> None:
        self.check_answer(sys.executable, "-B", SOURCE / "samples/python/answer_request.py")

    def check_job(self, *sample: object) -> None:
        """A whole repair job: its summary, and the repairer's messages to the byte."""
        (self.folder / "outbox").mkdir()
        self.check("repair_job", run(*sample, "samples/messages", self.folder / "outbox"))
        self.check_files("outbox", "repair_job")

    def test_the_cpp_sample_does_a_repair_job(self) -> None:
        self.check_job(self.compile("repair_job"))

    def test_the_python_sample_does_a_repair_job(self) -> None:
        self.check_job(sys.executable, "-B", SOURCE / "samples/python/repair_job.py")

    def test_the_messages_of_the_job_are_well_formed(self) -> None:
        self.assertEqual(len(EXPECTED_JOB), 4)
        for message in [*EXPECTED_JOB, *(SOURCE / "samples/messages").iterdir()]:
            with self.subTest(message.name):
                self.assertTrue(ElementTree.parse(message).getroot().tag.startswith("Xalo_"))

    def test_the_insurer_declines_the_invoice_that_was_sent(self) -> None:
        invoice = ElementTree.parse(SOURCE / "tests/dist/expected/repair_job/tax-invoice.xml").find("PaymentDetails")
        declined = ElementTree.parse(SOURCE / "samples/messages/payment-declined.xml").find("LastInvoiceDetails")
        sent = {child.tag: child.text for child in invoice}
        self.assertLessEqual({child.tag: child.text for child in declined}.items(), sent.items())

    @unittest.skipUnless(shutil.which("mcs"), "no compiler for C# is installed (scripts/setup samples)")
    def test_the_csharp_samples_compile(self) -> None:
        for sample in ("inbox", "record"):
            with self.subTest(sample):
                program = f"-out:{self.folder / sample}.exe"
                source = f"samples/windows/{sample}.cs"
                self.assertEqual(run("mcs", "-warn:4", "-warnaserror", "-r:Microsoft.CSharp.dll", program, source), "")

    def test_the_windows_samples_for_python_are_python(self) -> None:
        for sample in ("inbox", "record"):
            source = SOURCE / f"samples/windows/{sample}.py"
            compile(source.read_text(), str(source), "exec")


if __name__ == "__main__":
    unittest.main()
