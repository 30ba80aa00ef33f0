"""Feeds, lines, favourites and incidents, from small feeds made by hand."""

import unittest

from support import ProgramTest, alert, feed, field, period, selector, text

AT = "2024-07-24T12:00:00Z"
NOW = 1721822400
HOUR = 3600


class Incidents(ProgramTest):
    def add(self, *alerts, timestamp=NOW, name="city"):
        """A feed with these alerts, and its first two lines among the favourites."""
        path = self.write(f"{name}.pb", feed(timestamp, *alerts))
        self.orvo("feeds", "add", name, "--static", self.schedule(f"{name}-schedule"), "--alerts", path)
        self.orvo("favorites", "add", f"{name}:r2", f"{name}:r1")
        return path

    def lines(self, *words, at=AT):
        return {line["route_id"]: line for line in self.orvo("incidents", "--at", at, "--json", *words).json["lines"]}

    def test_the_json_is_the_contract(self):
        self.add(alert(selector(route="r1"), period(NOW - HOUR, NOW + HOUR), text(10, en="Burst pipe"),
                       text(11, en="Buses wait.\n\nMore soon."), effect=4, severity=4))
        answer = self.orvo("incidents", "--at", AT, "--json").json
        self.assertEqual(list(answer), ["at", "lines", "error"])
        self.assertEqual(answer["at"], AT)
        self.assertIsNone(answer["error"])
        self.assertEqual([line["route_id"] for line in answer["lines"]], ["r2", "r1"])
        second, first = answer["lines"]
        self.assertEqual(list(first), ["feed", "route_id", "muid", "name", "system", "incidents"])
        self.assertEqual(second["incidents"], [])
        self.assertEqual((first["feed"], first["name"], first["system"]), ("city", "1", "Test Transit"))
        self.assertIsInstance(first["muid"], str)
        (incident,) = first["incidents"]
        self.assertTrue(incident.pop("muid").isdecimal())
        self.assertEqual(incident, {
            "title": "Burst pipe", "summary": "Buses wait.", "start": "2024-07-24T11:00:00Z",
            "end": "2024-07-24T13:00:00Z", "severity": "SEVERE", "effect": "DETOUR", "part": False, "unknown": False})

    def test_each_period_stands_alone_under_one_number(self):
        self.add(alert(selector(route="r1"), period(None, NOW + HOUR), period(NOW + 2 * HOUR), period(NOW + 30 * HOUR),
                       text(10, en="Works")))
        # The newest start first.
        coming, current = self.lines()["r1"]["incidents"]
        self.assertEqual((current["start"], current["end"]), (None, "2024-07-24T13:00:00Z"))
        self.assertEqual((coming["start"], coming["end"]), ("2024-07-24T14:00:00Z", None))
        self.assertEqual(current["muid"], coming["muid"])

    def test_an_end_is_over_the_moment_after(self):
        self.add(alert(selector(route="r1"), period(NOW - HOUR, NOW), text(10, en="Over")))
        self.assertEqual(len(self.lines()["r1"]["incidents"]), 1)
        self.assertEqual(self.lines(at="2024-07-24T12:00:01Z")["r1"]["incidents"], [])

    def test_numbers_are_the_same_on_every_machine(self):
        self.add(alert(selector(route="r1"), text(10, en="Works")))
        self.assertEqual(self.lines()["r1"]["muid"], "10022940475986773047")

    def test_agency_mode_and_stop_name_lines_too(self):
        self.add(alert(selector(agency="A"), text(10, en="Everything")),
                 alert(selector(stop="s1"), text(10, en="Stop")),
                 alert(field(5, field(3, 4)), text(10, en="Ferries")),
                 alert(selector(agency="Nobody"), text(10, en="Nothing")))
        titles = {line["route_id"]: {incident["title"]: incident["part"] for incident in line["incidents"]}
                  for line in self.orvo("incidents", "--all", "--at", AT, "--json").json["lines"]}
        self.assertEqual(titles, {"r1": {"Everything": False, "Stop": True}, "r2": {"Everything": False},
                                  "r3": {"Everything": False, "Ferries": False}})
        check = self.run_orvo("feeds", "check", "--at", AT, "--json").json["feeds"][0]
        self.assertTrue(any("Nobody" in what for what in check["unresolved"]), check)

    def test_the_language_of_texts(self):
        self.add(alert(selector(route="r1"), text(10, en="Works", de="Bauarbeiten", pt="Obras")))
        for tag, title in (("de-AT", "Bauarbeiten"), ("pt-BR", "Obras"), ("fr", "Works")):
            self.assertEqual(self.lines("--language", tag)["r1"]["incidents"][0]["title"], title)

    def test_a_file_that_is_no_feed_is_unknown_beside_one_that_is(self):
        broken = self.add(name="broken")
        self.add()
        for content in (b"", b"<html></html>", b"{}", feed(NOW, alert(selector(route="r1"), text(10, en="x")))[:-3]):
            broken.write_bytes(content)
            answer = self.orvo("incidents", "--at", AT, "--json").json
            for line in answer["lines"]:
                self.assertEqual([i["unknown"] for i in line["incidents"]], [True] if line["feed"] == "broken" else [])

    def test_alone_it_is_an_error_that_names_feed_and_cause(self):
        self.add().write_bytes(b"")
        answer = self.refused(1, "incidents", "--at", AT, "--json")
        self.assertEqual(answer.json["lines"], [])
        self.assertEqual(sorted(answer.json["error"]), ["code", "domain", "message"])
        self.assertIn("city", answer.json["error"]["message"])
        self.assertIn("city", answer.err)

    def test_an_old_message_proves_nothing(self):
        self.add(timestamp=NOW - 25 * HOUR)
        answer = self.orvo("incidents", "--at", AT)
        self.assertEqual(answer.out.count("Status unknown"), 2)
        self.assertNotIn("Good service", answer.out)
        self.assertIn("more than a day old", answer.err)

    def test_a_line_that_left_its_schedule_is_unknown(self):
        self.add()
        (self.home / "city-schedule/routes.txt").write_text("route_id,agency_id,route_short_name,route_type\nr2,A,2,0\n")
        self.assertIn("1 line, 0 new, 2 gone", self.orvo("feeds", "update").out)
        lines = self.lines()
        self.assertEqual(lines["r2"]["incidents"], [])
        self.assertTrue(lines["r1"]["incidents"][0]["unknown"])
        self.assertEqual(lines["r1"]["name"], "1")

    def test_nothing_is_written_with_at(self):
        self.add(alert(selector(route="r1"), text(10, en="Works")))
        before = self.files()
        self.orvo("incidents", "--at", AT)
        self.orvo("feeds", "check", "--at", AT)
        self.orvo("favorites", "list", "--at", AT)
        self.orvo("lines", "city", "--at", AT)
        for words in (["settings", "step-free", "on"], ["favorites", "remove", "1"], ["feeds", "remove", "city"]):
            self.assertIn("--at writes nothing", self.refused(2, *words, "--at", AT).err)
        after = self.files()
        changed = [str(path) for path in {**before, **after} if before.get(path) != after.get(path)
                   and not path.name.endswith(("-shm", "-wal"))]
        self.assertEqual(changed, [])
        self.assertEqual(self.orvo("settings", "step-free").out, "off\n")

    def test_made_up_incidents(self):
        self.add()
        self.orvo("defaults", "write", "Orvo.TransitWidget.internal.injectFakeIncidents", "true")
        titles = set()
        for _ in range(40):
            for line in self.lines().values():
                titles.update(incident["title"] for incident in line["incidents"])
        self.assertEqual(titles, {"Something Bad™"})

    def test_orvo_now_sets_the_clock_and_nothing_else(self):
        self.add(alert(selector(route="r1"), period(NOW - HOUR, NOW + HOUR), text(10, en="Works")))
        self.environment["ORVO_NOW"] = AT
        self.assertIn("Works", self.orvo("incidents").out)
        self.orvo("settings", "step-free", "on")
        del self.environment["ORVO_NOW"]
        self.assertEqual(self.orvo("settings", "step-free").out, "on\n")


if __name__ == "__main__":
    unittest.main()
