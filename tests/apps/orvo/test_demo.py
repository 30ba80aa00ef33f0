"""The demonstration city, in files and live."""

import re
import signal
import subprocess
import unittest
import urllib.error
import urllib.request

from support import ProgramTest


class Demonstration(ProgramTest):
    def lines(self, *words):
        return {line["route_id"]: line["incidents"]
                for line in self.orvo("incidents", "--demo", "--json", *words).json["lines"]}

    def test_it_makes_itself(self):
        lines = self.lines()
        self.assertEqual(list(lines), ["M1", "M2", "T4", "B12", "S1", "F1", "SKY"])
        self.assertEqual(lines["M1"][0]["muid"], lines["M2"][0]["muid"])
        self.assertTrue(any(not incidents or incidents[0]["start"] for incidents in lines.values()))

    def test_it_never_touches_the_persons_own_profile(self):
        self.orvo("demo")
        self.orvo("incidents", "--demo")
        self.orvo("settings", "step-free", "on", "--demo")
        profiles = {path.relative_to(self.home).parts[1] for path in self.files()}
        self.assertEqual(profiles, {"group.com.zentu.Orvo.demo"})
        self.assertEqual(self.orvo("favorites", "list").out, "")

    def test_it_is_the_same_for_the_same_time(self):
        first = self.orvo("incidents", "--demo", "--json", "--at", "2025-06-15T12:00:00Z").out
        self.environment["ORVO_NOW"] = "2025-06-20T12:00:00Z"
        self.orvo("demo")
        del self.environment["ORVO_NOW"]
        self.assertEqual(self.orvo("incidents", "--demo", "--json", "--at", "2025-06-15T12:00:00Z").out, first)

    def test_incidents_begin_and_end_without_being_written_again(self):
        self.environment["ORVO_NOW"] = "2025-06-15T12:00:00Z"
        written = self.lines()
        later = self.lines("--at", "2025-06-15T12:03:00Z")
        current = lambda incidents, at: [i["title"] for i in incidents if not i["start"] or i["start"] <= at]
        self.assertEqual(current(written["S1"], "2025-06-15T12:00:00Z"), ["Fewer trains to the coast"])
        self.assertEqual(current(later["S1"], "2025-06-15T12:03:00Z"), [])
        self.assertEqual(current(written["F1"], "2025-06-15T12:00:00Z"), [])
        self.assertEqual(current(later["F1"], "2025-06-15T12:03:00Z"), ["No ferries"])

    def test_another_time_is_shown_without_writing(self):
        self.environment["TMPDIR"] = str(self.home / "tmp")
        (self.home / "tmp").mkdir()
        self.lines("--at", "2025-06-15T12:00:00Z")
        self.assertEqual(self.files(), {})
        self.orvo("demo")
        self.orvo("settings", "step-free", "on", "--demo")
        before = self.files()
        self.assertEqual(list(self.lines("--at", "2025-06-15T12:00:00Z")), ["M1", "M2", "T4", "B12", "S1", "F1", "SKY"])
        self.assertEqual(self.orvo("settings", "step-free", "--demo", "--at", "2025-06-15T12:00:00Z").out, "on\n")
        self.refused(2, "favorites", "remove", "1", "--demo", "--at", "2025-06-15T12:00:00Z")
        self.assertEqual(self.files(), before)
        self.assertEqual(list((self.home / "tmp").iterdir()), [])

    def test_it_is_written_anew_when_its_hour_is_over(self):
        self.environment["ORVO_NOW"] = "2025-06-15T12:00:00Z"
        self.orvo("favorites", "remove", "1", "--demo")
        self.assertEqual(len(self.lines()), 6)
        self.environment["ORVO_NOW"] = "2025-06-15T13:00:00Z"
        self.assertEqual(len(self.lines()), 7)

    def test_settings_stay_when_it_is_written_anew(self):
        self.orvo("settings", "step-free", "on", "--demo")
        self.orvo("demo")
        self.assertEqual(self.orvo("settings", "step-free", "--demo").out, "on\n")

    def test_german(self):
        out = self.orvo("incidents", "--demo", "--language", "de").out
        self.assertIn("Verspätungen auf M1 und M2", out)

    def test_it_can_be_served_live(self):
        with subprocess.Popen(self.command("demo", "--serve", "0"), env=self.environment, stdout=subprocess.PIPE,
                              text=True) as server:
            try:
                url = re.match(r"Serving (http://127\.0\.0\.1:\d+/alerts\.pb) ", server.stdout.readline()).group(1)
                with urllib.request.urlopen(url) as answer:
                    tag, body = answer.headers["ETag"], answer.read()
                self.assertIn(b"Hospital stop moved", body)
                request = urllib.request.Request(url, headers={"If-None-Match": tag})
                with self.assertRaises(urllib.error.HTTPError) as unchanged:
                    urllib.request.urlopen(request)
                self.assertEqual(unchanged.exception.code, 304)
                unchanged.exception.close()
                self.assertEqual(self.orvo("feeds", "list", "--demo", "--json").json["feeds"][0]["alerts"], [url])
                self.assertEqual(self.lines()["B12"][0]["title"], "Hospital stop moved")
                other = self.refused(1, "demo", "--serve", "0")
                self.assertIn("another orvo demo --serve is running", other.err)
            finally:
                server.send_signal(signal.SIGINT)
                rest = server.stdout.read()
        self.assertEqual(server.returncode, 0)
        self.assertIn("GET /alerts.pb 304", rest)
        self.assertIn("alerts.pb", self.orvo("feeds", "list", "--demo", "--json").json["feeds"][0]["alerts"][0])
        self.assertFalse(any(i["unknown"] for incidents in self.lines().values() for i in incidents))

    def test_a_server_that_was_killed_leaves_no_unknown_city(self):
        with subprocess.Popen(self.command("demo", "--serve", "0"), env=self.environment, stdout=subprocess.PIPE,
                              text=True) as server:
            server.stdout.readline()
            server.kill()
        self.assertFalse(any(i["unknown"] for incidents in self.lines().values() for i in incidents))

    def test_a_port_that_is_taken_is_an_error_with_the_cure(self):
        with subprocess.Popen(self.command("demo", "--serve", "0"), env=self.environment, stdout=subprocess.PIPE,
                              text=True) as server:
            port = re.search(r":(\d+)/", server.stdout.readline()).group(1)
            answer = self.refused(1, "demo", "--serve", port)
            server.kill()
        self.assertIn(port, answer.err)
        self.assertIn("--serve 0", answer.err)
        self.refused(2, "demo", "--serve", "70000")
        self.refused(2, "demo", "8000")


if __name__ == "__main__":
    unittest.main()
