#!/usr/bin/env python3
"""That the TDS server and the instance lookup can be believed: independent clients find what their table declares."""

from __future__ import annotations

import json
import os
import pathlib
import shutil
import signal
import socket
import subprocess
import sys
import tempfile
import time
import unittest
import unittest.mock
from typing import Any, Dict, List, Optional, Sequence

import odbc
import ssrp_server
from servers import HERE, PASSWORD, SsrpServer, TdsServer, register_drivers, wait_for
from tds_procedures import DIFFICULT, PROCEDURES, REFERENCE_SETS, TYPED_COLUMNS

BINARY = pathlib.Path(os.environ["VARNEX3_BINARY_DIR"])
BROWSER_PORT = 1434  # of UDP: drivers ask nowhere else
NEEDED = {"tsql": "freetds-bin", "node": "npm", "npm": "npm"}
REPAIR_MODELS: List[List[Optional[str]]] = [list(row) for row in REFERENCE_SETS["REPAIRMODELTYPE"]]
TAKERS = ("takeIntegers", "takeFractions", "takeMoments", "takeBit", "takeTexts", "takeOthers")
OUTPUTS = [["ID", "Int"], ["ErrNo", "Int"], ["ErrMsg", "VarChar"]]


def setUpModule() -> None:
    missing = {package for program, package in NEEDED.items() if shutil.which(program) is None}
    if missing:
        raise AssertionError(f"these Debian packages are missing: {' '.join(sorted(missing))}")
    drivers = tempfile.TemporaryDirectory(prefix="varnex3-drivers-")
    unittest.addModuleCleanup(drivers.cleanup)
    register_drivers(pathlib.Path(drivers.name))


class ServerTest(unittest.TestCase):
    server: TdsServer

    @classmethod
    def setUpClass(cls) -> None:
        cls.server = TdsServer()
        cls.addClassCleanup(cls.server.stop)


class Tsql(ServerTest):
    """The command-line client of FreeTDS."""

    def run_tsql(self, version: str, script: str, password: str = PASSWORD) -> str:
        command = ["tsql", "-H", "127.0.0.1", "-p", str(self.server.port), "-U", "sa", "-P", password]
        environment = {**os.environ, "TDSVER": version, "LC_ALL": "C.UTF-8"}
        done = subprocess.run(
            command, input=script, env=environment, capture_output=True, text=True, timeout=30, check=False
        )
        return done.stdout + done.stderr

    def test_every_version_of_the_protocol_gets_a_row_set(self) -> None:
        for version in ("7.1", "7.2", "7.3", "7.4"):
            with self.subTest(version):
                script = "exec getVarnexReferenceSet 'REPAIRMODELTYPE', '', 0, 0, ''\ngo\nexit\n"
                output = self.run_tsql(version, script)
                self.assertIn("Code\tDescription\nA\tAssessed\nCP\tAllocated\nT\tTendering\n(3 rows affected)", output)
                self.assertEqual(self.server.logged("login")[-1]["tds"], version)

    def test_a_batch_selects_literals_of_each_kind(self) -> None:
        output = self.run_tsql("7.3", "select 12 as Number, N'5 €' as Price, Quote = 'O''Brien'\ngo\nexit\n")
        self.assertIn("Number\tPrice\tQuote\n12\t5 €\tO'Brien\n(1 row affected)", output)

    def test_a_wrong_password_is_refused_and_not_logged(self) -> None:
        self.assertIn("Msg 18456", self.run_tsql("7.3", "exit\n", password="guess-me"))
        self.assertIs(self.server.logged("login")[-1]["password_right"], False)
        self.assertNotIn("guess-me", json.dumps(self.server.log()))

    def test_an_input_left_out_takes_its_default_or_is_error_201(self) -> None:
        output = self.run_tsql("7.3", "exec optionalInput 'given', default, 0, 0, ''\ngo\nexit\n")
        self.assertIn("@Required\tgiven\n@Optional\tnone\n", output)
        self.assertIn("Msg 201", self.run_tsql("7.3", "exec optionalInput default, 'x', 0, 0, ''\ngo\nexit\n"))

    def test_an_unknown_procedure_is_error_2812_and_bad_syntax_102(self) -> None:
        self.assertIn("Msg 2812", self.run_tsql("7.3", "exec noSuchProcedure 1\ngo\nexit\n"))
        self.assertIn("Msg 102", self.run_tsql("7.3", "drop everything\ngo\nexit\n"))


