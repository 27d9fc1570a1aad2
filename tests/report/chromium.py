"""A headless Chromium that a test drives over a pipe, in the words of its DevTools protocol."""
import base64
import fcntl
import itertools
import json
import os
import subprocess
import tempfile

FLAGS = ["--headless=new", "--no-sandbox", "--disable-gpu", "--disable-quic", "--no-first-run", "--disable-background-networking",
         "--disable-component-update", "--disable-sync", "--disable-default-apps", "--hide-scrollbars",
         "--force-device-scale-factor=1", "--remote-debugging-pipe"]


class Browser:
    """One page in a browser with an empty profile of its own."""

    def __init__(self, width=1280, height=800):
        self._profile = tempfile.TemporaryDirectory(ignore_cleanup_errors=True)
        reads, theirs_out = os.pipe()
        theirs_in, writes = os.pipe()
        high = [fcntl.fcntl(fd, fcntl.F_DUPFD, 20) for fd in (theirs_in, theirs_out)]

        def place():
            os.dup2(high[0], 3)
            os.dup2(high[1], 4)

        self._process = subprocess.Popen(
            ["chromium", *FLAGS, f"--user-data-dir={self._profile.name}", f"--window-size={width},{height}", "about:blank"],
            preexec_fn=place, pass_fds=(3, 4), stdin=subprocess.DEVNULL, stdout=subprocess.DEVNULL, stderr=subprocess.DEVNULL)
        for fd in (theirs_in, theirs_out, *high):
            os.close(fd)
        self._writes = os.fdopen(writes, "wb", buffering=0)
        self._reads = os.fdopen(reads, "rb", buffering=0)
        self._rest = b""
        self._numbers = itertools.count(1)
        self.events = []
        self._session = None
        target = self.call("Target.createTarget", url="about:blank")["targetId"]
        self._session = self.call("Target.attachToTarget", targetId=target, flatten=True)["sessionId"]
        for domain in ("Page", "Runtime", "Log", "Network"):
            self.call(domain + ".enable")
        self.size(width, height)

    def __enter__(self):
        return self

    def __exit__(self, *_):
        self._process.terminate()
        try:
            self._process.wait(20)
        except subprocess.TimeoutExpired:
            self._process.kill()
            self._process.wait()
        self._profile.cleanup()

    def _next(self):
        while b"\0" not in self._rest:
            piece = self._reads.read(1 << 16)
            if not piece:
                raise RuntimeError("the browser has gone")
            self._rest += piece
        message, _, self._rest = self._rest.partition(b"\0")
        return json.loads(message)

    def call(self, method, **parameters):
        """The answer to one call; what the browser tells meanwhile is kept in `events`."""
        number = next(self._numbers)
        message = {"id": number, "method": method, "params": parameters}
        if self._session:
            message["sessionId"] = self._session
        self._writes.write(json.dumps(message).encode() + b"\0")
        while True:
            answer = self._next()
            if answer.get("id") == number:
                if "error" in answer:
                    raise RuntimeError(f"{method}: {answer['error']}")
                return answer["result"]
            self.events.append(answer)

    def wait(self, method):
        """Until the browser tells of `method`."""
        while not any(event.get("method") == method for event in self.events):
            self.events.append(self._next())

    def size(self, width, height, mobile=False):
        self.call("Emulation.setDeviceMetricsOverride", width=width, height=height, deviceScaleFactor=1, mobile=mobile)
        self.call("Emulation.setTouchEmulationEnabled", enabled=mobile, maxTouchPoints=5 if mobile else 1)

    def prefer(self, scheme="light", media=""):
        self.call("Emulation.setEmulatedMedia", media=media, features=[{"name": "prefers-color-scheme", "value": scheme}])

    def open(self, path):
        self.events.clear()
        self.call("Page.navigate", url="file://" + os.path.abspath(path))
        self.wait("Page.loadEventFired")

    def value(self, expression):
        """What the page makes of a JavaScript expression."""
        answer = self.call("Runtime.evaluate", expression=expression, returnByValue=True, awaitPromise=True)
        if "exceptionDetails" in answer:
            raise RuntimeError(f"{expression}: {answer['exceptionDetails']}")
        return answer["result"].get("value")

    def key(self, key, text="", shift=False):
        kind = {"key": key, "code": key, "modifiers": 8 if shift else 0}
        codes = {"Enter": 13, "ArrowRight": 39, "ArrowLeft": 37, "Home": 36, "End": 35, "Tab": 9}
        if key in codes:
            kind["windowsVirtualKeyCode"] = codes[key]
        if text:
            kind["text"] = text
        self.call("Input.dispatchKeyEvent", type="keyDown", **kind)
        self.call("Input.dispatchKeyEvent", type="keyUp", **{k: v for k, v in kind.items() if k != "text"})

    def mouse(self, kind, x, y, buttons=0):
        self.call("Input.dispatchMouseEvent", type=kind, x=x, y=y, button="left" if kind != "mouseMoved" else "none",
                  buttons=buttons, clickCount=1)

    def touch(self, kind, *points):
        """Fingers at these places, each under the number of its place in the list; none when the last is lifted."""
        self.call("Input.dispatchTouchEvent", type=kind, touchPoints=[{"x": x, "y": y, "id": i} for i, (x, y) in enumerate(points)])

    def screenshot(self, path, whole=False):
        picture = self.call("Page.captureScreenshot", format="png", captureBeyondViewport=whole)
        with open(path, "wb") as file:
            file.write(base64.b64decode(picture["data"]))

    def pdf(self, path):
        printed = self.call("Page.printToPDF", preferCSSPageSize=True, printBackground=True)
        with open(path, "wb") as file:
            file.write(base64.b64decode(printed["data"]))

    def complaints(self):
        """Errors and warnings that the page has caused."""
        found = []
        for event in self.events:
            parameters = event.get("params", {})
            if event.get("method") == "Runtime.exceptionThrown":
                found.append(str(parameters["exceptionDetails"]))
            elif event.get("method") == "Runtime.consoleAPICalled" and parameters["type"] in ("error", "warning", "assert"):
                found.append(str(parameters["args"]))
            elif event.get("method") == "Log.entryAdded" and parameters["entry"]["level"] in ("error", "warning"):
                found.append(parameters["entry"]["text"])
        return found

    def requests(self):
        """The addresses that the page has asked for."""
        return [event["params"]["request"]["url"] for event in self.events
                if event.get("method") == "Network.requestWillBeSent"]
