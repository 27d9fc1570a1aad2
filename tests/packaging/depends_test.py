#!/usr/bin/python3
"""What the packages are built with is what debian-packages.txt names. Usage: depends_test.py SOURCE"""
import re
import sys
import unittest
from pathlib import Path

SOURCE = Path(sys.argv[1])


def listed(*groups):
    """The packages of those groups of debian-packages.txt."""
    lines = (SOURCE / "packaging/debian-packages.txt").read_text().splitlines()
    named = [line.split() for line in lines if line and not line.startswith("#")]
    return {package for group, package in named if group in groups}


def field(path, name):
    """A field of a control file: the packages it names, without versions and profiles."""
    value = re.search(rf"^{name}:(.*(?:\n .*)*)", (SOURCE / path).read_text(), re.MULTILINE)[1]
    return {re.split(r"[ (<]", entry.strip())[0] for entry in value.split(",") if entry.strip()}


class Depends(unittest.TestCase):
    def setUp(self):
        self.build = field("debian/control", "Build-Depends")

    def test_what_compiles_the_tree_compiles_the_packages(self):
        # Every system that builds packages has the compiler.
        self.assertEqual(listed("build") - {"g++"} - self.build, set())

    def test_the_modules_that_the_screens_import_are_there_to_be_found(self):
        modules = {package for package in listed("run") if package.startswith("qml6-module-")}
        self.assertEqual({package for package in self.build if package.startswith("qml6-module-")}, modules)

    def test_the_packages_need_nothing_that_the_list_does_not_know(self):
        debhelper = {name for name in self.build if name.startswith("debhelper-compat")}
        self.assertEqual(len(debhelper), 1)
        known = listed("build", "run", "test", "window", "check", "package", "cross")
        self.assertEqual(self.build - debhelper - known, set())


if __name__ == "__main__":
    unittest.main(argv=sys.argv[:1])
