#!/usr/bin/python3
"""Saved snapshots of all families as a person opens them: the program itself, a real window, and what it tells a screen
reader, held against what another reader of property lists finds in the file.

    snapshot_test.py PROGRAMS CAPTURES     the folders of the built programs and of a capture of each family

Exits with 77, which ctest calls skipped, where something that it needs is not installed."""
import plistlib
import subprocess
import sys
import unittest
from pathlib import Path

try:
    from desktop import missing_programs
    from session import Session
except ModuleNotFoundError as module:
    print(f"skipped: python3-{module.name} is not installed")
    sys.exit(77)

FAMILIES = ("ifx", "gsm", "cdma", "lte", "utran")


def rows(display):
    """Name and content of what a screen shows, in its order."""
    if isinstance(display, list):
        return [(str(number), row) for number, row in enumerate(display)]
    if "_sorted" not in display:
        return list(display.items())
    return [(key.split(";")[1] if key.count(";") == 1 else key, display[key])
            for key in sorted(display) if key != "_sorted"]


def first_value(display):
    """The rows that lead to the first value, and the value."""
    for name, content in rows(display):
        if isinstance(content, str):
            return [name], content
        if (found := first_value(content)) is not None:
            return [name, *found[0]], found[1]
    return None


class SnapshotTest(unittest.TestCase):
    programs = None
    captures = None

    def setUp(self):
        self.session = self.enterContext(Session(self.programs, []))
        self.directory = self.session.desktop.directory

    def save(self, family):
        file = self.directory / f"{family}.kelvo"
        subprocess.run([self.programs / "kelvoctl", "decode", "--refresh-every", "100", "--save", file,
                        self.captures / f"{family}.pcap"], check=True, stdout=subprocess.DEVNULL)
        return file

    def test_show_the_saved_texts_of_every_family(self):
        for family in FAMILIES:
            with self.subTest(family):
                file = self.save(family)
                display = [entry for entry in plistlib.loads(file.read_bytes())["Data"] if "Display" in entry][-1]["Display"]
                # Under the name that other programs hand over, the family's first screens and their first value.
                application, window = self.session.open(file.as_uri(), f"^{family}.kelvo: Snapshot of 20")
                for name, content in rows(display)[:3]:
                    window.wait(name if not isinstance(content, str) else f"{name}, {content}", "list item")
                window.wait(lambda text: text.startswith("Snapshot of 20"))
                self.assertIsNone(window.find("Save"))
                self.assertIsNone(window.find("Overview"))
                path, value = first_value(display)
                for name in path[:-1]:
                    window.click(name, "list item")
                    window.wait(name, "heading")
                window.wait(f"{path[-1]}, {value}", "list item")
                window.key("ctrl+q")
                self.assertEqual(application.wait(), 0)
        ports = self.directory / "runtime_dir/kelvo/ports"
        self.assertEqual([port for port in ports.iterdir() if port.name.startswith("com.zorvik.")], [])
        self.assertIsNone(self.session.preferences("com.zorvik.dockmere"))

    def test_has_a_window_beside_the_live_one_and_of_its_own(self):
        file = self.save("lte")
        live, _ = self.session.start_application(internal=False)
        first, _ = self.session.open(file, "^lte.kelvo: ")
        again = self.session.desktop.start(self.programs / "kelvo", file)
        self.assertEqual(again.wait(), 0)  # it has brought the first to the front
        other, _ = self.session.open(self.save("gsm"), "^gsm.kelvo: ")
        for application in (first, other, live):
            self.assertIsNone(application.poll())
            application.terminate()
            self.assertEqual(application.wait(), 0)

    def test_says_in_a_window_why_a_file_is_not_shown(self):
        file = self.directory / "cut.kelvo"
        file.write_bytes(self.save("utran").read_bytes()[:1000])
        application, window = self.session.open(file, "^cut.kelvo: Nothing to show")
        window.wait(lambda text: text.startswith("cut.kelvo is not a snapshot: "))
        window.key("ctrl+q")
        self.assertEqual(application.wait(), 1)


if __name__ == "__main__":
    missing = missing_programs()
    if missing:
        print("skipped:", ", ".join(missing), "not installed")
        sys.exit(77)
    SnapshotTest.programs, SnapshotTest.captures = Path(sys.argv[1]), Path(sys.argv[2])
    unittest.main(argv=sys.argv[:1])
