"""The widget's window on a Wayland display that nobody looks at."""

import glob
import pathlib
import shutil
import subprocess
import unittest

from display import Display
from window_support import WindowTest, works

SOCKET = "orvo-test"


class Wayland(WindowTest):
    def setUp(self):
        if not shutil.which("weston"):
            self.skipTest("there is no weston")
        if not glob.glob("/usr/lib/*/qt6/plugins/platforms/libqwayland-generic.so"):
            self.skipTest("the toolkit has no plugin for Wayland (qt6-wayland)")
        super().setUp()
        self.start_compositor()
        self.live_feed(works(1, "Works on 1"), works(2, "Works on 2"))

    def start_compositor(self, shell="desktop-shell.so"):
        compositor = subprocess.Popen(
            ["weston", "--backend=headless-backend.so", f"--shell={shell}", f"--socket={SOCKET}", "--idle-time=0", "--no-config"],
            env=self.environment, stdout=subprocess.DEVNULL, stderr=subprocess.DEVNULL)
        self.addCleanup(compositor.wait)
        self.addCleanup(compositor.terminate)
        socket = pathlib.Path(self.environment["XDG_RUNTIME_DIR"], SOCKET)

        def is_there():
            self.assertIsNone(compositor.poll(), "weston has ended")
            return socket.exists()
        Display.eventually(self, is_there, "weston makes a display")

    def on_display(self):
        return {"WAYLAND_DISPLAY": SOCKET}

    def find_window(self, process):
        pass  # there is no other

    def test_shows_rows_changes_its_mode_and_keeps_the_choice(self):
        self.open_widget()
        self.shows("2 advisories")
        self.button().press()
        self.shows("Works on 1", "Works on 2", "Good service")
        self.close_widget()
        self.open_widget(XDG_ACTIVATION_TOKEN="from-a-launcher")
        self.shows("Works on 1", "Works on 2", "Good service")
        self.parts("list item")[0].press()
        self.eventually(lambda: "Works on 1" in self.handed_over(), "the row's incident is handed over")
        self.close_widget()


class WaylandKiosk(Wayland):
    """A desktop that makes every window as large as the display, and shows none while nobody has a keyboard."""

    def start_compositor(self, shell="kiosk-shell.so"):
        super().start_compositor(shell)


if __name__ == "__main__":
    unittest.main()
