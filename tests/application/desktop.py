"""A desktop of its own for programs under test: an X server without a screen, a session bus with the portal that tells
the colour scheme, and eyes and hands: what a window shows is read as a screen reader reads it, and typed and clicked
into as a person does. Nothing of the user's session is touched. Needs the packages of the group "window"."""
import os
import shutil
import subprocess
import tempfile
import threading
import time
from pathlib import Path

from jeepney import DBusAddress, HeaderFields, MessageType, new_error, new_method_call, new_method_return, new_signal
from jeepney.bus_messages import message_bus
from jeepney.io.blocking import open_dbus_connection

PROGRAMS = ("Xvfb", "dbus-daemon", "/usr/libexec/at-spi-bus-launcher", "xdotool", "import")
PATIENCE = 30  # seconds; every wait ends as soon as its condition holds


def missing_programs():
    return [program for program in PROGRAMS if shutil.which(program) is None]


def wait_for(condition, what):
    """The first true value of `condition`; fails, naming `what`, when there is none in time."""
    end = time.monotonic() + PATIENCE
    while True:
        value = condition()
        if value:
            return value
        if time.monotonic() > end:
            raise AssertionError(f"waited in vain for {what}")
        time.sleep(0.02)


class Portal(threading.Thread):
    """The part of the desktop's portal that tells whether programs shall be light or dark."""

    PATH = "/org/freedesktop/portal/desktop"
    SETTINGS = "org.freedesktop.portal.Settings"
    SETTING = ("org.freedesktop.appearance", "color-scheme")

    def __init__(self, address, dark):
        super().__init__(daemon=True)
        self._connection = open_dbus_connection(address)
        self._connection.send_and_get_reply(message_bus.RequestName("org.freedesktop.portal.Desktop"))
        self._value = 1 if dark else 2
        self.start()

    def run(self):
        try:
            while True:
                message = self._connection.receive()
                if message.header.message_type is MessageType.method_call:
                    self._answer(message)
        except (OSError, EOFError):
            pass  # the bus has gone

    def _answer(self, message):
        known = message.header.fields.get(HeaderFields.member) == "Read" and message.body == self.SETTING
        reply = (new_method_return(message, "v", (("v", ("u", self._value)),)) if known
                 else new_error(message, "org.freedesktop.portal.Error.NotFound"))
        self._connection.send(reply)

    def use_dark(self, dark):
        self._value = 1 if dark else 2
        address = DBusAddress(self.PATH, interface=self.SETTINGS)
        self._connection.send(new_signal(address, "SettingChanged", "ssv", (*self.SETTING, ("u", self._value))))


class Desktop:
    def __init__(self, dark=False, scale=1, screen=(1600, 2000)):
        self.directory = Path(tempfile.mkdtemp(prefix="kelvo-desktop-"))
        self._programs = []
        self.environment = {
            name: value for name, value in os.environ.items()
            if not name.startswith(("QT_", "DBUS_", "XDG_", "WAYLAND_"))
        }
        for name in ("RUNTIME_DIR", "CONFIG_HOME", "DATA_HOME", "CACHE_HOME", "STATE_HOME"):
            path = self.directory / name.lower()
            path.mkdir(mode=0o700)
            self.environment[f"XDG_{name}"] = str(path)
        self.environment.update(QT_QPA_PLATFORM="xcb", QT_SCALE_FACTOR=str(scale), LC_ALL="C.UTF-8", TZ="UTC")
        self.environment.pop("XAUTHORITY", None)
        self._start_screen(screen)
        self._start_bus()
        self.portal = Portal(self.environment["DBUS_SESSION_BUS_ADDRESS"], dark)

    def __enter__(self):
        return self

    def __exit__(self, *_):
        for program in reversed(self._programs):
            program.terminate()
        for program in self._programs:
            program.wait(timeout=PATIENCE)
        shutil.rmtree(self.directory, ignore_errors=True)

    def _start_screen(self, size):
        reading, writing = os.pipe()
        # Without -noreset the server starts anew whenever its only client leaves, and turns the next one away.
        self.start("Xvfb", "-displayfd", str(writing), "-noreset", "-nolisten", "tcp",
                   "-screen", "0", f"{size[0]}x{size[1]}x24", pass_fds=[writing])
        os.close(writing)
        with os.fdopen(reading) as display:
            self.environment["DISPLAY"] = ":" + display.readline().strip()

    def _start_bus(self):
        bus = self.start("dbus-daemon", "--session", "--nofork", "--print-address", stdout=subprocess.PIPE, text=True)
        self.environment["DBUS_SESSION_BUS_ADDRESS"] = bus.stdout.readline().strip()

    def start(self, *command, log=None, **options):
        """Starts a program that ends, at the latest, with this desktop. `log` is the file for its standard error."""
        with open(log or os.devnull, "ab") as errors:
            program = subprocess.Popen([str(part) for part in command], env=self.environment, stderr=errors,
                                       stdin=subprocess.DEVNULL, **options)
        self._programs.append(program)
        return program

    def run(self, *command):
        return subprocess.run([str(part) for part in command], env=self.environment, check=True, capture_output=True,
                              text=True).stdout


