#!/usr/bin/python3
"""Service and application as a person uses them: both processes, a real window, and what it tells a screen reader.

    application_test.py PROGRAMS (CAPTURE | simulate FAMILY)     PROGRAMS is the folder of the built programs

Exits with 77, which ctest calls skipped, where something that it needs is not installed."""
import plistlib
import sys
import unittest

try:
    from desktop import missing_programs, wait_for
    from session import Session, source_options
except ModuleNotFoundError as module:
    print(f"skipped: python3-{module.name} is not installed")
    sys.exit(77)

SECTIONS = ("Serving Cell Info", "Serving Cell Measurements", "Measured Neighbor Cells", "SIM Info")


def is_level(text):
    return text.startswith("Measured RSRP, -") and text.endswith(" dBm")


def is_stamp(text):
    return text.startswith("Updated 20")


class ApplicationTest(unittest.TestCase):
    programs = None
    source = None

    def setUp(self):
        self.session = self.enterContext(Session(self.programs, self.source))

    def test_a_day_in_its_life(self):
        self.waits_for_a_service()
        service = self.session.start_service()
        why_no_saving = self.session.why_no_saving()
        application, window = self.session.start_application(internal=not why_no_saving)
        self.shows_the_drive(window)
        self.follows_the_desktops_colours(window)
        self.survives_the_service(window, service)
        if why_no_saving:
            print(f"left out: saving a snapshot in the whole application ({why_no_saving})")
        else:
            self.saves_a_snapshot(window)
        self.quits(window, application)

    def waits_for_a_service(self):
        application, window = self.session.start_application(internal=False)
        window.wait("No telephony service is running")
        window.wait(lambda text: text.startswith("Connecting"))
        self.assertIsNone(window.find("Save"))
        application.terminate()
        self.assertEqual(application.wait(), 0)

    def shows_the_drive(self, window):
        for section in SECTIONS:
            window.wait(section, "list item")
        window.wait(is_stamp)
        window.click("Serving Cell Measurements", "list item")
        window.wait("Back to Kelvo", "push button")
        before = window.wait(is_level).name
        window.wait(lambda text: is_level(text) and text != before)

    def follows_the_desktops_colours(self, window):
        light = self.brightness(window)
        self.session.desktop.portal.use_dark(True)
        wait_for(lambda: self.brightness(window) < light / 2, "dark colours")

    def survives_the_service(self, window, service):
        service.kill()
        service.wait()
        window.wait("Connecting...")
        window.wait(is_level)  # the last readings stay
        self.session.start_service()
        window.wait(is_stamp)

    def saves_a_snapshot(self, window):
        window.click("Save", "push button")
        window.wait("Save Snapshot")
        window.wait(lambda text: text.startswith("DLF binary ("))
        window.click("Description")
        window.type("at the bridge")
        window.click("Save", "push button")
        window.wait("Back to Kelvo", "push button")
        files = list(self.session.snapshots.iterdir())
        self.assertEqual(len(files), 1)
        self.assertRegex(files[0].name, r"^KelvoSnapshot-\d+\.kelvo$")
        snapshot = plistlib.loads(files[0].read_bytes())
        self.assertEqual(list(snapshot), ["Timestamp", "Data", "Description"])
        self.assertEqual(snapshot["Description"], "at the bridge")
        self.assertIn("DLF", snapshot["Data"][-1])

    def quits(self, window, application):
        window.key("Escape")
        window.wait("SIM Info", "list item")
        window.key("ctrl+q")
        self.assertEqual(application.wait(), 0)
        preferences = self.session.preferences("com.zorvik.dockmere")
        self.assertEqual(plistlib.loads(preferences.read_bytes()), {"DMShowGSMRSSI": False})

    def brightness(self, window):
        picture = self.session.desktop.directory / "picture.png"
        window.picture(picture)
        return float(self.session.desktop.run("convert", picture, "-format", "%[fx:mean]", "info:"))


if __name__ == "__main__":
    missing = missing_programs()
    if missing:
        print("skipped:", ", ".join(missing), "not installed")
        sys.exit(77)
    ApplicationTest.programs = sys.argv[1]
    ApplicationTest.source = [*source_options(sys.argv[2:]), "--speed", "5"]  # every refresh finds new readings
    unittest.main(argv=sys.argv[:1])
