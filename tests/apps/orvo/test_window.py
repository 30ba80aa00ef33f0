"""The windows of the application, on a display that nobody looks at."""

import os
import signal
import subprocess
import unittest

from assistive import AssistiveTools
from display import Display
from handing import INTERFACE, NAME, PATH, PATIENCE, BusTest, incident, line, tap_on_incidents, tap_on_line
from support import feed

WIDGET = os.environ["ORVO_WIDGET"]


class WindowTest(Display, BusTest):
    """With a display, which what the bus starts has too."""

    @classmethod
    def setUpClass(cls):
        cls.start_display()

    def start_bus(self):
        self.forget_displays()
        self.environment["DISPLAY"] = self.display
        super().start_bus()
        if self.activates:
            self.addCleanup(self.end_service)

    def end_service(self):
        """What the bus has started outlives the bus, and its windows the test."""
        if self.is_running():
            os.kill(self.owner(), signal.SIGTERM)
            self.eventually(lambda: not self.is_running() and not self.windows(), "the service has ended")

    def start(self, *words, **how):
        """Runs the program until it ends by itself, or the test does."""
        process = subprocess.Popen(self.command(*words), env=self.environment, cwd=self.home, stderr=subprocess.PIPE, **how)
        self.addCleanup(self.end, process)
        return process

    def tap(self, *words):
        finished = subprocess.run([WIDGET, "--demo", *words], env=self.environment, cwd=self.home, capture_output=True,
                                  timeout=PATIENCE)
        self.assertEqual((finished.returncode, finished.stderr), (0, b""))

    def windows(self):
        """Those that are seen, by their titles."""
        found = self.xdotool("search", "--onlyvisible", "--class", "^orvo$", check=False).split()
        return {self.xdotool("getwindowname", window, check=False).strip(): window for window in found}

    def window(self, title):
        """The window of that title, as soon as it is seen."""
        return self.eventually(lambda: self.windows().get(f"{title} — Orvo"), f"there is a window {title}")

    def keys(self, window, *names):
        self.xdotool("windowfocus", "--sync", window, "key", "--delay", "30", *names)

    def write_text(self, window, text):
        self.xdotool("windowfocus", "--sync", window, "type", "--delay", "30", text)


class Taps(WindowTest):
    def test_a_tap_on_a_row_opens_the_line_in_a_window(self):
        self.tap("--mode", "expanded", "--open", "0")
        self.window("M1 · Marrow Bay Transit")
        self.assertIn("Delays on M1 and M2", self.orvo("show", "--demo").out)

    def test_what_is_tapped_next_takes_the_place_in_the_window_of_the_one_that_runs(self):
        self.tap("--mode", "compact", "--open", "0")
        window = self.window("4 incidents")
        owner = self.owner()
        self.tap("--mode", "expanded", "--open", "1")
        self.assertEqual(self.window("4 · Marrow Bay Transit"), window)
        self.assertEqual(self.owner(), owner)

    def test_the_favourites_row_opens_the_favourites(self):
        self.tap("--mode", "expanded", "--open", "4")
        self.window("Favorite lines")

    def test_a_window_that_was_closed_comes_again(self):
        self.hand_over("activity", given=tap_on_line(line("U1", incident("Works"))))
        self.keys(self.window("U1 · Metro"), "Escape")
        self.eventually(lambda: not self.windows(), "the window is closed")
        self.hand_over("activity", given=tap_on_incidents(incident("Fire")))
        self.window("1 incident")

    def test_activation_shows_the_favourites(self):
        answer = self.ask(NAME, PATH, f"{INTERFACE}.Activate", "{}")
        self.assertEqual(answer.returncode, 0, answer.stderr)
        self.window("Favorite lines")

    def test_what_cannot_be_read_opens_nothing(self):
        self.assertEqual(self.hand_over("activity", given=b"junk").returncode, 1)
        self.assertEqual(self.windows(), {})


class OneInstance(WindowTest):
    activates = False

    def test_the_first_serves_until_its_last_window_is_closed(self):
        first = self.start("favorites", "edit")
        window = self.window("Favorite lines")
        self.assertEqual(self.owner(), first.pid)
        self.keys(window, "Escape")
        self.assertEqual(first.wait(PATIENCE), 0)
        self.assertEqual(first.stderr.read(), b"")
        self.assertFalse(self.is_running())

    def test_a_second_start_hands_over(self):
        first = self.start("open", "orvo://?t=r")
        self.window("Favorite lines")
        finished = subprocess.run(self.command("receive", "ContinueUserActivity"), env=self.environment, cwd=self.home,
                                  input=tap_on_line(line("U1")), capture_output=True, timeout=PATIENCE)
        self.assertEqual(finished.returncode, 0, finished.stderr)
        self.window("U1 · Metro")
        self.assertEqual(self.owner(), first.pid)
        self.orvo("favorites", "edit")
        self.assertEqual(sorted(self.windows()), ["Favorite lines — Orvo", "U1 · Metro — Orvo"])
        self.assertIsNone(first.poll())

    def test_without_a_bus_it_shows_what_it_was_given(self):
        self.environment["DBUS_SESSION_BUS_ADDRESS"] = "disabled:"
        process = self.start("receive", "ContinueUserActivity", stdin=subprocess.PIPE)
        process.stdin.write(tap_on_line(line("U1")))
        process.stdin.close()
        self.keys(self.window("U1 · Metro"), "Escape")
        self.assertEqual(process.wait(PATIENCE), 0)

    def test_a_display_that_has_gone_is_none(self):
        self.environment["DISPLAY"] = ":94321"
        self.assertIn("No favourite lines", self.orvo("open", "orvo://?t=r").out)
        self.assertIn("no display", self.refused(1, "favorites", "edit").err)

    def test_a_service_with_an_open_window_does_not_end(self):
        service = self.serve("--idle", "1")
        self.hand_over("open", "orvo://?t=r")
        window = self.window("Favorite lines")
        self.assertRaises(subprocess.TimeoutExpired, service.wait, 3)
        self.keys(window, "Escape")
        self.assertEqual(service.wait(PATIENCE), 0)


