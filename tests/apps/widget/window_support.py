"""A display, an accessibility bus and a feed of one's own, for tests of the widget's window."""

import http.server
import os
import pathlib
import signal
import struct
import subprocess
import sys
import threading
import time

from assistive import PROPERTIES, SERVICE, AssistiveTools
from display import Display
from handing import NAME, BusTest
from support import feed
from widget_support import NOW, WIDGET, WidgetTest, alert, period, selector, text

PATIENCE = float(os.environ.get("ORVO_TEST_PATIENCE", "90"))  # seconds, for machines that do much besides
CARD_WIDTH, COMPACT_HEIGHT = 359, 146


class AlertServer(http.server.ThreadingHTTPServer):
    """Serves alerts that a test changes, and counts who asks."""

    daemon_threads = True

    def __init__(self):
        super().__init__(("127.0.0.1", 0), AlertHandler)
        self.content = feed(NOW)
        self.asked = 0
        self.fails = False
        self.may_answer = threading.Event()
        self.may_answer.set()
        threading.Thread(target=self.serve_forever, kwargs={"poll_interval": 0.02}, daemon=True).start()

    @property
    def url(self):
        return f"http://127.0.0.1:{self.server_port}/alerts.pb"

    def tell(self, *alerts):
        self.content = feed(int(time.time()), *alerts)

    def end(self):
        self.may_answer.set()
        self.shutdown()
        self.server_close()

    def handle_error(self, request, client_address):
        pass  # a widget that is killed in the middle


class AlertHandler(http.server.BaseHTTPRequestHandler):
    def do_GET(self):
        self.server.asked += 1
        self.server.may_answer.wait(PATIENCE)
        content = self.server.content
        self.send_response(503 if self.server.fails else 200)
        self.send_header("Content-Length", str(len(content)))
        self.end_headers()
        self.wfile.write(content)

    def log_message(self, *words):
        pass


class WindowTest(Display, AssistiveTools, BusTest, WidgetTest):
    """The widget in a window of a display that nobody looks at, beside a session bus with assistive tools."""

    patience = PATIENCE

    @classmethod
    def setUpClass(cls):
        cls.find_tools()
        cls.start_display()

    def start_bus(self):
        self.forget_displays()  # what the bus starts shows nothing here
        super().start_bus()
        self.environment["DBUS_SYSTEM_BUS_ADDRESS"] = "disabled:"

    def system_bus(self):
        """The address of a bus in the place of the machine's, for what is opened from now on."""
        bus = subprocess.Popen(["dbus-daemon", f"--config-file={self.home}/bus.conf", "--nofork", "--print-address",
                                f"--address=unix:path={self.home}/system"],
                               env=self.environment, stdout=subprocess.PIPE, stderr=subprocess.DEVNULL)
        self.addCleanup(self.end, bus)
        self.environment["DBUS_SYSTEM_BUS_ADDRESS"] = bus.stdout.readline().decode().strip()
        return self.environment["DBUS_SYSTEM_BUS_ADDRESS"]

    def live_feed(self, *alerts):
        """The person's own feed, whose alerts come from a server that tells these first."""
        self.server = AlertServer()
        self.addCleanup(self.server.end)
        self.server.tell(*alerts)
        self.orvo("feeds", "add", "city", "--static", self.schedule(), "--alerts", self.server.url)
        self.orvo("favorites", "add", *(f"city:r{number}" for number in (1, 2, 3)))
        self.server.asked = 0

    # The widget

    def open_widget(self, *words, **environment):
        process = subprocess.Popen([WIDGET, *words], cwd=self.home, stdout=subprocess.PIPE, stderr=subprocess.PIPE,
                                   env={**self.environment, **self.on_display(), **environment})
        for cleanup in (process.stdout.close, process.stderr.close, process.wait, process.kill):
            self.addCleanup(cleanup)
        self.process = process
        self.eventually(lambda: self.parts("list"), "the widget tells assistive tools of its rows")
        self.find_window(process)
        return process

    def on_display(self):
        """What tells a program which display to use."""
        return {"DISPLAY": self.display}

    def find_window(self, process):
        """And types into it from now on."""
        self.window = self.xdotool("search", "--all", "--onlyvisible", "--pid", process.pid, "--name", ".").split()[0]
        self.xdotool("windowfocus", "--sync", self.window)

    def close_widget(self, how=signal.SIGTERM):
        """As the person's closing; nothing was said."""
        self.process.send_signal(how)
        self.has_closed()

    def has_closed(self):
        out, err = self.process.communicate(timeout=PATIENCE)
        self.assertEqual((self.process.returncode, out, err), (0, b"", b""))

    def kill_widget(self):
        self.process.kill()
        self.process.wait(PATIENCE)

    def eventually(self, look, what):
        """Until it holds, while the widget lives; answers what was seen."""
        def look_at_widget():
            try:
                seen = look()
            except (self.dbus.DBusException, FileNotFoundError):
                seen = None  # it went while it was asked
            if not seen and self.process.poll() is not None:
                self.fail(f"{what}: the widget has ended: {self.process.stderr.read().decode()}")
            return seen
        return super().eventually(look_at_widget, what)

    # What it shows

    def parts(self, role):
        """Its elements of that role."""
        return self.parts_of(self.process, role)

    def rows(self):
        """The spoken titles of its rows."""
        return [row.title for row in self.parts("list item")]

    def shows(self, *starts):
        """Until its rows begin so, and are no more."""
        def look():
            rows = self.rows()
            self.seen = rows
            return len(rows) == len(starts) and all(row.startswith(start) for row, start in zip(rows, starts))
        try:
            self.eventually(look, f"the rows begin with {starts}")
        except AssertionError as error:
            raise AssertionError(f"{error}; they are {self.seen}") from None

    def button(self):
        (button,) = self.parts("push button")
        return button

    def height(self):
        geometry = self.xdotool("getwindowgeometry", "--shell", self.window).split()
        return int(dict(line.split("=") for line in geometry)["HEIGHT"])

    def is_high(self, height):
        self.eventually(lambda: self.height() == height, f"the window is {height} high")

    def color_at(self, x, y):
        """Of the display's pixel, as #rrggbb."""
        with self.pixels.open("rb") as file:
            header = struct.unpack(">25I", file.read(100))
            start, width, colors = header[0], header[12], header[19]
            file.seek(start + 12 * colors + y * width + 4 * x)
            blue, green, red, _ = file.read(4)
        return f"#{red:02x}{green:02x}{blue:02x}"

    def alarms(self):
        """In how many seconds each of the kernel's timers that it has set goes off."""
        process = pathlib.Path("/proc", str(self.process.pid))
        timers = [file.name for file in (process / "fd").iterdir() if "timerfd" in os.readlink(file)]
        told = [(process / "fdinfo" / name).read_text() for name in timers]
        seconds = [int(text.split("it_value: (")[1].split(",")[0]) for text in told]
        nothing = "it_value: (0, 0)"
        return [second for second, text in zip(seconds, told) if nothing not in text]

    # What a person does

    def click(self, part):
        x, y = part.middle
        self.xdotool("mousemove", "--sync", x, y, "click", 1)

    def keys(self, *names):
        self.xdotool("key", "--delay", "30", *names)

    def handed_over(self):
        """What `orvo` shows of the last tap."""
        return self.run_orvo("show").out