class SecondClient(ServerTest):
    """The client tedious, which shares no code with FreeTDS."""

    client: pathlib.Path

    @classmethod
    def setUpClass(cls) -> None:
        super().setUpClass()
        folder = BINARY / "tests" / "tedious"
        subprocess.run([sys.executable, HERE / "tedious" / "fetch", folder], check=True)
        cls.client = folder / "client.js"

    def run_client(self, calls: Sequence[Dict[str, Any]], version: str = "7_4", password: str = PASSWORD) -> Any:
        plan = {"port": self.server.port, "password": password, "version": version, "calls": calls}
        command = ["node", str(self.client)]
        done = subprocess.run(command, input=json.dumps(plan), capture_output=True, text=True, timeout=60, check=True)
        return json.loads(done.stdout)

    def call(self, name: str, *inputs: Sequence[object], version: str = "7_4") -> Any:
        return self.run_client([{"procedure": name, "inputs": inputs, "outputs": OUTPUTS}], version)["results"][0]

    def test_every_version_of_the_protocol_gets_the_reference_set(self) -> None:
        inputs = (["Name", "VarChar", "REPAIRMODELTYPE"], ["Filter", "VarChar", ""])
        for version in ("7_1", "7_2", "7_3_A", "7_3_B", "7_4"):
            with self.subTest(version):
                result = self.call("getVarnexReferenceSet", *inputs, version=version)
                self.assertEqual(result["sets"], [{"columns": ["Code", "Description"], "rows": REPAIR_MODELS}])
                self.assertEqual(result["outputs"], {"ID": 0, "ErrNo": 0, "ErrMsg": None})
                self.assertEqual((result["status"], result["error"]), (0, None))

    def test_a_value_and_a_null_of_every_type_are_read(self) -> None:
        values, nulls = self.call("rowSetOfTypes")["sets"][0]["rows"]
        self.assertEqual(
            values[:16],
            [255, -32768, -2147483648, str(2**62), True, 1.5, -0.1, -1234.56, 99.95]
            + ["2004-03-15T14:05:09.000Z", "2004-03-15T14:05:00.000Z", "1899-12-30T00:00:00.000Z"]
            + ["1970-01-01T14:05:09.120Z", "2004-03-15T14:05:09.123Z", "ab   ", "5 €"],
        )
        self.assertEqual(values[16:19], ["x" * 10_000, "\U0001f697 €", "\U0001f697" * 5000])
        self.assertEqual(values[19]["data"], [0, 255])
        self.assertEqual(values[20], "00112233-4455-6677-8899-AABBCCDDEEFF")
        self.assertEqual(nulls, [None] * len(TYPED_COLUMNS))

    def test_difficult_texts_are_read(self) -> None:
        self.assertEqual(self.call("rowSetDifficult")["sets"][0]["rows"], [list(row) for row in DIFFICULT])

    def test_errors_and_two_row_sets_are_read(self) -> None:
        self.assertEqual(self.call("errorAfterRows")["error"], {"number": 50000, "message": "After the rows."})
        self.assertEqual(len(self.call("errorAfterRows")["sets"]), 1)
        row_sets = [row_set["rows"] for row_set in self.call("twoRowSets")["sets"]]
        self.assertEqual(row_sets, [[["A", "Assessed"]], [["T", "Tendering"]]])
        self.assertEqual(self.call("noRowSetReturnsStatus")["status"], -6)

    def test_thousands_of_rows_are_read(self) -> None:
        rows = self.call("manyRows", ["Count", "Int", 5000])["sets"][0]["rows"]
        self.assertEqual((len(rows), rows[-1]), (5000, ["C4999", "Description 4999"]))

    def test_the_log_holds_what_this_client_sent(self) -> None:
        self.call("takeNumberAndText", ["Number", "Int", 7], ["Text", "VarChar", "A€"])
        number, text = self.server.last_call()["parameters"][:2]
        self.assertEqual([number[k] for k in ("name", "type", "size", "value")], ["@Number", "int", 4, 7])
        self.assertEqual([text[k] for k in ("name", "type", "null", "value")], ["@Text", "varchar", False, "A€"])

    def test_a_wrong_password_is_refused(self) -> None:
        self.assertEqual(self.run_client([], password="y")["error"]["message"], "Login failed for user 'sa'.")


