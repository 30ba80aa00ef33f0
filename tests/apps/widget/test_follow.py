"""Going on while incidents begin and end."""

import json
import signal
import subprocess
import unittest

from widget_support import AT, NOW, WIDGET, WidgetTest, alert, period, selector, shown, text


class Follow(WidgetTest):
    def follow(self, *words):
        process = subprocess.Popen([WIDGET, "--follow", *words], env=self.environment, cwd=self.home,
                                   stdout=subprocess.PIPE, stderr=subprocess.PIPE)
        self.addCleanup(process.stdout.close)
        self.addCleanup(process.stderr.close)
        self.addCleanup(process.wait)
        self.addCleanup(process.kill)
        return process

    def end(self, process, how=signal.SIGINT):
        """What was printed besides what has been read."""
        process.send_signal(how)
        out, err = process.communicate(timeout=60)
        self.assertEqual((process.returncode, err), (0, b""))
        return out

    def test_an_incident_of_the_city_begins_while_one_watches(self):
        self.city()
        # The storm begins a second after the start: a minute and a half after the city's own time.
        process = self.follow("--demo", "--print", "json", "--max-rows", "0", "--at", "2025-06-15T12:01:29Z")
        before, after = (shown(json.loads(process.stdout.readline())) for _ in range(2))
        self.assertNotIn("No ferries", before)
        self.assertEqual(sorted(after), sorted([*before, "No ferries"]))
        self.assertEqual(self.end(process), b"")

    def test_each_change_is_printed_once(self):
        # At each end the rows are made anew, and fetched anew besides, which changes nothing.
        self.feed(*(alert(selector(route=f"r{i}"), period(NOW - 60, NOW + i), text(10, en=f"Works {i}"))
                    for i in (1, 2)))
        self.environment["ORVO_NOW"] = AT
        process = self.follow("--print", "json")
        rows = [json.loads(process.stdout.readline()) for _ in range(3)]
        self.assertEqual([shown(one) for one in rows],
                         [["Works 1", "Works 2", "Good service"], ["Works 2", "Good service"], []])
        self.assertEqual(rows[2]["summary"]["primaryText"], "Good service")
        self.assertEqual(self.end(process, signal.SIGTERM), b"")

    def test_text_and_bars_go_on_too(self):
        for form, first in (("text", b"compact:\n"), ("waybar", b'{"text": "4 advisories"')):
            process = self.follow("--demo", "--at", AT, "--print", form)
            self.assertTrue(process.stdout.readline().startswith(first))
            self.end(process)

    def test_it_leaves_no_trace_on_the_persons_own_profile(self):
        self.feed()
        before = self.kept()
        process = self.follow("--print", "json")
        self.assertEqual(json.loads(process.stdout.readline())["summary"]["primaryText"], "Good service")
        self.end(process)
        self.assertEqual(self.kept(), before)

    def test_an_error_is_printed_and_does_not_end_it(self):
        self.feed().unlink()
        process = self.follow("--print", "waybar")
        self.assertEqual(json.loads(process.stdout.readline())["class"], "unavailable")
        self.assertIsNone(process.poll())
        self.end(process)


if __name__ == "__main__":
    unittest.main()