class MockService:
    """Stands in for a service of the desktop, on the bus at that address."""

    def __init__(self, test, address, name, path, interface):
        self._test, self._name, self._path, self._interface = test, name, path, interface
        environment = {**test.environment, "DBUS_SESSION_BUS_ADDRESS": address}
        process = subprocess.Popen([sys.executable, "-m", "dbusmock", name, path, interface], env=environment,
                                   stdout=subprocess.DEVNULL, stderr=subprocess.DEVNULL)
        test.addCleanup(process.wait)
        test.addCleanup(process.terminate)
        self._process = process
        subprocess.run(["gdbus", "wait", "--session", "--timeout", str(int(PATIENCE)), name], env=environment, check=True)
        self._connection = test.connect(address)

    def end(self):
        self._process.terminate()
        self._process.wait(PATIENCE)

    def _mock(self, method, *arguments):
        return self._connection.get_object(self._name, self._path, introspect=False).get_dbus_method(
            method, "org.freedesktop.DBus.Mock")(*arguments)

    def add_object(self, path, interface, properties):
        dbus = self._test.dbus
        self._mock("AddObject", path, interface, dbus.Dictionary(properties, signature="sv"),
                   dbus.Array([], signature="(ssss)"))
        added = object.__new__(MockService)
        added.__dict__ = {**self.__dict__, "_path": path, "_interface": interface}
        return added

    def add_property(self, name, value):
        self._mock("AddProperty", self._interface, name, value)

    def add_method(self, name, takes, answers, code):
        self._mock("AddMethod", self._interface, name, takes, answers, code)

    def was_asked(self, name):
        """Whether that method was called."""
        return len(self._mock("GetMethodCalls", name)) > 0

    def update(self, interface, properties):
        self._mock("UpdateProperties", interface, self._test.dbus.Dictionary(properties, signature="sv"))

    def emit(self, signal_name, signature, *arguments):
        self._mock("EmitSignal", self._interface, signal_name, signature,
                   self._test.dbus.Array(arguments, signature="v"))


def works(number, title, start=None, end=None, **titles):
    """An alert for a line of the small schedule, in English and in the languages that are named."""
    return alert(selector(route=f"r{number}"), *([period(start, end)] if start or end else []), text(10, en=title, **titles))


__all__ = ["CARD_WIDTH", "COMPACT_HEIGHT", "MockService", "NAME", "NOW", "PATIENCE", "PROPERTIES", "SERVICE", "WindowTest", "signal", "sys",
           "works"]
