#!/usr/bin/python3
"""Every program tells the same version, commit and build, and every document the same releases.
Usage: version_test.py SOURCE PROGRAMS VERSION BUILD-TYPE"""
import re
import shutil
import subprocess
import sys
import tempfile
import unittest
from pathlib import Path

SOURCE, PROGRAMS = Path(sys.argv[1]), Path(sys.argv[2])
VERSION, BUILD_TYPE = sys.argv[3:5]


def git(directory, *arguments):
    identity = ("-c", "user.name=Somebody", "-c", "user.email=somebody@example.org")
    return subprocess.run(["git", "-C", directory, *identity, *arguments], check=True, capture_output=True,
                          text=True).stdout.strip()


def header(tree):
    """What is built out of a tree, as its header tells it."""
    output = Path(tree) / "Header.h"
    subprocess.run(["cmake", "-D", f"SOURCE={tree}", "-D", f"OUTPUT={output}", "-D", "VERSION=3.4.5", "-D",
                    "BUILD=Debug, GNU 1.2, m68k", "-P", SOURCE / "cmake/WriteBuildHeader.cmake"], check=True)
    return dict(re.findall(r'#define KELVO_(\w+) "([^"]*)"', output.read_text()))


class Programs(unittest.TestCase):
    def test_tell_version_commit_and_build_in_one_line(self):
        for program in ("kelvo", "kelvo-telephonyd", "kelvo-modem", "kelvoctl"):
            said = subprocess.run([PROGRAMS / program, "--version"], capture_output=True, text=True)
            self.assertEqual((said.returncode, said.stderr), (0, ""))
            self.assertRegex(said.stdout, rf"^{program} {re.escape(VERSION)} \(commit ([0-9a-f]{{12}}(\+changes)?|unknown), "
                                          rf"{BUILD_TYPE}, (GNU|Clang) \d+\.\d+, \w+\)\n$")

    def test_refuse_in_one_line_what_they_do_not_know(self):
        for program in ("kelvo", "kelvo-telephonyd", "kelvo-modem", "kelvoctl"):
            said = subprocess.run([PROGRAMS / program, "--verison"], capture_output=True, text=True)
            self.assertEqual((said.returncode, said.stdout), (1, ""))
            self.assertRegex(said.stderr, rf"^{program}: .*\n$")


@unittest.skipUnless(shutil.which("git"), "no git")
class Commit(unittest.TestCase):
    def setUp(self):
        self._directory = tempfile.TemporaryDirectory()
        self.addCleanup(self._directory.cleanup)
        self.tree = Path(self._directory.name) / "kelvo"
        (self.tree / "cmake").mkdir(parents=True)
        (self.tree / ".gitattributes").write_text((SOURCE / ".gitattributes").read_text())
        (self.tree / "cmake/archive-commit").write_text("$Format:%H$\n")  # SOURCE may be out of an archive itself
        (self.tree / "file").write_text("as it was\n")

    def commit(self):
        git(self.tree, "init", "-q")
        git(self.tree, "add", "file", "cmake", ".gitattributes")
        git(self.tree, "commit", "-q", "-m", "All")
        return git(self.tree, "rev-parse", "HEAD")[:12]

    def test_is_that_of_the_tree(self):
        commit = self.commit()
        self.assertEqual(header(self.tree), {"VERSION": "3.4.5", "COMMIT": commit, "BUILD": "Debug, GNU 1.2, m68k"})
        (self.tree / "file").write_text("as it is\n")
        self.assertEqual(header(self.tree)["COMMIT"], commit + "+changes")

    def test_travels_in_an_archive_that_git_makes(self):
        commit = self.commit()
        unpacked = Path(self._directory.name) / "unpacked"
        unpacked.mkdir()
        archive = subprocess.run(["git", "-C", self.tree, "archive", "HEAD"], check=True, capture_output=True).stdout
        subprocess.run(["tar", "-x", "-C", unpacked], input=archive, check=True)
        self.assertEqual(header(unpacked)["COMMIT"], commit)

    def test_is_unknown_where_nothing_tells_it(self):
        self.assertEqual(header(self.tree)["COMMIT"], "unknown")

    def test_of_a_repository_around_the_tree_is_not_the_trees(self):
        around = self.tree.parent
        git(around, "init", "-q")
        git(around, "add", "kelvo/file")
        git(around, "commit", "-q", "-m", "Something else")
        self.assertEqual(header(self.tree)["COMMIT"], "unknown")

    def test_leaves_a_header_alone_that_says_so_already(self):
        header(self.tree)
        before = (self.tree / "Header.h").stat().st_mtime_ns
        header(self.tree)
        self.assertEqual((self.tree / "Header.h").stat().st_mtime_ns, before)


class Documents(unittest.TestCase):
    """The version stands in CMakeLists.txt. What has to name releases names the same ones."""

    def releases(self):
        """Version and date of the releases in the changelog, the newest first."""
        return re.findall(r"^## \[(\S+)\] - (\S+)$", (SOURCE / "CHANGELOG.md").read_text(), re.MULTILINE)

    def test_the_changelog_keeps_its_form(self):
        text = (SOURCE / "CHANGELOG.md").read_text()
        self.assertTrue(text.startswith("# Changelog\n"))
        headings = re.findall(r"^## (.*)$", text, re.MULTILINE)
        self.assertEqual(headings[1:] if headings[0] == "Unreleased" else headings,
                         [f"[{version}] - {date}" for version, date in self.releases()])
        kinds = set(re.findall(r"^### (.*)$", text, re.MULTILINE))
        self.assertLessEqual(kinds, {"Added", "Changed", "Deprecated", "Removed", "Fixed", "Security"})
        self.assertEqual(self.releases(), sorted(self.releases(), key=lambda release: release[1], reverse=True))

    def test_the_newest_release_is_the_version(self):
        self.assertEqual(self.releases()[0][0], VERSION)

    def test_the_debian_changelog_knows_it(self):
        self.assertRegex((SOURCE / "debian/changelog").read_text(), rf"^kelvo \({re.escape(VERSION)}\) ")

    def test_the_software_centre_knows_all_releases(self):
        metainfo = (SOURCE / "packaging/org.kelvo.Kelvo.metainfo.xml").read_text()
        self.assertEqual(re.findall(r'<release version="([^"]+)" date="([^"]+)"', metainfo), self.releases())


if __name__ == "__main__":
    unittest.main(argv=sys.argv[:1])
