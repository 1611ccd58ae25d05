"""What `varnex3 doctor` promises: against the server of tests/database, and where there is none.

VARNEX3_PROGRAM is the program.
"""

import contextlib
import json
import re
import socket
import sys
import time
import unittest

import test_tools as tools
from test_tools import COULD_NOT_RUN, FINDINGS, FINE, SOURCE

DATABASE = SOURCE / "tests" / "database"
sys.path.insert(0, str(DATABASE))
from servers import TdsServer  # noqa: E402

SECRET = "Ge;heim} 4711"
DRIVERS = ("SQL Server", "SQL Native Client")


@contextlib.contextmanager
def closed_port():
    """A port that nobody else gets and nobody listens on."""
    with socket.socket() as held:
        held.bind(("127.0.0.1", 0))
        yield held.getsockname()[1]


class DoctorTest(tools.ToolTest):
    """Each test has its own settings and its own drivers: none until register_drivers."""

    def setUp(self):
        super().setUp()
        self.drivers = self.folder / "drivers"
        self.drivers.mkdir()
        self.settings_folder = self.folder / "settings"
        self.changes = {"VARNEX3_SETTINGS_DIR": str(self.settings_folder), "ODBCSYSINI": str(self.drivers),
                        "HOME": str(self.folder), "LC_ALL": "C.UTF-8"}

    def register_drivers(self, *names):
        text = "".join(f"[{name}]\nDriver=libtdsodbc.so\n" for name in names)
        (self.drivers / "odbcinst.ini").write_text(text)

    def set(self, **values):
        for key, value in values.items():
            done = tools.run("settings", "set", "corvo32", "frmsplash", key, value, **self.changes)
            self.assertEqual(FINE, done.status, done.errors)

    def doctor(self, *arguments, **changes):
        return tools.run("doctor", *arguments, **self.changes | changes)

    def report(self, **changes):
        return json.loads(self.doctor("--json", **changes).out)

    def assert_not_shown(self, secret):
        for form in ([], ["--json"]):
            done = self.doctor(*form)
            self.assertNotIn(secret, done.out + done.errors)

    def assert_shown(self, out, label, value):
        self.assertRegex(out, rf"(?m)^  {label} +{value}$")


class NothingConfiguredTest(DoctorTest):
    def test_without_drivers(self):
        """doctor: where no driver is registered it says so, names it, tries no server, status 1"""
        done = self.doctor()
        self.assertEqual((FINDINGS, ""), (done.status, done.errors))
        self.assert_shown(done.out, "Drivers", "none")
        self.assert_shown(done.out, "Driver", "SQL Server, not registered")
        self.assert_shown(done.out, "Server", "not tried")
        self.assertTrue(done.out.endswith(
            "\n1 finding\n  There is no driver 'SQL Server': register it in odbcinst.ini under that name\n"), done.out)

    def test_without_a_driver_manager(self):
        """doctor: where no driver manager can be loaded it says so and what to install, status 1"""
        libraries = self.folder / "libraries"
        libraries.mkdir()
        for name in ("libodbc.so.2", "libodbc.so.1", "libodbc.so"):
            (libraries / name).write_text("no library")
        done = self.doctor(LD_LIBRARY_PATH=str(libraries))
        self.assertEqual((FINDINGS, ""), (done.status, done.errors))
        self.assert_shown(done.out, "Driver manager", "missing")
        self.assertIn("\n1 finding\n  There is no driver manager: install ODBC", done.out)
        self.assertFalse(self.report(LD_LIBRARY_PATH=str(libraries))["database"]["hasDriverManager"])

    def test_the_settings_that_are_not_there(self):
        """doctor: without settings both files are said not to be there, and the defaults make the connection string"""
        done = self.doctor()
        self.assertEqual(2, len(re.findall(r"(?m)^  (?:Machine-wide|The user's) +(?:/.*)?[^/]+, not there$",
                                           done.out.replace("\n" + 24 * " ", ""))), done.out)
        for key in ("TabletUseMaster", "ServerName", "InstanceName", "DatabaseName", "SAPwd", "UseNativeClient"):
            self.assert_shown(done.out, key, "not set")
        self.assertEqual(r"Driver={SQL Server};Server=(local)\;Database=CrvSql;Uid=sa;Pwd=;",
                         self.report()["database"]["connectionString"])

    def test_it_changes_nothing(self):
        """doctor: no setting is written, not the default that a host's look-up would leave either"""
        self.register_drivers(*DRIVERS)
        with closed_port() as port:
            self.doctor(TDSPORT=str(port))
        self.assertFalse(self.settings_folder.exists())


