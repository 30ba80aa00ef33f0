"""A profile that cannot be written can still be read."""

import os
import subprocess
import unittest

from support import PROGRAM, ProgramTest, alert, feed, selector, text


def nobody_may_run_it():
    """Root writes everywhere, so that the tests run as nobody, who must be able to start the program."""
    if os.geteuid() != 0:
        return True
    return subprocess.run(["test", "-x", PROGRAM], user=65534, group=65534, extra_groups=[]).returncode == 0


@unittest.skipUnless(nobody_may_run_it(), "nobody may not start the program")
class ReadOnly(ProgramTest):
    def city(self):
        alerts = self.write("city.pb", feed(0, alert(selector(route="r1"), text(10, en="Works"))))
        self.orvo("feeds", "add", "city", "--static", self.schedule(), "--alerts", alerts)
        self.orvo("favorites", "add", "city:r1")
        for path in list(self.home.rglob("*-shm")) + list(self.home.rglob("*-wal")):
            path.unlink()

    def test_reading_commands_answer_as_ever(self):
        self.environment["ORVO_NOW"] = "2025-06-15T12:00:00Z"  # answers tell when they were made
        self.city()
        for words in (["incidents"], ["incidents", "--all"], ["lines", "ferry"], ["lines", "city", "--json"],
                      ["favorites", "list"], ["feeds", "check"], ["settings"], ["defaults", "read"],
                      ["completion", "words", "lines"]):
            expected = self.orvo(*words)
            answer = self.run_without_rights(*words)
            self.assertEqual((answer.code, answer.out), (0, expected.out), f"{words}: {answer.err}")
            self.assertEqual(answer.err, expected.err, words)
        self.assertEqual(self.run_without_rights("feeds", "list").code, 0)

    def test_writing_commands_fail_with_file_and_reason(self):
        self.city()
        before = self.files()
        for words in (["favorites", "remove", "1"], ["favorites", "add", "city:r2"], ["settings", "step-free", "on"],
                      ["defaults", "write", "k", "v"], ["feeds", "update", "--force"], ["feeds", "remove", "city"]):
            answer = self.run_without_rights(*words)
            self.assertEqual(answer.code, 1, words)
            self.assertEqual(answer.out, "", words)
            self.assertRegex(answer.err, str(self.home) + r"\S*: .*([Pp]ermission|readonly)", words)
        self.assertEqual(self.files(), before)

    def test_what_is_hidden_is_not_like_none(self):
        self.city()
        self.orvo("settings", "step-free", "on")
        data = self.home / "data" / "group.com.zentu.Orvo"
        reading = {
            "favorites.sqlite": (["favorites", "list"], ["incidents"], ["incidents", "--json"],
                                 ["favorites", "list", "--at", "2025-06-15T12:00:00Z"]),
            "schedules.sqlite": (["lines", "ferry"], ["feeds", "list"], ["incidents", "--all"],
                                 ["lines", "ferry", "--at", "2025-06-15T12:00:00Z"]),
            "group.com.zentu.Orvo.plist": (["settings"], ["defaults", "read"], ["defaults", "delete", "k"]),
            "feeds.plist": (["feeds", "list"], ["incidents"], ["feeds", "remove", "city"]),
        }
        for name, commands in reading.items():
            for hidden in (data / name, data):
                for words in commands:
                    answer = self.run_without_rights(*words, hidden=[hidden])
                    self.assertEqual(answer.code, 1, f"{words} without {hidden}: {answer.out}")
                    self.assertRegex(answer.err, str(data) + r"\S*: .*Permission denied", words)

    def test_a_line_of_json_tells_what_is_hidden(self):
        self.city()
        store = self.home / "data" / "group.com.zentu.Orvo" / "schedules.sqlite"
        feeds = self.run_without_rights("feeds", "list", "--json", hidden=[store]).json
        (city,) = feeds["feeds"]
        self.assertEqual((city["name"], city["lines"], city["agencies"], city["run_out"]), ("city", None, None, None))
        self.assertIn("Permission denied", feeds["error"]["message"])

    def test_an_empty_home_is_one_without_favourites(self):
        self.assertIn("orvo favorites add", self.run_without_rights("incidents").err)
        self.assertIn("orvo feeds add", self.run_without_rights("feeds", "list").err)
        self.assertIn("no schedule yet", self.run_without_rights("lines", "ferry").err)

    def test_the_demonstration_can_be_looked_at(self):
        answer = self.run_without_rights("incidents", "--demo")
        self.assertEqual(answer.code, 0, answer.err)
        self.assertIn("Delays on M1 and M2", answer.out)
        self.assertEqual(self.run_without_rights("favorites", "remove", "1", "--demo").code, 1)


if __name__ == "__main__":
    unittest.main()
