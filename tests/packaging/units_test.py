#!/usr/bin/python3
"""The units of the service, as systemd's own tools see them. Usage: units_test.py UNITS   (UNITS has system/ and user/)"""
import os
import re
import shutil
import subprocess
import sys
import tempfile
import unittest
from pathlib import Path

UNITS = Path(sys.argv[1])
LIMIT = 2.0  # the exposure that systemd-analyze works out, of 10


def analyze(*arguments):
    with tempfile.TemporaryDirectory() as runtime:  # of a user without a session
        done = subprocess.run(["systemd-analyze", "--no-pager", *arguments], capture_output=True, text=True,
                              env={**os.environ, "XDG_RUNTIME_DIR": runtime})
    return done.returncode, done.stdout, done.stderr


def entries(path):
    """What a unit says, a list of values for each name."""
    found = {}
    for name, value in re.findall(r"^(\w+)=(.*)$", path.read_text(), re.MULTILINE):
        found.setdefault(name, []).append(value)
    return found


class Units(unittest.TestCase):
    def setUp(self):
        if not shutil.which("systemd-analyze"):
            print("left out: the units, without systemd-analyze", flush=True)
            self.skipTest("no systemd-analyze")
        directory = tempfile.TemporaryDirectory()
        self.addCleanup(directory.cleanup)
        self.directory = Path(directory.name)
        for unit in UNITS.glob("*/kelvo-*"):
            # A template is looked at for somebody.
            shutil.copy(unit, self.directory / unit.name.replace("@.", "@somebody."))

    def test_are_understood(self):
        for manager, units in (("--user", ["kelvo-telephonyd.socket", "kelvo-telephonyd.service"]),
                               ("--system", ["kelvo-session@somebody.service", "kelvo-telephonyd@somebody.service"])):
            status, _, said = analyze(manager, "verify", "--man=no", "--recursive-errors=no",
                                      *(self.directory / unit for unit in units))
            said = "\n".join(line for line in said.splitlines() if "kelvo" in line)
            self.assertEqual(said, "")
            self.assertEqual(status, 0)

    def test_leave_little_open(self):
        for unit in ("kelvo-telephonyd@somebody.service", "kelvo-telephonyd.service"):
            _, text, said = analyze("security", "--offline=yes", self.directory / unit)
            exposure = re.search(r"Overall exposure level for \S+: ([\d.]+)", text)
            self.assertIsNotNone(exposure, said)
            self.assertLess(float(exposure[1]), LIMIT)


class Devices(unittest.TestCase):
    def test_are_those_of_modems_alone(self):
        for unit in ("system/kelvo-telephonyd@.service", "user/kelvo-telephonyd.service"):
            said = entries(UNITS / unit)
            self.assertEqual(said["DevicePolicy"], ["closed"])
            self.assertEqual(said["DeviceAllow"], ["char-ttyUSB rw", "char-ttyACM rw", "char-ttyHS rw", "/dev/diag rw"])

    def test_it_writes_nowhere_but_where_it_says(self):
        for unit, paths in (("system/kelvo-telephonyd@.service", "/run/kelvo-telephonyd/%i/runtime"),
                            ("user/kelvo-telephonyd.service", "%t/kelvo -%h/.local/state/kelvo")):
            said = entries(UNITS / unit)
            self.assertEqual((said["ProtectSystem"], said["ProtectHome"], said["ReadWritePaths"]),
                             (["strict"], ["read-only"], [paths]))

    def test_the_service_is_watched_and_comes_back(self):
        for unit in ("system/kelvo-telephonyd@.service", "user/kelvo-telephonyd.service"):
            said = entries(UNITS / unit)
            self.assertEqual((said["Type"], said["WatchdogSec"], said["Restart"]), (["notify"], ["30"], ["on-failure"]))

    def test_what_it_refuses_to_start_with_is_not_tried_again_and_again(self):
        for unit in ("system/kelvo-telephonyd@.service", "user/kelvo-telephonyd.service"):
            said = entries(UNITS / unit)
            self.assertEqual(said["RestartPreventExitStatus"], ["1"])
            self.assertEqual((said["StartLimitIntervalSec"], said["StartLimitBurst"]), (["60"], ["20"]))
        self.assertEqual(entries(UNITS / "user/kelvo-telephonyd.socket")["FlushPending"], ["yes"])

    def test_from_boot_on_another_unit_opens_the_session(self):
        """Who opens one leaves his unit's control group, and its rules for devices."""
        said = entries(UNITS / "system/kelvo-telephonyd@.service")
        self.assertNotIn("PAMName", said)
        self.assertEqual(said["Requires"], ["kelvo-session@%i.service"])
        self.assertIn("kelvo-session@%i.service", said["After"][0].split())
        self.assertEqual(said["Environment"], ["XDG_RUNTIME_DIR=/run/kelvo-telephonyd/%i/runtime"])
        session = entries(UNITS / "system/kelvo-session@.service")
        self.assertEqual((session["User"], session["PAMName"]), (["%i"], ["login"]))
        self.assertEqual(session["StopWhenUnneeded"], ["yes"])

    def test_nobody_else_reaches_the_users_socket(self):
        said = entries(UNITS / "user/kelvo-telephonyd.socket")
        self.assertEqual((said["SocketMode"], said["DirectoryMode"]), (["0600"], ["0700"]))
        self.assertEqual(said["ListenSequentialPacket"], ["%t/kelvo/ports/com.zorvik.TelephonyService.port"])


if __name__ == "__main__":
    unittest.main(argv=sys.argv[:1])