class SettingsFoundTest(DoctorTest):
    def test_each_setting_with_its_place(self):
        """doctor: each setting that the connection depends on has its value and where it was found"""
        self.settings_folder.mkdir()
        (self.settings_folder / "machine.reg").write_text(
            "REGEDIT4\n\n[HKEY_LOCAL_MACHINE\\SOFTWARE\\corvo32\\frmsplash]\n\"ServerName\"=\"WORKSHOP1\"\n")
        self.set(InstanceName="SQLEXPRESS", UseNativeClient="1", SAPwd=SECRET)
        out = self.doctor().out
        self.assert_shown(out, "ServerName", r"WORKSHOP1 \(machine\)")
        self.assert_shown(out, "InstanceName", r"SQLEXPRESS \(user\)")
        self.assert_shown(out, "SAPwd", r"set \(user\)")
        report = self.report()
        self.assertEqual(r"Driver={SQL Native Client};Server=WORKSHOP1\SQLEXPRESS;Database=CrvSql;Uid=sa;Pwd=***;",
                         report["database"]["connectionString"])
        self.assertEqual([{"key": "ServerName", "isSet": True, "scope": "machine", "value": "WORKSHOP1"},
                          {"key": "SAPwd", "isSet": True, "scope": "user"}],
                         [entry for entry in report["settings"] if entry["key"] in ("ServerName", "SAPwd")])
        self.assertEqual([1, 3], [file["values"] for file in report["settingsFiles"]])

    def test_the_settings_of_the_tablets_master(self):
        """doctor: with TabletUseMaster 1 the keys of the master are those that count"""
        self.set(TabletUseMaster="1", TabletMasterServerName="MASTER", TabletMasterSAPwd=SECRET, ServerName="OTHER")
        done = self.doctor()
        self.assertIn(r"Server=MASTER\;", done.out)
        self.assertNotIn("OTHER", done.out)
        self.assert_shown(done.out, "TabletMasterSAPwd", r"set \(user\)")
        self.assert_not_shown(SECRET)

    def test_a_damaged_line_is_a_finding(self):
        """doctor: each damaged line is a finding with file, line and reason, and never its content"""
        self.set(SAPwd="x")
        path = self.settings_folder / "user.reg"
        path.write_text(path.read_text() + f'"TabletMasterSAPwd"="{SECRET}\n')
        done = self.doctor()
        self.assertEqual(FINDINGS, done.status)
        self.assertIn(f"{path}:5: the closing quotation mark is missing", done.out.replace("\n    ", " "))
        self.assertIn("\n2 findings\n", done.out)
        self.assertEqual(5, self.report()["settingsFiles"][1]["damagedLines"][0]["line"])
        self.assert_not_shown(SECRET)

    def test_a_file_that_cannot_be_read_is_a_finding(self):
        """doctor: a file of settings that cannot be read is a finding with the reason; the rest is told"""
        (self.settings_folder / "machine.reg").mkdir(parents=True)
        done = self.doctor()
        self.assertEqual((FINDINGS, ""), (done.status, done.errors))
        self.assertIn("machine.reg': is a folder", done.out.replace("\n    ", " "))
        self.assertIn("\nDatabase\n", done.out)