class Driver(ServerTest):
    """The driver manager and the driver that the library uses."""

    def connect(self, driver: str = "SQL Native Client") -> odbc.Connection:
        server = f"Driver={{{driver}}};Server=127.0.0.1;Port={self.server.port};Database=CrvSql;"
        return odbc.Connection(server + f"Uid=sa;Pwd={PASSWORD};TDS_Version=7.3;ClientCharset=UTF-8;")

    def call(self, name: str, *texts: Optional[str], timeout: int = 0) -> odbc.Outcome:
        with self.connect() as connection:
            return connection.call(name, odbc.given(*texts) + odbc.standard_outputs(), timeout)

    def rows(self, name: str, *texts: Optional[str]) -> List[List[Optional[str]]]:
        return self.call(name, *texts).row_sets[0].rows

    def outputs(self, name: str) -> List[Optional[str]]:
        outcome = self.call(name)
        self.assertEqual(outcome.row_sets, [])
        return outcome.outputs

    def test_both_driver_names_get_rows_and_outputs_and_status(self) -> None:
        for name in ("SQL Server", "SQL Native Client"):
            with self.subTest(name), self.connect(name) as connection:
                parameters = odbc.given("REPAIRMODELTYPE", "") + odbc.standard_outputs()
                outcome = connection.call("getVarnexReferenceSet", parameters)
                self.assertEqual(outcome.row_sets, [odbc.RowSet(["Code", "Description"], REPAIR_MODELS)])
                self.assertEqual((outcome.status, outcome.outputs), (0, ["0", "0", None]))

    def test_a_filter_leaves_the_row_with_that_code(self) -> None:
        self.assertEqual(self.rows("getVarnexReferenceSet", "repairmodeltype", "cp"), [["CP", "Allocated"]])
        self.assertEqual(self.rows("getVarnexReferenceSet", "NOSUCHSET", ""), [])

    def test_a_server_part_that_ends_in_a_backslash_is_reached(self) -> None:
        where = {"TDSHOST": "127.0.0.1", "TDSPORT": str(self.server.port), "TDSVER": "7.3"}
        settings = f"Driver={{SQL Native Client}};Server=(local)\\;Database=CrvSql;Uid=sa;Pwd={PASSWORD};"
        with unittest.mock.patch.dict(os.environ, where), odbc.Connection(settings) as connection:
            self.assertEqual(connection.query("select 1 as One"), [odbc.RowSet(["One"], [["1"]])])
        self.assertEqual(self.server.logged("login")[-1]["database"], "CrvSql")

    def test_the_parameter_list_of_every_procedure_is_what_the_table_declares(self) -> None:
        with self.connect() as connection:
            for procedure in PROCEDURES:
                listed = [
                    row for row in connection.parameter_list(procedure.name)
                    if row[2] == procedure.name + ";1" and row[1] == procedure.owner
                ]
                declared = [["@RETURN_VALUE", "5", "int"]]
                for parameter in procedure.parameters:
                    declared.append([parameter.name, "2" if parameter.is_output else "1", parameter.type.name])
                with self.subTest(procedure.name):
                    self.assertEqual([[row[3], row[4], row[6]] for row in listed], declared)

    def test_the_parameter_list_tells_type_codes_and_sizes(self) -> None:
        with self.connect() as connection:
            rows = [row for name in TAKERS for row in connection.parameter_list(name) if row[4] == "1"]
        facts = {str(row[3]): (row[5], row[7]) for row in rows}
        expected = {
            "@Tiny": ("-6", "3"), "@Small": ("5", "5"), "@Int": ("4", "10"), "@Big": ("-5", "19"),
            "@Real": ("7", "24"), "@Float": ("6", "53"), "@Decimal": ("3", "9"), "@Numeric": ("2", "18"),
            "@Money": ("3", "19"), "@SmallMoney": ("3", "10"), "@Bit": ("-7", "1"),
            "@DateTime": ("93", "23"), "@SmallDateTime": ("93", "16"), "@DateTime2": ("93", "27"),
            "@Date": ("91", "10"), "@Time": ("92", "12"),
            "@Char": ("1", "3"), "@VarChar": ("12", "2"), "@Max": ("12", "2147483647"), "@MaxAsZero": ("12", "0"),
            "@Text": ("-1", "2147483647"), "@NChar": ("-8", "3"), "@NVarChar": ("-9", "2"),
            "@NMax": ("-9", "1073741823"), "@NText": ("-10", "1073741823"), "@Identity": ("-11", "36"),
            "@Variant": ("-150", "8000"), "@Xml": ("-152", "1073741823"), "@Bytes": ("-3", "8"),
        }  # fmt: skip
        self.assertEqual(facts, expected)

    def test_a_name_is_a_pattern_in_the_parameter_list_and_none_in_a_call(self) -> None:
        with self.connect() as connection:
            names = {row[2] for row in connection.parameter_list("get_Pattern")}
        self.assertEqual(names, {"get_Pattern;1", "getXPattern;1"})
        self.assertEqual(self.call("get_Pattern", "1").row_sets[0].rows, [["@Underscore", "1"]])

    def test_no_row_set_and_every_state_of_the_outputs(self) -> None:
        expected = {
            "noRowSet": ["42", "0", None],
            "noRowSetNullID": [None, "0", None],
            "noRowSetFails": ["42", "-5", "The job is locked by O'Brien."],
            "noRowSetFailsWithNullText": ["42", "-5", None],
            "noRowSetPositive": ["42", "7", "Two rows were merged."],
            "noRowSetNullErrNo": ["42", None, None],
        }
        self.assertEqual({name: self.outputs(name) for name in expected}, expected)

    def test_row_sets_and_every_state_of_the_outputs(self) -> None:
        self.assertEqual(self.call("emptyRowSet").row_sets, [odbc.RowSet(["Code", "Description"], [])])
        self.assertEqual(self.call("rowSet").outputs, ["42", "0", None])
        self.assertEqual(self.call("rowSetNullID").outputs, [None, "0", None])
        self.assertEqual(self.call("rowSetFails").outputs, ["42", "-5", "The job is locked."])
        self.assertEqual(self.call("rowSetOtherColumns").row_sets, [odbc.RowSet(["Id", "Label"], [["1", "One"]])])
        self.assertEqual(len(self.call("twoRowSets").row_sets), 2)
        for name in ("rowCountFirst", "printFirst"):
            self.assertEqual(self.call(name).row_sets, [odbc.RowSet(["Code", "Description"], [["A", "Assessed"]])])
        self.assertEqual(self.outputs("printOnly"), ["42", "0", None])

    def test_parameters_that_are_not_declared_cannot_be_given(self) -> None:
        for name in ("rowSetWithoutID", "emptyRowSetWithoutID", "noRowSetWithoutID", "noRowSetWithoutErrNo"):
            with self.subTest(name), self.assertRaisesRegex(odbc.OdbcError, "too many arguments"):
                self.call(name)

    def test_inputs_and_outputs_may_be_mixed(self) -> None:
        identifier, number, text = odbc.standard_outputs()
        first, second, third = odbc.given("one", "2", None)
        with self.connect() as connection:
            outcome = connection.call("mixedOrder", [identifier, first, number, second, text, third])
        self.assertEqual(outcome.row_sets[0].rows, [["@First", "one"], ["@Second", "2"], ["@Third", None]])
        self.assertEqual(outcome.outputs, ["42", "0", None])

    def test_values_arrive_converted_to_the_declared_types(self) -> None:
        rows = self.call("takeFractions", "1.5", "-0.1", "1234.567", "3.14159", "9.999", "1").row_sets[0].rows
        self.assertEqual([row[1] for row in rows], ["1.5", "-0.1", "1234.57", "3.1416", "9.9990", "1.0000"])
        rows = self.call("takeTexts", "A", "ABC", "x" * 3000, "5 €", "O'Brien").row_sets[0].rows
        self.assertEqual([row[1] for row in rows], ["A  ", "AB", "x" * 3000, "5 €", "O'Brien"])
        with self.assertRaisesRegex(odbc.OdbcError, "8114.*data type to int"):
            self.call("takeNumberAndText", "twelve", "AB")

    def test_the_log_tells_type_size_null_and_direction_of_what_was_sent(self) -> None:
        self.call("takeNumberAndText", "12", None)
        call = self.server.last_call()
        self.assertEqual(call["procedure"], "takeNumberAndText")
        told = [[p[key] for key in ("type", "size", "null", "value", "output")] for p in call["parameters"]]
        self.assertEqual(
            told,
            [
                ["nvarchar", 255, False, "12", False],
                ["nvarchar", 255, True, None, False],
                ["int", 4, True, None, True],
                ["int", 4, True, None, True],
                ["nvarchar", 255, True, None, True],
            ],
        )

    def test_difficult_texts_and_long_ones_are_read(self) -> None:
        self.assertEqual(self.call("rowSetDifficult").row_sets[0].rows, [list(row) for row in DIFFICULT])
        values, nulls = self.call("rowSetOfTypes").row_sets[0].rows
        self.assertEqual(values[16:19], ["x" * 10_000, "\U0001f697 €", "\U0001f697" * 5000])
        self.assertEqual(nulls, [None] * len(TYPED_COLUMNS))

    def test_thousands_of_rows_are_read(self) -> None:
        self.assertEqual(len(self.call("manyRows", "5000").row_sets[0].rows), 5000)

    def test_errors_come_before_after_and_in_place_of_rows(self) -> None:
        for name, text in {
            "errorOnly": "No such set.",
            "errorBeforeRows": "Before the rows.",
            "errorAfterRows": "After the rows.",
            "errorThatEnds": "Thrown.",
        }.items():
            with self.subTest(name), self.assertRaisesRegex(odbc.OdbcError, f"50000.*{text}"):
                self.call(name)

    def test_a_call_that_takes_too_long_is_cancelled_and_the_server_learns_it(self) -> None:
        started = time.monotonic()
        with self.assertRaises(odbc.OdbcError) as caught:
            self.call("delay", "20", timeout=1)
        self.assertEqual(caught.exception.state, "HYT00")
        self.assertLess(time.monotonic() - started, 10)
        wait_for("the attention", lambda: bool(self.server.logged("attention")))

    def test_a_delay_delays(self) -> None:
        started = time.monotonic()
        self.assertEqual(self.call("delay", "0.5").outputs, ["42", "0", None])
        self.assertGreaterEqual(time.monotonic() - started, 0.5)

    def test_the_server_hangs_up_before_and_during_the_answer(self) -> None:
        for name in ("hangUpBefore", "hangUpDuring"):
            with self.subTest(name), self.assertRaisesRegex(odbc.OdbcError, "EOF"):
                self.call(name)

    def test_the_server_hangs_up_after_the_answer(self) -> None:
        with self.connect() as connection:
            self.assertEqual(connection.call("hangUpAfter", odbc.standard_outputs()).outputs, ["42", "0", None])
            with self.assertRaises(odbc.OdbcError):
                connection.query("select 1 as One")

    def test_idle_connections_are_closed_on_command_and_the_caller_is_kept(self) -> None:
        with self.connect() as idle, self.connect() as caller:
            caller.call("closeIdleConnections", odbc.standard_outputs())
            self.assertEqual(caller.query("select 1 as One")[0].rows, [["1"]])
            with self.assertRaises(odbc.OdbcError):
                idle.query("select 1 as One")


