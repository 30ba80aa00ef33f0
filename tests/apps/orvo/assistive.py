"""An accessibility bus of one's own, and what a program tells assistive tools on it."""

import os
import unittest

ACCESSIBLE = "org.a11y.atspi.Accessible"
PROPERTIES = "org.freedesktop.DBus.Properties"
REGISTRY = ("org.a11y.atspi.Registry", "/org/a11y/atspi/accessible/root")
BUS_LAUNCHERS = ("/usr/libexec/at-spi-bus-launcher", "/usr/lib/at-spi2-core/at-spi-bus-launcher")
SERVICE = "[D-BUS Service]\nName={}\nExec={}\n"


class Part:
    """An element that assistive tools are told of."""

    def __init__(self, connection, name, path):
        self._connection, self._name, self._path = connection, name, path

    def _call(self, interface, method, *arguments):
        proxy = self._connection.get_object(self._name, self._path, introspect=False)
        return proxy.get_dbus_method(method, interface)(*arguments)

    @property
    def title(self):
        return str(self._call(PROPERTIES, "Get", ACCESSIBLE, "Name"))

    @property
    def role(self):
        return str(self._call(ACCESSIBLE, "GetRoleName"))

    @property
    def children(self):
        return [Part(self._connection, *reference) for reference in self._call(ACCESSIBLE, "GetChildren")]

    @property
    def process(self):
        bus = self._connection.get_object("org.freedesktop.DBus", "/org/freedesktop/DBus", introspect=False)
        return int(bus.GetConnectionUnixProcessID(self._name, dbus_interface="org.freedesktop.DBus"))

    @property
    def states(self):
        low, high = self._call(ACCESSIBLE, "GetState")
        return int(low) | int(high) << 32

    @property
    def is_focused(self):
        return bool(self.states >> 12 & 1)  # ATSPI_STATE_FOCUSED

    @property
    def is_showing(self):
        return bool(self.states >> 25 & 1)  # ATSPI_STATE_SHOWING

    @property
    def actions(self):
        return [str(name) for name, *_ in self._call("org.a11y.atspi.Action", "GetActions")]

    @property
    def middle(self):
        x, y, width, height = map(int, self._call("org.a11y.atspi.Component", "GetExtents", 0))
        return x + width // 2, y + height // 2

    def press(self):
        self._call("org.a11y.atspi.Action", "DoAction", 0)


def parts_of(root):
    """The element and all below it."""
    found = [root]
    for child in root.children:
        found += parts_of(child)
    return found


class AssistiveTools:
    """For a test with a session bus: assistive tools beside it, which want to be told everything."""

    @classmethod
    def find_tools(cls):
        cls.launcher = next((path for path in BUS_LAUNCHERS if os.path.exists(path)), None)
        if not cls.launcher:
            raise unittest.SkipTest("there is no at-spi-bus-launcher (at-spi2-core)")
        try:
            import dbus
        except ImportError as error:
            raise unittest.SkipTest("there is no python3-dbus") from error
        cls.dbus = dbus

    def bus_with(self, services):
        self.environment["GSETTINGS_BACKEND"] = "memory"  # else what is switched on is asked of a service that is not there
        folder = self.home / "tools"
        folder.mkdir()
        (folder / "org.a11y.Bus.service").write_text(SERVICE.format("org.a11y.Bus", self.launcher))
        super().bus_with(f"{services}<servicedir>{folder}</servicedir>")
        self.session = self.connect(self.environment["DBUS_SESSION_BUS_ADDRESS"])
        tools = self.session.get_object("org.a11y.Bus", "/org/a11y/bus", introspect=False)
        for switch in ("IsEnabled", "ScreenReaderEnabled"):
            tools.Set("org.a11y.Status", switch, self.dbus.Boolean(True, variant_level=1), dbus_interface=PROPERTIES)
        self.tools = self.connect(str(tools.GetAddress(dbus_interface="org.a11y.Bus")))

    def connect(self, address):
        connection = self.dbus.bus.BusConnection(address)
        self.addCleanup(connection.close)
        return connection

    def parts_of(self, process, role):
        """The elements of that role of a process, in their order."""
        own = [child for child in Part(self.tools, *REGISTRY).children if child.process == process.pid]
        return [part for application in own for part in parts_of(application) if part.role == role]