class ServerTest(DoctorTest):
    @classmethod
    def setUpClass(cls):
        cls.server = TdsServer("--password", SECRET)
        cls.addClassCleanup(cls.server.stop)

    def setUp(self):
        super().setUp()
        self.register_drivers(*DRIVERS)

    def use(self, server, **values):
        self.set(ServerName=f"127.0.0.1,{server.port}", **{"SAPwd": SECRET} | values)

    def test_a_server_that_answers_is_fine(self):
        """doctor: a server that answers, how fast, its reference sets and their sizes; status 0"""
        for driver, choice in zip(DRIVERS, "01"):
            self.use(self.server, UseNativeClient=choice)
            done = self.doctor()
            self.assertEqual((FINE, ""), (done.status, done.errors), done.out)
            self.assert_shown(done.out, "Driver manager", "there")
            self.assert_shown(done.out, "Driver", driver)
            self.assert_shown(done.out, "Server", r"answers, \d+\.\d ms: Microsoft SQL Server")
            self.assert_shown(done.out, "REPAIRMODELTYPE", "3 rows")
            self.assert_shown(done.out, "ERRORSEVERITY", "4 rows")
            self.assertTrue(done.out.endswith("\n\nEverything answers.\n"), done.out)

    def test_one_attempt_is_made(self):
        """doctor: the server sees one login and two calls of the procedure"""
        self.use(self.server)
        before = len(self.server.log())
        self.doctor()
        seen = self.server.log()[before:]
        self.assertEqual(1, len([entry for entry in seen if entry["event"] == "login"]))
        self.assertEqual(2, len([entry for entry in seen if entry.get("procedure") == "getVarnexReferenceSet"]))

    def test_a_wrong_password(self):
        """doctor: a wrong password is told as the server tells it, status 1; neither password is shown"""
        self.use(self.server, SAPwd="ganz-falsch")
        done = self.doctor()
        self.assertEqual((FINDINGS, ""), (done.status, done.errors))
        self.assert_shown(done.out, "Server", r"no connection, \d+\.\d ms")
        self.assertIn("\n1 finding\n  There is no connection to the server: Login failed for user 'sa'.",
                      done.out)
        self.assertNotIn("REPAIRMODELTYPE", done.out)
        self.assert_not_shown("ganz-falsch")

    def test_the_password_is_shown_nowhere(self):
        """doctor: the password of a server that answers is neither on the page nor in the JSON"""
        self.use(self.server)
        self.assert_not_shown(SECRET)
        self.assert_not_shown("4711")
        self.assertIn("Pwd=***;", self.doctor().out)

    def test_a_server_that_is_down(self):
        """doctor: a server that is down is a finding with the driver's reason, at once"""
        with closed_port() as port:
            self.set(ServerName=f"127.0.0.1,{port}", SAPwd=SECRET)
            done = self.doctor()
            self.assertEqual((FINDINGS, ""), (done.status, done.errors))
            self.assertRegex(done.out, r"\n1 finding\n  There is no connection to the server: \w[^\n]+")
            server = self.report()["database"]["server"]
            self.assertEqual((True, False), (server["isTried"], server["isAnswering"]))
            self.assertLess(server["milliseconds"], 1000)
            self.assert_not_shown(SECRET)

    def test_a_host_that_is_not_there(self):
        """doctor: a server name that no host has is a finding that names it"""
        self.set(ServerName="no.such.host.invalid")
        self.assertIn("no.such.host.invalid", self.report()["findings"][0])

    def test_a_server_that_is_silent_is_not_waited_for_long(self):
        """doctor: a server that takes the call and says nothing is given up after two seconds"""
        with TdsServer("--silent-login") as silent:
            self.use(silent)
            start = time.monotonic()
            report = self.report()
        self.assertLess(time.monotonic() - start, 8)
        self.assertRegex(report["findings"][0], "There is no connection to the server: .*[Tt]imeout")

    def test_json_has_all_of_it(self):
        """doctor --json: one object with version, files, settings, drivers, server and reference sets"""
        self.use(self.server)
        done = self.doctor("--json")
        self.assertEqual((FINE, "", 1), (done.status, done.errors, done.out.count("\n")))
        report = json.loads(done.out)
        self.assertEqual(tools.run("--version").out, f"varnex3 {report['version']}\n")
        self.assertIn(report["bits"], (32, 64))
        self.assertEqual(sorted(DRIVERS), sorted(report["database"]["drivers"]))
        self.assertEqual("Microsoft SQL Server", report["database"]["server"]["product"])
        self.assertEqual([{"name": "REPAIRMODELTYPE", "rows": 3}, {"name": "ERRORSEVERITY", "rows": 4}],
                         report["database"]["referenceSets"])
        self.assertEqual([], report["findings"])

    def test_another_driver_in_the_place_of_the_wanted_one(self):
        """doctor: where only FreeTDS is registered it is said to stand in for the driver that is asked for"""
        self.register_drivers("FreeTDS")
        self.use(self.server)
        done = self.doctor()
        self.assertEqual(FINE, done.status, done.out)
        self.assert_shown(done.out, "Driver", "FreeTDS in the place of SQL Server")