class FailureModes(unittest.TestCase):
    def connect(self, server: TdsServer) -> odbc.Connection:
        settings = f"Driver={{SQL Server}};Server=127.0.0.1;Port={server.port};Uid=sa;Pwd=x;TDS_Version=7.3;"
        return odbc.Connection(settings, login_timeout=1)

    def test_a_silent_server_accepts_and_never_answers(self) -> None:
        with TdsServer("--silent-login") as server:
            started = time.monotonic()
            with self.assertRaises(odbc.OdbcError):
                self.connect(server)
            self.assertGreaterEqual(time.monotonic() - started, 0.9)
            self.assertEqual([entry["event"] for entry in server.log()], ["accepted"])

    def test_a_server_refuses_after_so_many_connections(self) -> None:
        with TdsServer("--refuse-after", 1) as server:
            with self.connect(server) as connection:
                with self.assertRaises(odbc.OdbcError):
                    self.connect(server)
                self.assertEqual(connection.query("select 1 as One")[0].rows, [["1"]])

    def test_a_server_has_the_password_that_it_is_given(self) -> None:
        with TdsServer("--password", "other") as server, self.assertRaisesRegex(odbc.OdbcError, "18456|28000"):
            self.connect(server)

    def test_a_server_survives_bytes_that_are_no_request(self) -> None:
        with TdsServer() as server:
            with socket.create_connection(("127.0.0.1", server.port), timeout=5) as client:
                client.sendall(b"\x03\x01\x00\x0c\0\0\0\0\xff\xff\xff\xff")
                self.assertEqual(client.recv(100), b"")
            self.assertEqual(len(server.logged("unreadable")), 1)
            with self.connect(server) as connection:
                self.assertEqual(connection.query("select 1 as One")[0].rows, [["1"]])

    def test_a_server_ends_on_sigterm_while_clients_are_connected(self) -> None:
        server = TdsServer()
        with self.connect(server):
            server.process.send_signal(signal.SIGTERM)
            self.assertEqual(server.process.wait(timeout=5), 0)
        server.stop()


