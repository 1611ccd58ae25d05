#!/usr/bin/env python3
"""That a real MariaDB answers as the TDS server does: with the sample's reference sets and the same procedures."""

from __future__ import annotations

import pathlib
import subprocess
import tempfile
import unittest
from typing import List, Optional

import odbc
from servers import HERE, MariaDB, register_drivers
from tds_procedures import DIFFICULT, REFERENCE_SETS


def setUpModule() -> None:
    drivers = tempfile.TemporaryDirectory(prefix="varnex3-drivers-")
    unittest.addModuleCleanup(drivers.cleanup)
    register_drivers(pathlib.Path(drivers.name))


class OnMariaDB(unittest.TestCase):
    server: MariaDB

    @classmethod
    def setUpClass(cls) -> None:
        cls.server = MariaDB()
        cls.addClassCleanup(cls.server.stop)

    def call(self, name: str, *texts: Optional[str]) -> odbc.Outcome:
        facts = self.server.facts
        where = f"Driver={{MariaDB}};Server=127.0.0.1;Port={facts['port']};Database={facts['database']};"
        with odbc.Connection(where + f"Uid={facts['user']};Pwd={facts['password']};") as connection:
            parameters = odbc.given(*texts) + odbc.standard_outputs()
            return connection.call(name, parameters, has_status=False)

    def rows(self, name: str, *texts: Optional[str]) -> List[List[Optional[str]]]:
        return self.call(name, *texts).row_sets[0].rows

    def test_the_reference_sets_are_the_same(self) -> None:
        for name, rows in REFERENCE_SETS.items():
            found = self.call("getVarnexReferenceSet", name, "").row_sets
            self.assertEqual(found[0], odbc.RowSet(["Code", "Description"], [list(row) for row in rows]))
            self.assertEqual(found[1], odbc.RowSet(["@ID", "@ErrNo", "@ErrMsg"], [["0", "0", None]]))
        self.assertEqual(self.rows("getVarnexReferenceSet", "repairmodeltype", "cp"), [["CP", "Allocated"]])
        self.assertEqual(self.rows("getVarnexReferenceSet", "NOSUCHSET", ""), [])

    def test_outputs_without_a_row_set_are_a_row_set_of_their_own(self) -> None:
        expected = [odbc.RowSet(["@ID", "@ErrNo", "@ErrMsg"], [["42", "-5", "The job is locked by O'Brien."]])]
        self.assertEqual(self.call("noRowSetFails").row_sets, expected)

    def test_values_and_texts_are_the_same(self) -> None:
        self.assertEqual(self.rows("takeNumberAndText", "12", "AB"), [["@Number", "12"], ["@Text", "AB"]])
        self.assertEqual(self.rows("rowSetDifficult"), [list(row) for row in DIFFICULT])
        self.assertEqual(len(self.rows("manyRows", "5000")), 5000)

    def test_an_error_of_the_procedure_is_one_of_the_driver(self) -> None:
        with self.assertRaisesRegex(odbc.OdbcError, "No such set."):
            self.call("errorOnly")

    def test_the_sample_may_be_loaded_twice(self) -> None:
        facts = self.server.facts
        command = ["mariadb", "--no-defaults", f"--socket={facts['socket']}", "--user=sa", "--password=x", "CrvSql"]
        sample = HERE.parent.parent / "samples/database/mariadb.sql"
        subprocess.run(command, input=sample.read_bytes(), check=True, timeout=30)
        expected = [list(row) for row in REFERENCE_SETS["REPAIRMODELTYPE"]]
        self.assertEqual(self.rows("getVarnexReferenceSet", "REPAIRMODELTYPE", ""), expected)

    def test_it_ends_with_sigterm_and_leaves_nothing(self) -> None:
        server = MariaDB()
        folder = pathlib.Path(server.facts["socket"]).parent
        self.assertTrue(folder.is_dir())
        server.stop()
        self.assertFalse(folder.exists())


if __name__ == "__main__":
    unittest.main()