class Node:
    """One thing on the screen, as a screen reader is told of it."""

    def __init__(self, role, name, box, enabled):
        self.role, self.name, self.box, self.enabled = role, name, box, enabled

    def __repr__(self):
        return f"{self.role} {self.name!r}"


class Eyes:
    """Reads what the one application on a desktop tells screen readers."""

    ROOT = "/org/a11y/atspi/accessible/root"
    ENABLED = 1 << 8
    SHOWING = 1 << 25

    def __init__(self, desktop):
        session = open_dbus_connection(desktop.environment["DBUS_SESSION_BUS_ADDRESS"])
        launcher = DBusAddress("/org/a11y/bus", "org.a11y.Bus", "org.a11y.Bus")
        address = session.send_and_get_reply(new_method_call(launcher, "GetAddress"), timeout=PATIENCE).body[0]
        self._bus = open_dbus_connection(address)

    def _ask(self, node, interface, member, signature=None, body=()):
        address = DBusAddress(node[1], node[0], interface)
        reply = self._bus.send_and_get_reply(new_method_call(address, member, signature, body), timeout=PATIENCE)
        return None if reply.header.message_type is MessageType.error else reply.body[0]

    def _children(self, node):
        return self._ask(node, "org.a11y.atspi.Accessible", "GetChildren") or []

    def _walk(self, node):
        state = self._ask(node, "org.a11y.atspi.Accessible", "GetState")
        if not state or not state[0] & self.SHOWING:
            return
        name = self._ask(node, "org.freedesktop.DBus.Properties", "Get", "ss", ("org.a11y.atspi.Accessible", "Name"))
        role = self._ask(node, "org.a11y.atspi.Accessible", "GetRoleName")
        box = self._ask(node, "org.a11y.atspi.Component", "GetExtents", "u", (0,))
        if name and box:
            yield Node(role, name[1], box, bool(state[0] & self.ENABLED))
        for child in self._children(node):
            yield from self._walk(tuple(child))

    def see(self):
        """Everything the application shows now, in reading order."""
        registry = ("org.a11y.atspi.Registry", self.ROOT)
        return [node for application in self._children(registry) for window in self._children(tuple(application))
                for node in self._walk(tuple(window))]


class Window:
    """The application's window."""

    def __init__(self, desktop, size=(412, 732), title="^Kelvo$"):
        self._desktop = desktop
        self._title = title
        self._eyes = None
        self._scale = int(desktop.environment["QT_SCALE_FACTOR"])
        self._id = wait_for(self._find, "the window")
        self.resize(*size)
        self._tool("windowmove", self._id, 0, 0)
        self._tool("windowfocus", "--sync", self._id)

    def resize(self, width, height):
        self._tool("windowsize", "--sync", self._id, width * self._scale, height * self._scale)

    def _find(self):
        found = subprocess.run(["xdotool", "search", "--onlyvisible", "--name", self._title], capture_output=True,
                               text=True, env=self._desktop.environment, check=False)
        return found.stdout.split()[0] if found.stdout else None

    def _tool(self, *arguments):
        self._desktop.run("xdotool", *arguments)

    def see(self):
        self._eyes = self._eyes or Eyes(self._desktop)
        return self._eyes.see()

    def find(self, name, role=None):
        """The first thing within reach that is called `name`, or whose name the callable `name` accepts; else none."""
        accepts = name if callable(name) else lambda text: text == name
        return next((node for node in self.see()
                     if node.enabled and accepts(node.name) and role in (None, node.role)), None)

    def wait(self, name, role=None):
        return wait_for(lambda: self.find(name, role), f"{name if isinstance(name, str) else 'a text'} on the screen")

    def rest(self):
        """Waits until nothing moves any more."""
        def boxes():
            return [node.box for node in self.see()]

        wait_for(lambda: boxes() == boxes(), "the screen to rest")

    def click(self, name, role=None):
        """Clicks the middle of something once it stands still."""
        self.wait(name, role)
        self.rest()
        left, top, width, height = self.wait(name, role).box
        middle = ((left + width // 2) * self._scale, (top + height // 2) * self._scale)
        self._tool("mousemove", *middle, "click", 1)

    def key(self, *names):
        self._tool("key", *names)

    def type(self, text):
        self._tool("type", text)

    def picture(self, path):
        self._desktop.run("import", "-window", self._id, path)
