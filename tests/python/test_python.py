#!/usr/bin/env python3
"""What the Python package adds to the rules that run on every face."""

from __future__ import annotations

import gc
import inspect
import json
import os
import pathlib
import pickle
import subprocess
import sys
import tempfile
import unittest
from datetime import date, datetime, timedelta, timezone

import varnex3

SAMPLES = pathlib.Path(os.environ["VARNEX3_SAMPLES"])


class Records(unittest.TestCase):
    def test_a_record_written_and_read_again_is_the_same(self) -> None:
        source = varnex3.SourceDef()
        source.OrgType, source.AppVersion, source.AppName = "REP", "1.2", "Werkstatt Müller \U0001f697"
        source.TimeStamp = datetime(2004, 3, 15, 14, 5, 9)
        again = varnex3.SourceDef()
        self.assertIsNone(again.ParseXML(source.Serialise()))
        self.assertEqual(json.loads(again.ToJson()), json.loads(source.ToJson()))

    def test_a_child_is_one_object_however_often_it_is_read(self) -> None:
        customer = varnex3.CustomerDef()
        self.assertEqual(customer.PersonalName, customer.PersonalName)
        self.assertEqual(hash(customer.PersonalName), hash(customer.PersonalName))
        self.assertNotEqual(customer.PersonalName, varnex3.PersonalNameDef())

    def test_a_child_outlives_its_parent(self) -> None:
        name = varnex3.CustomerDef().PersonalName
        gc.collect()
        name.Surname = "Smith"
        self.assertEqual(name.FullName, "Smith")

    def test_none_sets_a_child_to_nothing_and_the_next_read_makes_a_new_one(self) -> None:
        customer = varnex3.CustomerDef()
        customer.PersonalName.Title = "Dr"
        customer.PersonalName = None
        self.assertEqual(customer.PersonalName.Title, "")

    def test_an_unknown_attribute_is_no_silent_store(self) -> None:
        with self.assertRaises(AttributeError):
            varnex3.VehicleDef().RegistrationNumber = "ABC123"

    def test_a_read_only_property_cannot_be_stored(self) -> None:
        with self.assertRaises(AttributeError):
            varnex3.VersionDef().DLLVersion = "9.9"

    def test_the_representation_of_a_record_shows_its_values(self) -> None:
        self.assertEqual(repr(varnex3.DestinationDef()), '<varnex3.DestinationDef {"OrgType":""}>')

    def test_a_text_keeps_nul_characters_and_lone_surrogates(self) -> None:
        vehicle = varnex3.VehicleDef()
        for text in ("a\0b", "\udc80", "\U0001f697", ""):
            vehicle.VIN = text
            self.assertEqual(vehicle.VIN, text)

    def test_a_name_that_is_no_member_is_named_by_put(self) -> None:
        with self.assertRaises(varnex3.Error) as raised:
            varnex3.VehicleDef().put("Wheels", 4)
        self.assertEqual((raised.exception.number, raised.exception.source), (438, "VehicleDef.Wheels"))

    def test_put_without_a_value_is_a_type_error(self) -> None:
        with self.assertRaises(TypeError):
            varnex3.VehicleDef().put("VIN")


class Values(unittest.TestCase):
    def test_a_date_comes_back_to_the_millisecond(self) -> None:
        source = varnex3.SourceDef()
        moments = (
            datetime(2004, 3, 15, 14, 5, 9),
            datetime(1899, 12, 29, 6, 0),
            datetime(100, 1, 1),
            datetime(9999, 12, 31, 23, 59, 59),
            datetime(2026, 2, 28, 0, 0, 0, 1000),
        )
        for moment in moments:
            source.TimeStamp = moment
            self.assertEqual(source.TimeStamp, moment)

    def test_a_day_is_its_midnight(self) -> None:
        source = varnex3.SourceDef()
        source.TimeStamp = date(2004, 3, 15)
        self.assertEqual(source.TimeStamp, datetime(2004, 3, 15))

    def test_a_date_with_a_time_zone_is_refused(self) -> None:
        with self.assertRaisesRegex(ValueError, "no time zone"):
            varnex3.SourceDef().TimeStamp = datetime(2004, 3, 15, tzinfo=timezone(timedelta(hours=10)))

    def test_an_enumeration_is_an_int_enum_and_another_number_stays_a_number(self) -> None:
        customer = varnex3.CustomerDef()
        self.assertIs(customer.CustomerType, varnex3.CustomerTypeEnum.Personal)
        customer.CustomerType = 7
        self.assertEqual(customer.CustomerType, 7)
        self.assertNotIsInstance(customer.CustomerType, varnex3.CustomerTypeEnum)

    def test_a_number_outside_32_bits_overflows(self) -> None:
        with self.assertRaises(varnex3.Error) as raised:
            varnex3.ClaimHeaderDef().ReinstatementNo = 2**31
        self.assertEqual((raised.exception.number, raised.exception.source), (6, "ClaimHeaderDef.ReinstatementNo"))

    def test_none_is_no_text(self) -> None:
        with self.assertRaises(varnex3.Error) as raised:
            varnex3.VehicleDef().VIN = None
        self.assertEqual(raised.exception.number, 13)


