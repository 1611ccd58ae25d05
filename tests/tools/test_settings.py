"""What `varnex3 settings` promises.

VARNEX3_PROGRAM is the program.
"""

import json
import os
import pty
import re
import subprocess
import sys
import time
import unittest

import test_tools as tools
from test_tools import COULD_NOT_RUN, FINDINGS, FINE, PROGRAM, Result

SECRET = "Ge heim-4711"
MACHINE = r"[HKEY_LOCAL_MACHINE\SOFTWARE\corvo32\frmsplash]"
USER = r"[HKEY_CURRENT_USER\Software\VB and VBA Program Settings\corvo32\frmsplash]"


class SettingsTest(tools.ToolTest):
    def settings(self, *arguments, **changes):
        return tools.run("settings", *arguments, **{"VARNEX3_SETTINGS_DIR": str(self.folder)} | changes)

    def json_of(self, *arguments):
        return [json.loads(line) for line in self.settings(*arguments, "--json").out.splitlines()]

    def get(self, key):
        return self.settings("get", "corvo32", "frmsplash", key)

    def set(self, key, *value):
        return self.settings("set", "corvo32", "frmsplash", key, *value)

    def write_machine(self, *lines):
        return self.write("machine.reg", "\n".join(["Windows Registry Editor Version 5.00", "", MACHINE, *lines, ""]))

    def write_user(self, *lines):
        return self.write("user.reg", "\n".join(["Windows Registry Editor Version 5.00", "", USER, *lines, ""]))


class RoundTripTest(SettingsTest):
    def test_what_is_set_is_what_is_got(self):
        """settings: every text comes back as it was set, for the user and for the machine"""
        for scope in ("--user", "--machine"):
            for value in ("WORKSHOP1", "(local)", r"SRV\SQLEXPRESS", 'a "b" c', "Müller 李小龍", " blanks ", "x" * 1023, "7"):
                self.assertEqual(FINE, self.set("Key", value, scope).status)
                self.assertEqual((FINE, value.rstrip()), (self.get("Key").status, self.get("Key").out[:-1]))
                self.assertEqual(value, self.json_of("get", "corvo32", "frmsplash", "Key")[0]["value"])

    def test_a_value_goes_to_the_user_unless_the_machine_is_named(self):
        """settings set: without a word the value is the user's own; --machine writes it for everybody"""
        self.set("One", "1")
        self.set("Two", "2", "--machine")
        self.assertIn(f'{USER}\n"One"="1"\n', (self.folder / "user.reg").read_text())
        self.assertIn(f'{MACHINE}\n"Two"="2"\n', (self.folder / "machine.reg").read_text())

    def test_the_letter_case_of_names_plays_no_part(self):
        """settings get: application, section and key in any letter case"""
        self.set("ServerName", "A")
        self.assertEqual("A\n", self.settings("get", "CORVO32", "frmSplash", "SERVERNAME").out)

    def test_the_machine_outranks_the_user(self):
        """settings get: the machine-wide value is in force; an empty one counts as none"""
        self.write_user('"ServerName"="U"')
        self.write_machine('"ServerName"="M"')
        self.assertEqual("M\n", self.get("ServerName").out)
        self.write_machine('"ServerName"=""')
        self.assertEqual("U\n", self.get("ServerName").out)

    def test_a_value_that_is_outranked_is_a_finding(self):
        """settings set: a user's value that the machine's outranks is written, and said to be in vain"""
        self.set("ServerName", "M", "--machine")
        done = self.set("ServerName", "U")
        self.assertEqual((FINDINGS, "varnex3: the machine-wide value outranks it and stays in force\n"),
                         (done.status, done.errors))
        self.assertIn('"ServerName"="U"', (self.folder / "user.reg").read_text())
        self.assertFalse(self.json_of("set", "corvo32", "frmsplash", "ServerName", "V")[0]["isInForce"])

    def test_reading_writes_nothing(self):
        """settings get and list: no file is made or changed"""
        self.get("UseNativeClient")
        self.assertEqual([], list(self.folder.iterdir()))
        before = self.write_user('"UseNativeClient"="1"')
        self.get("UseNativeClient")
        self.settings("list")
        self.assertEqual([before], [str(path) for path in self.folder.iterdir()])

    def test_a_setting_that_is_not_there_is_a_finding(self):
        """settings get: without a value nothing is printed, the reason is told, status 1"""
        self.assertEqual(Result(FINDINGS, "", "varnex3: corvo32, frmsplash, ServerName is not set\n"), self.get("ServerName"))
        self.assertEqual([{"application": "corvo32", "section": "frmsplash", "key": "ServerName", "isSet": False}],
                         self.json_of("get", "corvo32", "frmsplash", "ServerName"))

    def test_a_setting_that_is_empty_is_there(self):
        """settings get: a user's empty value is a value"""
        self.set("InstanceName", "")
        self.assertEqual(Result(FINE, "\n", ""), self.get("InstanceName"))

    def test_an_edit_leaves_the_other_lines(self):
        """settings set: comments and other values stay as they are"""
        self.write_user("; by hand", '"DatabaseName"="CrvSql" ; the usual one')
        self.set("DatabaseName", "Other")
        text = (self.folder / "user.reg").read_text()
        self.assertIn("; by hand\n", text)
        self.assertIn('"DatabaseName"="Other" ; the usual one\n', text)

    def test_a_number_becomes_a_text(self):
        """settings set: a value of another type becomes a text, which reads back as it is"""
        self.write_machine('"UseNativeClient"=dword:00000001', '"Blob"=hex:01,02')
        for key in ("UseNativeClient", "Blob"):
            self.assertEqual(FINE, self.set(key, "258", "--machine").status)
            self.assertEqual("258\n", self.get(key).out)