class PoorServerTest(DoctorTest):
    """A server whose database is not what it should be."""

    def report_with(self, fault):
        program = self.folder / "poor_server.py"
        program.write_text(f"import sys\nsys.path.insert(0, {str(DATABASE)!r})\n"
                           f"import dataclasses, tds_procedures as given\n{fault}\nimport tds_server\ntds_server.main()\n")
        poor = type("PoorServer", (TdsServer,), {"program": str(program)})
        self.register_drivers(*DRIVERS)
        with poor("--password", SECRET) as server:
            self.set(ServerName=f"127.0.0.1,{server.port}", SAPwd=SECRET)
            self.assertEqual(FINDINGS, self.doctor().status)
            return self.doctor().out, self.report()

    def test_a_reference_set_without_rows_is_a_finding(self):
        """doctor: a reference set without rows is a finding, the other one is told with its size"""
        out, report = self.report_with("given.REFERENCE_SETS.pop('ERRORSEVERITY')")
        self.assert_shown(out, "REPAIRMODELTYPE", "3 rows")
        self.assert_shown(out, "ERRORSEVERITY", "0 rows")
        self.assertEqual(["The reference set ERRORSEVERITY has no rows"], report["findings"])

    def test_a_database_without_the_procedure_is_a_finding(self):
        """doctor: a database that lacks the procedure answers, and each reference set is a finding with the reason"""
        out, report = self.report_with("given.PROCEDURES = given.PROCEDURES[1:]")
        self.assert_shown(out, "Server", r"answers, .*")
        self.assert_shown(out, "ERRORSEVERITY", "cannot be had")
        self.assertEqual(2, len(report["findings"]))
        self.assertRegex(report["findings"][0], "^The reference set REPAIRMODELTYPE cannot be had: .*getVarnexReferenceSet")

    def test_a_procedure_that_fails_is_a_finding(self):
        """doctor: what the procedure itself says against a reference set is the reason"""
        out, report = self.report_with(
            "first, *others = given.PROCEDURES\n"
            "refuse = given.always(given.outcome(None, -5, 'Sets are locked'))\n"
            "given.PROCEDURES = (dataclasses.replace(first, behaviour=refuse), *others)")
        self.assert_shown(out, "REPAIRMODELTYPE", "cannot be had")
        self.assertEqual("The reference set REPAIRMODELTYPE cannot be had: Sets are locked", report["findings"][0])


class PageTest(DoctorTest):
    def test_the_page_fits_eighty_columns(self):
        """doctor: no line takes more than 80 columns or ends with a blank, whatever the settings"""
        self.set(ServerName="x" * 200, InstanceName="word " * 40, DatabaseName="李小龍" * 30, SAPwd=SECRET)
        out = self.doctor().out
        self.assert_no_line_is_wider(out, 80)
        self.assert_no_blanks_end_a_line(out)

    def test_the_connection_string_is_broken_behind_semicolons(self):
        """doctor: each part of the connection string has a line of its own"""
        parts = re.findall(r"(?m)^ {24}(\S.*;)$", self.doctor().out)
        self.assertEqual([r"Server=(local)\;", "Database=CrvSql;", "Uid=sa;", "Pwd=;"], parts)

    def test_colours_at_a_terminal_only(self):
        """doctor: colours are used when the output is a terminal, and then only"""
        self.assertNotIn("\x1b", self.doctor().out)
        page = tools.run_at_terminal("doctor", streams=("out",), **self.changes).out
        self.assertIn("\x1b[1mSettings\x1b[0m", page)
        self.assertIn("\x1b[31m1 finding\x1b[0m", page)
        self.assertNotIn("\x1b", tools.run_at_terminal("doctor", streams=("out",), NO_COLOR="1", **self.changes).out)

    def test_no_control_character_reaches_the_terminal(self):
        """doctor: control characters in settings are escaped, on the page and in JSON"""
        self.set(ServerName="a\x1b[2J\tb", DatabaseName="\u009b31m")
        for form in ([], ["--json"]):
            self.assertNotRegex(self.doctor(*form).out, "[^\n -~]")

    def test_the_locale_in_force(self):
        """doctor: the locale is told, by category where they differ, and that one is not installed"""
        self.assert_shown(self.doctor().out, "Locale", "C.UTF-8")
        self.assert_shown(self.doctor(LC_ALL="xx_YY").out, "Locale", "xx_YY, not installed: C is in force")
        self.assert_shown(self.doctor(LC_ALL="", LC_NUMERIC="", LC_TIME="POSIX", LC_CTYPE="", LANG="C").out, "Locale",
                          "C, numbers C, dates POSIX")
        self.assertEqual({"name": "xx_YY", "isInstalled": False}, self.report(LC_ALL="xx_YY")["locale"])

    def test_wrong_arguments(self):
        """doctor: an argument that it does not take ends with status 2"""
        done = self.doctor("now")
        self.assertEqual((COULD_NOT_RUN, ""), (done.status, done.out))

    def test_help_and_manual(self):
        """doctor --help has examples, no line wider than 80 columns; the manual page names the command"""
        done = self.doctor("--help")
        self.assertEqual((FINE, ""), (done.status, done.errors))
        self.assertIn("Examples:\n  varnex3 doctor\n", done.out)
        self.assert_no_line_is_wider(done.out, 80)
        self.assertIn(".B doctor\n", (SOURCE / "tools" / "varnex3.1").read_text())


if __name__ == "__main__":
    sys.exit(unittest.main(verbosity=2))
