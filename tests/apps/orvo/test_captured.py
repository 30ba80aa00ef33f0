"""Captured feeds at their own time: what a careful person reads in them."""

import unittest

from support import FEEDS, ProgramTest


@unittest.skipUnless(FEEDS.is_dir(), "no captured feeds")
class Captured(ProgramTest):
    def lines(self, folder, alerts, at):
        self.orvo("feeds", "add", "f", "--replace", "--static", FEEDS / folder / "static.zip", "--alerts",
                  FEEDS / folder / alerts)
        answer = self.orvo("incidents", "--all", "--json", "--at", at).json
        self.assertEqual(answer["at"], at)
        return {line["route_id"]: line["incidents"] for line in answer["lines"]}

    def disturbed(self, lines):
        return {route: incidents for route, incidents in lines.items() if incidents}

    def test_the_same_incident_of_two_routes_is_one(self):
        at = "2025-03-12T15:29:34Z"
        disturbed = self.disturbed(self.lines("tam-montpellier-2025", "alerts.pb", at))
        self.assertEqual(sorted(disturbed), ["7-13", "7-7"])
        (first,), (second,) = disturbed["7-13"], disturbed["7-7"]
        self.assertEqual(first, second)
        self.assertEqual(first["title"], "TR/BUS MULTILIGNES/Retard/ RETARDS SANS CAUSE")
        self.assertEqual(first["summary"], "Des retards sont annoncés.")
        self.assertEqual((first["start"], first["end"]), ("2025-03-12T13:00:00Z", "2025-03-12T20:30:00Z"))

    def test_a_header_alone_is_good_service(self):
        lines = self.lines("tam-montpellier-2025", "empty.pb", "2025-03-12T21:53:40Z")
        self.assertGreater(len(lines), 90)
        self.assertEqual(self.disturbed(lines), {})

    def test_closed_stops_concern_a_part_of_the_line(self):
        lines = self.lines("detroit-people-mover-2023", "alerts-20221118.pb", "2022-11-19T03:18:20Z")
        self.assertEqual(list(lines), ["22210"])
        self.assertEqual({incident["title"]: (incident["effect"], incident["part"], incident["end"])
                          for incident in lines["22210"]}, {
            "Station at Bricktown closed": ("NO_SERVICE", True, "2022-11-21T05:00:00Z"),
            "Station at Cadillac Center closed": ("NO_SERVICE", True, None),
            "Station at Times Square closed": ("NO_SERVICE", True, None)})

    def test_good_news_is_no_incident(self):
        lines = self.lines("detroit-people-mover-2023", "alerts-20230724.pb", "2023-07-24T14:33:54Z")
        self.assertEqual(lines, {"22210": []})

    def test_shuttle_buses_tonight_and_tomorrow_are_one_incident_twice(self):
        lines = self.lines("mbta-2024", "alerts.pb", "2024-07-24T01:28:40Z")
        shuttles = [i for i in lines["Red"] if i["title"].startswith("Red Line: Shuttle buses are replacing service")]
        tonight = [i for i in shuttles if i["start"] == "2024-07-24T00:30:00Z"]
        self.assertEqual([i["end"] for i in tonight], ["2024-07-24T06:30:00Z"])
        self.assertEqual(sum(i["muid"] == tonight[0]["muid"] for i in shuttles), 2)
        self.assertEqual((tonight[0]["severity"], tonight[0]["effect"], tonight[0]["part"]), ("SEVERE", "DETOUR", True))

    def test_a_weekday_detour_is_announced_in_the_evening(self):
        incidents = self.lines("mbta-2024", "alerts.pb", "2024-07-24T01:28:40Z")["83"]
        (detour,) = [i for i in incidents if i["title"].startswith("Route 83 is detoured on weekdays from 7 AM to 4 PM")]
        self.assertEqual(detour["start"], "2024-07-24T11:27:00Z")

    def test_lifts_do_not_keep_a_line_red_unless_asked(self):
        at = "2024-07-24T01:28:40Z"
        effects = {i["effect"] for incidents in self.lines("mbta-2024", "alerts.pb", at).values() for i in incidents}
        self.assertNotIn("ACCESSIBILITY_ISSUE", effects)
        self.orvo("settings", "step-free", "on")
        effects = {i["effect"] for incidents in self.lines("mbta-2024", "alerts.pb", at).values() for i in incidents}
        self.assertIn("ACCESSIBILITY_ISSUE", effects)

    def test_an_agencys_name_is_no_agency(self):
        lines = self.lines("miway-2025", "alerts.pb", "2025-10-26T22:50:32Z")
        self.assertFalse(any("Stop 1917 on Hurontario" in i["summary"] for i in lines["17"]))
        check = self.run_orvo("feeds", "check", "--json", "--at", "2025-10-26T22:50:32Z").json["feeds"][0]
        self.assertEqual({what: count for what, count in check["unresolved"].items() if "Mississauga" in what},
                         {"agency_id Mississauga Transit": 3})

    def test_a_title_that_is_only_the_lines_name_says_the_effect(self):
        lines = self.lines("miway-2025", "alerts.pb", "2025-10-26T22:50:32Z")
        moved = [i for i in lines["17"] if i["summary"].startswith("17 South - Stop 1912")]
        self.assertEqual(len(moved), 1)
        self.assertNotEqual(moved[0]["title"], "17 Hurontario")
        self.assertTrue(moved[0]["part"])

    def test_zero_bytes_are_a_failed_fetch_and_a_header_alone_is_not(self):
        static = FEEDS / "tam-montpellier-2025/static.zip"
        at = "2023-11-08T12:00:00Z"
        zero = FEEDS / "empty-feeds/zero-bytes.pb"
        self.assertIn("warning", self.orvo("feeds", "add", "zero", "--static", static, "--alerts", zero).err)
        self.refused(1, "incidents", "--all", "--at", at)


if __name__ == "__main__":
    unittest.main()