class ListTest(SettingsTest):
    def test_both_places_are_listed(self):
        """settings list: every value with its place, and the files"""
        self.write_machine('"ServerName"="M"', '"UseNativeClient"=dword:00000001')
        self.write_user('"ServerName"="U"', '"InstanceName"="I"')
        done = self.settings("list")
        self.assertEqual((FINE, ""), (done.status, done.errors))
        self.assertRegex(done.out, r"(?m)^corvo32 +frmsplash +ServerName +M +machine$")
        self.assertRegex(done.out, r"(?m)^corvo32 +frmsplash +ServerName +U +user, unused$")
        self.assertRegex(done.out, r"(?m)^corvo32 +frmsplash +InstanceName +I +user$")
        self.assertRegex(done.out, r"(?m)^corvo32 +frmsplash +UseNativeClient +dword:00000001 +machine$")
        self.assertIn(f"machine: {self.folder}/machine.reg\n", done.out.replace("\n    ", " "))
        self.assert_no_line_is_wider(done.out, 80)
        self.assert_no_blanks_end_a_line(done.out)

    def test_one_application_alone(self):
        """settings list APP: the values of that application, whose name has any letter case"""
        self.set("ServerName", "A")
        self.settings("set", "other", r"deep\down", "Key", "B")
        listed, = self.json_of("list", "OTHER")
        self.assertEqual(("other", r"deep\down", "Key", "B", "user", True),
                         tuple(listed[name] for name in ("application", "section", "key", "value", "scope", "isInForce")))
        self.assertEqual(2, len(self.json_of("list")))

    def test_nothing_is_fine(self):
        """settings list: no files are no settings, and that is fine"""
        done = self.settings("list")
        self.assertEqual((FINE, ""), (done.status, done.errors))
        self.assertEqual(2, done.out.count(", not there"))
        self.assertEqual([], self.json_of("list"))

    def test_a_long_value_keeps_to_the_width(self):
        """settings list: a long value is cut, no line takes more than 80 columns; JSON has all of it"""
        self.set("Key", "word " * 40)
        self.assert_no_line_is_wider(self.settings("list").out, 80)
        self.assertEqual("word " * 40, self.json_of("list")[0]["value"])


