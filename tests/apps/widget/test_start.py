"""What a start of the widget loads: each library costs time and memory until the first frame, also those of fetches to come."""

import os
import subprocess
import unittest


class Start(unittest.TestCase):
    def test_what_only_fetches_need_is_not_loaded(self):
        # The loader tells what it would load, and runs nothing.
        loaded = subprocess.run([os.environ["ORVO_WIDGET"]], env={**os.environ, "LD_TRACE_LOADED_OBJECTS": "1"},
                                capture_output=True, text=True, timeout=60).stdout
        self.assertIn("libQt6Gui.so", loaded)
        for library in ("libQt6Network.so", "libQt6Widgets.so", "libzip.so"):
            self.assertNotIn(library, loaded)


if __name__ == "__main__":
    unittest.main()