class InstanceLookup(unittest.TestCase):
    def ask(self, server: SsrpServer, request: bytes) -> bytes:
        with socket.socket(socket.AF_INET, socket.SOCK_DGRAM) as client:
            client.settimeout(0.5)
            client.connect(("127.0.0.1", server.port))
            client.send(request)
            return client.recv(1024)

    def test_the_answer_tells_the_port_of_the_instance_in_any_letter_case(self) -> None:
        with SsrpServer("--port", 0, "--instance", "SQLEXPRESS", "--tcp-port", 14330) as server:
            for request in (b"\x04SQLEXPRESS\0", b"\x04sqlexpress\0", b"\x03"):
                self.assertEqual(self.ask(server, request), ssrp_server.answer_about("SQLEXPRESS", 14330))
            self.assertEqual([entry["instance"] for entry in server.log()], ["SQLEXPRESS", "sqlexpress", ""])

    def test_another_instance_gets_no_answer(self) -> None:
        with SsrpServer("--port", 0, "--instance", "SQLEXPRESS", "--tcp-port", 14330) as server:
            with self.assertRaises(socket.timeout):
                self.ask(server, b"\x04OTHER\0")
            self.assertEqual(server.log(), [{"instance": "OTHER", "answered": False}])

    def test_the_driver_finds_a_named_instance(self) -> None:
        with TdsServer() as server:
            with SsrpServer("--port", BROWSER_PORT, "--instance", "SQLEXPRESS", "--tcp-port", server.port):
                settings = r"Driver={SQL Server};Server=127.0.0.1\SQLEXPRESS;Uid=sa;Pwd=x;TDS_Version=7.3;"
                with odbc.Connection(settings) as connection:
                    self.assertEqual(connection.query("select 1 as One")[0].rows, [["1"]])


if __name__ == "__main__":
    unittest.main()