class PasswordTest(SettingsTest):
    KEYS = ("SAPwd", "TabletMasterSAPwd", "pwd", "ADMINPWD", "Password2")

    def all_output(self, *arguments, **changes):
        text = ""
        for form in ([], ["--json"]):
            done = self.settings(*arguments, *form, **changes)
            text += done.out + done.errors
        return text

    def test_a_password_is_never_shown(self):
        """settings: a password is nowhere in what get, set and list write, as a text or as JSON"""
        for key in self.KEYS:
            self.assertNotIn(SECRET, self.all_output("set", "corvo32", "frmsplash", key, SECRET))
            self.assertIn(f'"{key}"="{SECRET}"', (self.folder / "user.reg").read_text())
            self.assertNotIn(SECRET, self.all_output("get", "corvo32", "frmsplash", key))
            self.assertEqual(Result(FINE, "set\n", ""), self.get(key))
        self.assertNotIn(SECRET, self.all_output("list"))
        self.assertEqual(len(self.KEYS), self.settings("list").out.count(" set "))

    def test_a_password_of_another_type_is_not_shown(self):
        """settings: a password that is no text is not shown either"""
        self.write_machine('"SAPwd"=hex:47,65,68', '"TabletMasterSAPwd"=dword:00001267')
        self.assertNotRegex(self.all_output("list") + self.all_output("get", "corvo32", "frmsplash", "TabletMasterSAPwd"),
                            "47,65,68|1267|4711")

    def test_a_password_that_is_not_there_or_empty_is_not_set(self):
        """settings get: a password that is not there or empty is not set, status 1"""
        self.assertEqual(Result(FINDINGS, "not set\n", ""), self.get("SAPwd"))
        self.write_user('"SAPwd"=""')
        self.assertEqual(Result(FINDINGS, "not set\n", ""), self.get("SAPwd"))
        self.assertFalse(self.json_of("list")[0]["isSet"])

    def test_a_damaged_line_keeps_its_password(self):
        """settings: of a damaged line place and reason are told, never what stands there"""
        self.write_user(f'"SAPwd"="{SECRET}')
        for arguments in (["list"], ["get", "corvo32", "frmsplash", "SAPwd"], ["set", "a", "b", "c", "d"]):
            text = self.all_output(*arguments)
            self.assertNotIn(SECRET, text)
            self.assertIn("quotation mark", text)

    def test_wrong_arguments_are_not_repeated(self):
        """settings set: what the command line cannot make sense of may be a password and is not repeated"""
        for words in (["-" + SECRET], [SECRET, "more"], ["x", "--" + SECRET], ["x", "--user=" + SECRET], [SECRET + "\xff"]):
            arguments = [os.fsencode(word.replace("\xff", "\udcff")) for word in ("settings", "set", "a", "b", "SAPwd", *words)]
            done = tools.run(*arguments, VARNEX3_SETTINGS_DIR=str(self.folder))
            self.assertEqual((COULD_NOT_RUN, ""), (done.status, done.out), words)
            self.assertNotIn(SECRET, done.errors)
            self.assertTrue(done.errors.startswith("varnex3: "))

    def test_a_failure_does_not_show_it(self):
        """settings set: a password that cannot be written is not shown"""
        self.assertNotIn(SECRET, self.all_output("set", "a", "b", "SAPwd", SECRET, VARNEX3_SETTINGS_DIR="/dev/null/x"))

    def test_a_value_comes_from_the_standard_input(self):
        """settings set: without a value a line of the standard input is taken; without a line status 2"""
        command = [PROGRAM, "settings", "set", "corvo32", "frmsplash", "SAPwd"]
        changed = tools.environment(VARNEX3_SETTINGS_DIR=str(self.folder))
        done = subprocess.run(command, input=f"-{SECRET}\nmore\n".encode(), capture_output=True, env=changed, check=True)
        self.assertNotIn(SECRET.encode(), done.stdout + done.stderr)
        self.assertIn(f'"SAPwd"="-{SECRET}"\n', (self.folder / "user.reg").read_text())
        done = self.set("SAPwd")
        self.assertEqual((COULD_NOT_RUN, "varnex3: no value was given (error 5)\n"), (done.status, done.errors))

    def test_a_password_that_is_typed_does_not_show(self):
        """settings set: at a terminal the value is asked for; that of a password is not echoed"""
        for key, is_shown in (("SAPwd", False), ("ServerName", True)):
            ours, theirs = pty.openpty()
            command = [PROGRAM, "settings", "set", "corvo32", "frmsplash", key]
            with subprocess.Popen(command, stdin=theirs, stdout=theirs, stderr=theirs,
                                  env=tools.environment(VARNEX3_SETTINGS_DIR=str(self.folder))) as program:
                written = os.read(ours, 100)
                self.assertEqual(b"Value: ", written)
                os.write(ours, SECRET.encode() + b"\n")
                program.wait(timeout=60)
            time.sleep(0.05)
            written += os.read(ours, 4096)
            os.close(ours)
            os.close(theirs)
            self.assertEqual(is_shown, SECRET.encode() in written, key)
            self.assertIn(f'"{key}"="{SECRET}"', (self.folder / "user.reg").read_text())


