"""A display that nobody looks at, and a hand on its pointer and its keys."""

import os
import pathlib
import shutil
import subprocess
import tempfile
import time
import unittest


class Display:
    """For a `ProgramTest`."""

    patience = 60  # seconds

    @classmethod
    def start_display(cls):
        """One for all tests of the class; skips them where it cannot be had."""
        for program in ("Xvfb", "xdotool"):
            if not shutil.which(program):
                raise unittest.SkipTest(f"there is no {program}")
        folder = tempfile.TemporaryDirectory(prefix="orvo-display-")
        cls.addClassCleanup(folder.cleanup)
        cls.pixels = pathlib.Path(folder.name) / "Xvfb_screen0"
        told, tells = os.pipe()
        server = subprocess.Popen(["Xvfb", "-displayfd", str(tells), "-screen", "0", "1280x1024x24", "-nolisten", "tcp",
                                   "-noreset", "-fbdir", folder.name],
                                  pass_fds=[tells], stdout=subprocess.DEVNULL, stderr=subprocess.DEVNULL)
        cls.addClassCleanup(server.wait)
        cls.addClassCleanup(server.terminate)
        os.close(tells)
        with os.fdopen(told) as answer:
            cls.display = ":" + answer.readline().strip()

    def forget_displays(self):
        """What is started from now on knows of none, and has a folder of its own for sockets."""
        for name in ("QT_QPA_PLATFORM", "DISPLAY", "WAYLAND_DISPLAY"):
            self.environment.pop(name, None)
        runtime = self.home / "runtime"
        runtime.mkdir(mode=0o700)
        self.environment["XDG_RUNTIME_DIR"] = str(runtime)

    def xdotool(self, *words, check=True):
        return subprocess.run(["xdotool", *map(str, words)], env={**self.environment, "DISPLAY": self.display},
                              check=check, capture_output=True, text=True, timeout=self.patience).stdout

    def eventually(self, look, what):
        """Until it holds; answers what was seen."""
        deadline = time.monotonic() + self.patience
        while not (seen := look()):
            if time.monotonic() > deadline:
                self.fail(f"not so: {what}")
            time.sleep(0.02)
        return seen