class Favourites(WindowTest):
    activates = False

    def setUp(self):
        super().setUp()
        self.orvo("feeds", "add", "city", "--static", self.schedule(), "--alerts", self.write("alerts.pb", feed(1)))
        self.process = self.start("favorites", "edit")
        self.edited = self.window("Favorite lines")

    def are(self, *routes):
        """Until these are kept, in this order."""
        wanted = [f"city:{route}" for route in routes]
        self.eventually(lambda: [row.split("\t")[1] for row in self.orvo("favorites", "list").out.splitlines()] == wanted,
                        f"the favourites are {wanted}")

    def test_they_are_found_added_moved_removed_and_brought_back_by_keys_alone(self):
        for search in ("first", "second", "ferry"):
            self.write_text(self.edited, search)
            self.keys(self.edited, "Return")
        self.are("r1", "r2", "r3")
        self.keys(self.edited, "Down", "alt+Up")
        self.are("r1", "r3", "r2")
        self.keys(self.edited, "Delete")
        self.are("r1", "r2")
        self.keys(self.edited, "ctrl+z")
        self.are("r1", "r3", "r2")

    def test_a_row_is_dragged_to_another_place(self):
        self.orvo("favorites", "add", "city:r1", "city:r2", "city:r3")
        self.orvo("favorites", "edit")
        row, above = 50, 90  # the middle of the first row, and the way to the next
        self.xdotool("mousemove", "--sync", "--window", self.edited, 150, above, "mousedown", 1)
        for way in (0.3, 0.8, 1.4, 2.1, 2.4):  # past the middle of the last row, in steps that a hand would make
            self.xdotool("mousemove", "--sync", "--window", self.edited, 150, above + int(way * row))
        self.xdotool("mouseup", 1)
        self.are("r2", "r3", "r1")
        self.keys(self.edited, "Escape")
        self.process.wait(PATIENCE)
        self.assertEqual(self.process.stderr.read(), b"")

    def test_what_another_program_adds_is_seen_when_the_person_comes_back(self):
        self.orvo("favorites", "add", "city:r2")
        self.orvo("favorites", "edit")
        self.keys(self.edited, "Down", "Delete")
        self.are()


class Voices(AssistiveTools, WindowTest):
    """What a person hears who does not see the windows."""

    activates = False

    @classmethod
    def setUpClass(cls):
        super().setUpClass()
        cls.find_tools()

    def names(self, process, role):
        """Of the elements of that role that are shown."""
        try:
            return [part.title for part in self.parts_of(process, role) if part.is_showing]
        except self.dbus.DBusException:
            return None  # one went while it was asked

    def rows(self, process, title):
        """Of the list of that name."""
        try:
            (found,) = [part for part in self.parts_of(process, "list") if part.title == title]
            return [row.title for row in found.children]
        except self.dbus.DBusException:
            return None

    def hears(self, process, role, *names):
        def look():
            self.heard = self.names(process, role)
            return self.heard == list(names)
        try:
            self.eventually(look, f"each {role} is one of {names}")
        except AssertionError as error:
            raise AssertionError(f"{error}; they are {self.heard}") from None

    def test_the_search_field_the_lists_and_their_buttons_have_names(self):
        self.orvo("feeds", "add", "city", "--static", self.schedule(), "--alerts", self.write("alerts.pb", feed(1)))
        self.orvo("favorites", "add", "city:r1", "city:r2")
        process = self.start("favorites", "edit")
        window = self.window("Favorite lines")
        self.hears(process, "list", "Favorites")
        field = "Add a line: search by name or number"
        self.hears(process, "text", field)
        self.hears(process, "push button", field, "Move Up", "Move Down", "Remove")
        known = ["1, First Street, Test Transit", "2, Second Street, Test Transit"]
        found = "Harbour Ferry, Test Transit"
        self.assertEqual(self.rows(process, "Favorites"), known)
        self.write_text(window, "ferry")
        self.hears(process, "list", "Lines found")
        self.assertEqual(self.rows(process, "Lines found"), [found])
        self.hears(process, "push button", "Clear the search", field)
        self.keys(window, "Return")
        self.eventually(lambda: self.rows(process, "Favorites") == [*known, found], "the line that was found is among them")
        self.eventually(lambda: self.rows(process, "Lines found") == [], "what was found is told of no more")
        self.keys(window, "Down", "Delete")
        self.hears(process, "push button", field, "Move Up", "Move Down", "Remove", "Undo")

    def test_incidents_and_their_links_are_read_out(self):
        process = self.start("receive", "ContinueUserActivity", stdin=subprocess.PIPE)
        process.stdin.write(tap_on_line(line("U1", incident("Works", description="No trains.", feed="city", link="https://t.example/i"))))
        process.stdin.close()
        self.window("U1 · Metro")
        self.hears(process, "label", "U1", "Metro", "Works", "Until further notice", "No trains.",
                   "More information: t.example")


if __name__ == "__main__":
    unittest.main()
