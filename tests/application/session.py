"""The telephony service and the application, whole, on a desktop of their own. Saving needs the package of the group
"internal" and a system that lets it make a view of the file system."""
import subprocess
from pathlib import Path

from desktop import Desktop, Window, wait_for


def source_options(words):
    """What `kelvo-telephonyd` is told: `words` is ["simulate", FAMILY] or [CAPTURE]."""
    return ["--simulate", words[1]] if words[0] == "simulate" else ["--replay", Path(words[0]).resolve(), "--loop"]


class Session:
    MARKER = "/ZorvikInternal/Library/PreferenceBundles/Carrier Settings.bundle"
    SNAPSHOTS = "/var/mobile/Library/Logs/Quillet"

    def __init__(self, programs, source, dark=False, scale=1, size=(360, 640), haste=1):
        """`haste`: so many times faster than the clock on the wall goes that of both programs (package faketime)."""
        self._programs, self._source, self._size = Path(programs).resolve(), source, size
        self._clock = self._hasty_clock(haste) if haste != 1 else []
        self.desktop = Desktop(dark, scale)
        self.desktop.environment["QT_LINUX_ACCESSIBILITY_ALWAYS_ON"] = "1"
        self.snapshots = self.desktop.directory / "snapshots"
        self.snapshots.mkdir()

    def __enter__(self):
        return self

    def __exit__(self, *stopped):
        self.desktop.__exit__(*stopped)

    @staticmethod
    def _hasty_clock(haste):
        library = next(Path("/usr/lib").glob("*/faketime/libfaketimeMT.so.1"))
        return ["env", f"LD_PRELOAD={library}", f"FAKETIME=+0 x{haste}"]

    def start_service(self):
        """The service, ready to be asked."""
        service = self.desktop.start(*self._clock, self._programs / "kelvo-telephonyd", *self._source)
        port = self.desktop.directory / "runtime_dir/kelvo/ports/com.zorvik.TelephonyService.port"
        wait_for(port.exists, "the service's port")
        return service

    def start_application(self, internal=True):
        """The application and its window; on an internal installation, which may save, unless told otherwise."""
        view = self._internal_view() if internal else []
        application = self.desktop.start(*view, *self._clock, self._programs / "kelvo")
        return application, Window(self.desktop, self._size)

    def open(self, file, title):
        """The application as a file manager starts it for a file, and its window, whose title matches `title`."""
        application = self.desktop.start(self._programs / "kelvo", file)
        return application, Window(self.desktop, self._size, title)

    def why_no_saving(self):
        """Why the application cannot be started as on an internal installation here; None when it can."""
        try:
            tried = subprocess.run([*self._internal_view(), "true"], capture_output=True, text=True, check=False)
        except FileNotFoundError:
            return "bwrap is not installed"
        return None if tried.returncode == 0 else (tried.stderr.strip() or "bwrap fails").splitlines()[-1]

    def _internal_view(self):
        """A view of the file system with the marker that permits saving, and with a place for snapshots."""
        view = ["bwrap", "--die-with-parent", "--tmpfs", "/", "--dir", "/var"]
        for entry in [*Path("/").iterdir(), *Path("/var").iterdir()]:
            if str(entry) not in ("/var", "/var/mobile", "/ZorvikInternal"):
                view += ["--dev-bind", entry, entry]
        return [*view, "--dir", self.MARKER, "--bind", self.snapshots, self.SNAPSHOTS, "--"]

    def preferences(self, domain):
        """The file in which another application's preferences are kept; none yet is None."""
        files = list((self.desktop.directory / "config_home").rglob(domain + ".plist"))
        return files[0] if files else None
