"""What travels from the widget, made by hand, and a session bus of one's own."""

import bz2
import os
import pathlib
import plistlib
import re
import shutil
import subprocess
import tempfile

from support import ProgramTest, field

HAND_OVER = os.environ["ORVO_HAND_OVER"]
PATIENCE = 60
NAME = "com.zentu.Orvo"
PATH = "/com/zentu/Orvo"
INTERFACE = "org.freedesktop.Application"


def incident(title, **texts):
    """A storable incident as a message."""
    numbers = {"summary": 6, "description": 7, "feed": 16, "link": 23, "zone": 24}
    return field(1, 1) + field(5, title) + b"".join(field(numbers[name], text) for name, text in texts.items())


def line(name, *incidents, system="Metro"):
    """A storable line item as a message."""
    return (field(1, 7) + field(2, name) + field(3, field(1, system)) + b"".join(field(13, one) for one in incidents)
            + field(14, 1))


def line_message(line_item):
    """The message of a tap on a row: how to show it, and the line."""
    return field(1, field(1, 3)) + field(15, line_item)


def activity(kind, key, payload):
    return plistlib.dumps({"activityType": f"com.zentu.Orvo.Transit.{kind}", "userInfo": {key: payload}},
                          fmt=plistlib.FMT_BINARY)


def tap_on_line(line_item):
    return activity("Incident", "bs", bz2.compress(line_message(line_item)))


def archive(*incidents, name="TransitStorageIncident"):
    """A keyed archive of a list of incidents."""
    uid = plistlib.UID
    objects = ["$null", None, {"$classname": "NSArray", "$classes": ["NSArray", "NSObject"]},
               {"$classname": name, "$classes": [name, "NSObject"]}]
    references = []
    for one in incidents:
        references.append(uid(len(objects)))
        objects.append({"$class": uid(3), "message": uid(len(objects) + 1)})
        objects.append(one)
    objects[1] = {"$class": uid(2), "NS.objects": references}
    return plistlib.dumps({"$archiver": "NSKeyedArchiver", "$version": 100000, "$top": {"root": uid(1)},
                           "$objects": objects}, fmt=plistlib.FMT_BINARY)


def tap_on_incidents(*incidents):
    return activity("IncidentList", "incidentListKey", archive(*incidents))


class BusTest(ProgramTest):
    """With a session bus that starts the program when it is asked for it, as where it is installed."""

    activates = True

    def setUp(self):
        super().setUp()
        self.environment["PATH"] = f"{pathlib.Path(os.environ['ORVO_PROGRAM']).parent}:{os.environ['PATH']}"
        self.start_bus()

    def start_bus(self):
        if not shutil.which("dbus-daemon"):
            self.skipTest("there is no dbus-daemon")
        services = self.home / "services"
        services.mkdir()
        if self.activates:
            self.write_service(services, f'"{os.environ["ORVO_PROGRAM"]}" service --idle 600')
        self.bus_with(f"<servicedir>{services}</servicedir>")

    def write_service(self, folder, command):
        (folder / f"{NAME}.service").write_text(f"[D-BUS Service]\nName={NAME}\nExec={command}\n")

    def bus_with(self, services):
        # Not below the home folder: a socket's path must be short, and in an address without blanks.
        folder = tempfile.TemporaryDirectory(prefix="orvo-bus-", dir="/tmp")
        self.addCleanup(folder.cleanup)
        configuration = self.write("bus.conf", (
            '<!DOCTYPE busconfig PUBLIC "-//freedesktop//DTD D-Bus Bus Configuration 1.0//EN" '
            '"http://www.freedesktop.org/standards/dbus/1.0/busconfig.dtd">\n'
            f'<busconfig><type>session</type><listen>unix:path={folder.name}/bus</listen>{services}'
            f'<limit name="service_start_timeout">{PATIENCE * 1000}</limit>'
            '<policy context="default"><allow send_destination="*" eavesdrop="true"/><allow eavesdrop="true"/>'
            '<allow own="*"/></policy></busconfig>').encode())
        self.bus = bus = subprocess.Popen(["dbus-daemon", f"--config-file={configuration}", "--nofork", "--print-address"],
                               env=self.environment, stdout=subprocess.PIPE, stderr=subprocess.DEVNULL)
        self.addCleanup(self.end, bus)
        self.environment["DBUS_SESSION_BUS_ADDRESS"] = bus.stdout.readline().decode().strip()

    def end(self, process):
        """Ends a process of the test's own, and waits for it."""
        process.terminate()
        process.wait(PATIENCE)
        for stream in (process.stdout, process.stderr):
            if stream:
                stream.close()

    def ask_bus(self, method, *arguments):
        """The bus itself answers."""
        return self.ask("org.freedesktop.DBus", "/org/freedesktop/DBus", f"org.freedesktop.DBus.{method}", *arguments)

    def ask(self, name, path, method, *arguments):
        return subprocess.run(["gdbus", "call", "--session", "--timeout", str(PATIENCE), "--dest", name, "--object-path",
                               path, "--method", method, *arguments], env=self.environment, capture_output=True,
                              timeout=2 * PATIENCE, text=True)

    def is_running(self):
        return "true" in self.ask_bus("NameHasOwner", NAME).stdout

    def owner(self):
        """The process that serves the application."""
        answer = self.ask_bus("GetConnectionUnixProcessID", NAME)
        return int(re.fullmatch(r"\(uint32 (\d+),\)\n", answer.stdout)[1])

    def wait_for_owner(self, process):
        """Until the process serves the application."""
        subprocess.run(["gdbus", "wait", "--session", "--timeout", str(PATIENCE), NAME], env=self.environment, check=True)
        self.assertIsNone(process.poll())

    def serve(self, *words, **how):
        process = subprocess.Popen(self.command("service", *words), env=self.environment, cwd=self.home, **how)
        self.addCleanup(self.end, process)
        self.wait_for_owner(process)
        return process

    def hand_over(self, *words, given=b""):
        """Until it, and the program that it starts where nobody serves, have ended."""
        return subprocess.run([HAND_OVER, *words], env=self.environment, cwd=self.home, input=given,
                              capture_output=True, timeout=PATIENCE)