class Calls(unittest.TestCase):
    def test_arguments_may_be_named(self) -> None:
        details = varnex3.InsurerDetailDef()
        details.Add(sValue="03 9555 0100", sFieldName="Phone")
        self.assertEqual(details.Values("Phone"), "03 9555 0100")

    def test_an_indexed_property_is_stored_with_put(self) -> None:
        details = varnex3.InsurerDetailDef()
        details.Add("Phone", "1")
        details.put("Values", "Phone", "2")
        self.assertEqual(details.Values("Phone"), "2")

    def test_results_that_come_back_in_arguments_follow_the_result(self) -> None:
        self.assertEqual(
            varnex3.Xalo_Messages().ParseFiles("/no such folder"),
            (False, 30030, "Folder '/no such folder' does not exist."),
        )
        self.assertEqual(varnex3.SplitDateTime("2004-03-15"), (False, "2004-03-15", "", ""))

    def test_a_call_with_an_argument_too_many_is_a_type_error(self) -> None:
        with self.assertRaises(TypeError):
            varnex3.VersionDef().Serialise(1)

    def test_the_inbox_lists_what_the_folder_holds(self) -> None:
        messages = varnex3.Xalo_Messages()
        ok, number, words = messages.ParseFiles(str(SAMPLES))
        expected = sorted(path.name for path in SAMPLES.iterdir() if path.suffix.lower() == ".xml" and path.is_file())
        self.assertEqual((ok, number, words), (True, 0, ""))
        self.assertEqual(messages.Count, len(expected))
        first = messages.MessageItems(0)
        self.assertIsInstance(first.MessageTypeID, varnex3.XaloMessageTypeEnum)
        self.assertIsNone(messages.MessageItems(messages.Count))

    def test_a_file_name_that_is_not_unicode_keeps_its_bytes(self) -> None:
        with tempfile.TemporaryDirectory() as folder:
            pathlib.Path(os.fsdecode(os.path.join(os.fsencode(folder), b"caf\xe9.xml"))).write_bytes(b"<Foo/>")
            messages = varnex3.Xalo_Messages()
            self.assertTrue(messages.ParseFiles(folder)[0])
            self.assertEqual(os.fsencode(messages.MessageItems(0).FileName), b"caf\xe9.xml")


class Errors(unittest.TestCase):
    def test_an_error_has_number_source_and_description(self) -> None:
        with self.assertRaises(varnex3.Error) as raised:
            varnex3.DestinationDef().ParseXML("<Destination/>")
        error = raised.exception
        self.assertEqual((error.number, error.source), (91, "DestinationDef.ParseXML"))
        self.assertIn("Destination/OrgType", error.description)
        self.assertEqual(str(error), f"{error.source}: {error.description} (91)")

    def test_an_error_can_be_pickled(self) -> None:
        error = pickle.loads(pickle.dumps(varnex3.Error(5, "a.b", "c")))
        self.assertEqual((error.number, error.source, error.description), (5, "a.b", "c"))


class Documentation(unittest.TestCase):
    def test_every_class_member_and_function_has_words(self) -> None:
        for info in varnex3.CLASSES.values():
            made = getattr(varnex3, info.name)
            self.assertTrue(made.__doc__, info.name)
            for member in info.members:
                self.assertTrue(inspect.getdoc(getattr(made, member.name)), f"{info.name}.{member.name}")

    def test_a_method_shows_its_parameters(self) -> None:
        self.assertEqual(
            str(inspect.signature(varnex3.Xalo_Messages.ParseFiles)), "(self, sFolderPath, ErrorNo=0, ErrorMessage='')"
        )

    @unittest.skipIf("LD_PRELOAD" in os.environ, "a sanitizer build makes no stubs")
    def test_the_stubs_know_every_member(self) -> None:
        stubs = pathlib.Path(varnex3.__file__).with_name("__init__.pyi").read_text(encoding="utf-8")
        compile(stubs, "__init__.pyi", "exec")
        for info in varnex3.CLASSES.values():
            for member in info.members:
                self.assertIn(f"def {member.name}(", stubs)

    @unittest.skipIf("LD_PRELOAD" in os.environ, "a sanitizer build makes no stubs")
    def test_a_type_checker_knows_the_types_of_properties_and_results(self) -> None:
        program = """
import varnex3
messages = varnex3.Xalo_Messages()
ok, number, words = messages.ParseFiles("inbox")
reveal_type((ok, number, words, messages.MessageItems(0), varnex3.CustomerDef().PersonalName.Surname))
varnex3.VehicleDef().VIN = 12
"""
        with tempfile.TemporaryDirectory() as folder:
            file = pathlib.Path(folder, "host.py")
            file.write_text(program)
            checked = subprocess.run(
                ["/usr/bin/mypy", "--strict", "--no-incremental", file],
                env=os.environ | {"MYPYPATH": str(pathlib.Path(varnex3.__file__).parent.parent)},
                capture_output=True,
                text=True,
                check=False,
            ).stdout
        self.assertIn("Tuple[builtins.bool, builtins.int, builtins.str, Union[varnex3.MessageDef, None], builtins.str]", checked)
        self.assertIn('expression has type "int", variable has type "str"', checked)
        self.assertIn("Found 1 error", checked)

    def test_the_package_loads_in_a_fresh_interpreter(self) -> None:
        done = subprocess.run(
            [sys.executable, "-c", "import varnex3; print(varnex3.__version__)"], capture_output=True, text=True, check=True
        )
        self.assertEqual(done.stdout.strip(), varnex3.__version__)


if __name__ == "__main__":
    unittest.main()
