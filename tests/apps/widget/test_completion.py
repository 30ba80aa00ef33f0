"""The widget's program in the shells: its own script, offered words, and both programs side by side."""

import os
import pathlib
import subprocess
import unittest

from completing import Completing
from support import PROGRAM
from widget_support import WIDGET, WidgetTest

NAME = "orvo-transit-widget"
FOLDERS = [os.path.dirname(WIDGET), os.path.dirname(PROGRAM)]
INSTALLED = (("bash", f"{NAME}.bash"), ("zsh", f"_{NAME}"), ("fish", f"{NAME}.fish"))


class WidgetCompletion(Completing, WidgetTest):
    def script(self, shell):
        return self.widget("--completion", shell).out

    def offered(self, shell, line):
        return getattr(self, f"offered_by_{shell}")(self.script(shell), line, FOLDERS)

    def test_installed_scripts_are_what_the_program_prints(self):
        folder = pathlib.Path(os.environ["ORVO_SOURCE"]) / "packaging/completions"
        for shell, name in INSTALLED:
            printed = self.script(shell)
            if os.environ.get("ORVO_UPDATE_EXPECTATIONS"):
                (folder / name).write_text(printed)
            self.assertEqual(printed, (folder / name).read_text(), f"update with ORVO_UPDATE_EXPECTATIONS=1: {name}")

    def test_shells_can_read_them(self):
        for shell, name in INSTALLED:
            subprocess.run([shell, "-n", self.write(name, self.script(shell).encode())], check=True)

    def test_a_shell_that_is_none_of_them_is_wrong_usage(self):
        self.assertIn("bash, zsh, fish", self.widget_refused(2, "--completion", "csh").err)

    def offers_options_values_and_files(self, shell):
        (self.home / "my pictures").mkdir()
        (self.home / "card.png").touch()
        options = self.offered(shell, f"{NAME} --")
        for option in ("--print", "--follow", "--snapshot", "--max-rows", "--demo", "--completion", "--help"):
            self.assertIn(option, options)
        self.assertEqual(self.offered(shell, f"{NAME} --print "), ["json", "text", "waybar"])
        self.assertEqual(self.offered(shell, f"{NAME} --demo --follow --print w"), ["waybar"])
        self.assertIn("AX5", self.offered(shell, f"{NAME} --dark --text-size "))
        self.assertIn("card.png", self.offered(shell, f"{NAME} --snapshot ca"))

    def test_bash_offers_options_values_and_files(self):
        self.offers_options_values_and_files("bash")
        # As it is: readline puts the backslash before the blank.
        self.assertEqual(self.offered("bash", f"{NAME} --snapshot my"), ["my pictures"])

    def test_zsh_offers_options_values_and_files(self):
        self.offers_options_values_and_files("zsh")

    def test_fish_offers_options_values_and_files(self):
        self.offers_options_values_and_files("fish")

    def test_both_programs_have_their_own_words_in_one_shell(self):
        for shell in ("bash", "fish"):
            both = self.script(shell) + self.orvo("completion", shell).out
            offered = getattr(self, f"offered_by_{shell}")
            self.assertEqual(offered(both, f"{NAME} --print j", FOLDERS), ["json"], shell)
            self.assertEqual(offered(both, "orvo feeds re", FOLDERS), ["remove"], shell)


if __name__ == "__main__":
    unittest.main()
