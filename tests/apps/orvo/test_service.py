"""The application on the session bus."""

import os
import pty
import select
import subprocess
import unittest

from handing import INTERFACE, NAME, PATH, PATIENCE, BusTest, incident, line, tap_on_line

WIDGET = os.environ["ORVO_WIDGET"]


class Served(BusTest):
    def test_the_bus_starts_it_for_an_activity(self):
        self.assertFalse(self.is_running())
        answer = self.hand_over("activity", given=tap_on_line(line("U1", incident("Works"))))
        self.assertEqual(answer.returncode, 0, answer.stderr)
        self.assertTrue(self.is_running())
        self.assertIn("Works", self.orvo("show").out)

    def test_the_one_that_runs_takes_what_comes_next(self):
        self.hand_over("open", "orvo://?t=r")
        first = self.owner()
        self.hand_over("activity", given=tap_on_line(line("U1")))
        self.assertEqual(self.owner(), first)
        self.assertIn("U1", self.orvo("show").out)

    def test_a_hostile_activity_is_refused_with_the_reason_and_it_runs_on(self):
        self.hand_over("activity", given=tap_on_line(line("U1")))
        first = self.owner()
        answer = self.hand_over("activity", given=b"junk")
        self.assertEqual(answer.returncode, 1)
        self.assertIn(b"no activity", answer.stderr)
        self.assertEqual(self.owner(), first)
        self.assertIn("U1", self.orvo("show").out)

    def test_the_demonstration_goes_along(self):
        answer = self.hand_over("--demo", "activity", given=tap_on_line(line("U1")))
        self.assertEqual(answer.returncode, 0, answer.stderr)
        self.assertIn("U1", self.orvo("show", "--demo").out)
        self.assertEqual(self.orvo("show").out, "")

    def test_taps_in_the_widget_arrive(self):
        for mode, told in (("compact", "4 incidents"), ("expanded", "Delays on M1 and M2")):
            finished = subprocess.run([WIDGET, "--demo", "--mode", mode, "--open", "0"], env=self.environment,
                                      cwd=self.home, capture_output=True, timeout=PATIENCE)
            self.assertEqual((finished.returncode, finished.stderr), (0, b""))
            self.assertIn(told, self.orvo("show", "--demo").out)
        self.assertTrue(self.is_running())
        self.assertEqual(self.orvo("show").out, "")

    def test_it_speaks_the_desktops_interface(self):
        for method, arguments in (("Activate", ["{}"]), ("Activate", ["{'activation-token': <'t'>}"]),
                                  ("Open", ["['orvo://?t=r', 'orvo://?favorites=2&t=r']", "{'x': <1>}"])):
            answer = self.ask(NAME, PATH, f"{INTERFACE}.{method}", *arguments)
            self.assertEqual(answer.returncode, 0, answer.stderr)
        self.assertIn("No favourite lines", self.orvo("show").out)
        for method, arguments, reason in (("Open", ["['https://t.example']", "{}"], "no URL of this application"),
                                          ("ActivateAction", ["Explode", "[<b'x'>]", "{}"], "no action"),
                                          ("ActivateAction", ["ContinueUserActivity", "[]", "{}"], "parameter"),
                                          ("ActivateAction", ["ContinueUserActivity", "[<'text'>]", "{}"], "bytes")):
            answer = self.ask(NAME, PATH, f"{INTERFACE}.{method}", *arguments)
            self.assertNotEqual(answer.returncode, 0)
            self.assertIn(reason, answer.stderr)


class OneInstance(BusTest):
    activates = False

    def test_a_second_one_does_not_start(self):
        self.serve()
        answer = self.refused(1, "service")
        self.assertIn("runs already", answer.err)

    def test_it_ends_when_nothing_was_asked_for_some_time(self):
        process = self.serve("--idle", "1")
        self.assertEqual(process.wait(PATIENCE), 0)
        self.assertFalse(self.is_running())

    def test_it_ends_with_its_bus(self):
        process = self.serve("--idle", "600")
        self.end(self.bus)
        self.assertEqual(process.wait(PATIENCE), 0)

    def test_idle_is_a_number(self):
        self.assertIn("--idle", self.refused(2, "service", "--idle", "soon").err)

    def test_without_a_bus_there_is_nothing_to_serve_on(self):
        self.environment["DBUS_SESSION_BUS_ADDRESS"] = "disabled:"
        self.assertIn("no session bus", self.refused(1, "service").err)

    def test_open_hands_over_to_the_one_that_runs(self):
        leader, follower = pty.openpty()
        self.addCleanup(os.close, leader)
        self.serve(stdin=follower, stdout=follower, stderr=follower)
        os.close(follower)
        told = self.orvo("open", "orvo://?t=r").out
        self.assertIn("No favourite lines yet", self.on_terminal(leader, "favorites add LINE"))
        self.assertEqual(self.orvo("show").out, told)
        answer = subprocess.run(self.command("receive", "ContinueUserActivity"), env=self.environment, cwd=self.home,
                                input=tap_on_line(line("U1")), capture_output=True, timeout=PATIENCE)
        self.assertEqual(answer.returncode, 0, answer.stderr)
        self.assertIn("Metro", self.on_terminal(leader, "Good service"))

    def on_terminal(self, leader, last):
        """What the terminal shows up to that text."""
        shown = ""
        while last not in shown:
            ready, _, _ = select.select([leader], [], [], PATIENCE)
            self.assertTrue(ready, f"nothing came after: {shown}")
            shown += os.read(leader, 65536).decode()
        return shown


if __name__ == "__main__":
    unittest.main()