class FailureTest(SettingsTest):
    def test_a_damaged_line_is_reported_with_its_place(self):
        """settings: each damaged line is told with file, line and reason, status 1; the rest is read"""
        path = self.write_user('"InstanceName"="I', "nonsense", '"ServerName"="A"')
        done = self.settings("list")
        self.assertEqual(FINDINGS, done.status)
        told = done.errors.replace("\n    ", " ")
        self.assertRegex(told, rf"(?m)^{path}:4: the closing quotation mark is missing$")
        self.assertRegex(told, rf"(?m)^{path}:5: \w")
        self.assertIn(" A ", done.out)
        self.assertEqual(Result(FINDINGS, "A\n", done.errors), self.get("ServerName"))
        setting, first, second = self.json_of("list")
        self.assertEqual("A", setting["value"])
        self.assertEqual((path, "damaged", 4), (first["FilePath"], first["error"]["kind"], first["error"]["line"]))
        self.assertEqual(5, second["error"]["line"])

    def test_a_place_that_cannot_be_written(self):
        """settings set: what cannot be written ends with status 2 and names the file and the reason"""
        done = self.settings("set", "a", "b", "c", "d", VARNEX3_SETTINGS_DIR="/dev/null/x")
        self.assertEqual(Result(COULD_NOT_RUN, "", "varnex3: '/dev/null/x/user.reg' cannot be written: its folder is not "
                                                   "there and cannot be made (error 75)\n"), done)

    @unittest.skipIf(os.geteuid() == 0, "the superuser may write everywhere")
    def test_a_folder_without_permission(self):
        """settings set: a folder that we may not write to ends with status 2"""
        os.chmod(self.folder, 0o500)
        done = self.set("ServerName", "A")
        self.assertEqual((COULD_NOT_RUN, ""), (done.status, done.out))
        self.assertIn("user.reg' cannot be written: permission denied (error 70)", done.errors)

    def test_a_file_that_cannot_be_read(self):
        """settings: a file that is there and cannot be read ends with status 2, not with the value of the other"""
        (self.folder / "machine.reg").mkdir()
        self.write_user('"ServerName"="A"')
        for arguments in (["list"], ["get", "corvo32", "frmsplash", "ServerName"]):
            done = self.settings(*arguments)
            self.assertEqual((COULD_NOT_RUN, ""), (done.status, done.out))
            self.assertIn("machine.reg': is a folder", done.errors)

    def test_names_that_a_file_cannot_hold(self):
        """settings set: an empty name, or one with an empty part, ends with status 2"""
        for name in (("", "b", "c"), ("a", "", "c"), ("a", "b", ""), ("a", r"b\\c", "d"), ("a\nb", "c", "d"), ("a", "b", "c\nd")):
            done = self.settings("set", *name, "value")
            self.assertEqual((COULD_NOT_RUN, ""), (done.status, done.out), name)
            self.assertIn("error 5", done.errors, name)

    def test_a_machine_wide_value_that_would_not_be_read(self):
        """settings set --machine: a value too long to be read again ends with status 2; the user's may be longer"""
        self.assertEqual(COULD_NOT_RUN, self.set("Key", "x" * 1024, "--machine").status)
        self.assertEqual(FINE, self.set("Key", "x" * 5000).status)
        self.assertEqual("x" * 5000 + "\n", self.get("Key").out)

    def test_wrong_arguments(self):
        """settings: too few arguments, too many, or two places end with status 2"""
        for words in ((), ("get",), ("get", "a", "b"), ("get", "a", "b", "c", "d"), ("list", "a", "b"), ("bogus",),
                      ("set", "a", "b", "c", "d", "--user", "--machine")):
            done = self.settings(*words)
            self.assertEqual((COULD_NOT_RUN, ""), (done.status, done.out), words)
            self.assertTrue(done.errors.startswith("varnex3: "), done.errors)

    def test_no_control_character_reaches_the_terminal(self):
        """settings: control characters in values and names are escaped, as a text and in JSON"""
        self.settings("set", "a\x1b[2J", "b", "c\u009b", "d\te\x1b[31m")
        for arguments in (["list"], ["get", "a\x1b[2J", "b", "c\u009b"], ["get", "\x1b", "\x1b", "\x1b"]):
            for form in ([], ["--json"]):
                done = self.settings(*arguments, *form)
                self.assertNotRegex(done.out + done.errors, "[^\n -~]")

    def test_help_has_examples(self):
        """settings --help: each command has one with examples, no line wider than 80 columns"""
        for command in ([], ["get"], ["set"], ["list"]):
            done = self.settings(*command, "--help")
            self.assertEqual((FINE, ""), (done.status, done.errors))
            self.assertIn("Examples:\n  varnex3 settings ", done.out)
            self.assert_no_line_is_wider(done.out, 80)

    def test_the_manual_names_every_command_and_option(self):
        """settings: the manual page names each command and each option"""
        manual = (tools.SOURCE / "tools" / "varnex3.1").read_text().replace("\\-", "-")
        for command in ("get", "set", "list"):
            self.assertIn(f".B settings {command}", manual)
            for option in re.findall(r"--[a-z]+", self.settings(command, "--help").out.split("Examples:")[0]):
                self.assertIn(option, manual)


if __name__ == "__main__":
    sys.exit(unittest.main(verbosity=2))
