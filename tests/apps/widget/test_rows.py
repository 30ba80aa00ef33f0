"""The rows in every form and language."""

import json
import re
import subprocess
import unittest

from widget_support import AT, INCIDENT, INCIDENT_LIST, WIDGET, WidgetTest, alert, period, selector, shown, text


class Contract(WidgetTest):
    def check_text(self, value):
        self.assertTrue(value is None or isinstance(value, str), value)

    def check_numbers(self, values):
        for value in values:
            self.assertIsInstance(value, str)
            self.assertTrue(value.isdecimal() and 0 < int(value) < 2**64, value)

    def check_artwork(self, artwork):
        if artwork is None:
            return
        self.assertIn(list(artwork), [["image", "alpha"], ["shields", "alpha"]])
        self.assertTrue(0 < artwork["alpha"] <= 1)
        if "image" in artwork:
            self.assertIn(artwork["image"], {"good-v2", "good-alt-v2", "advisories-v2", "WidgetGenericTransit"})
        else:
            self.assertTrue(all(isinstance(shield, str) and shield for shield in artwork["shields"]))

    def check_target(self, opens):
        if opens is None:
            return
        if "url" in opens:
            self.assertEqual(list(opens), ["url"])
            self.assertRegex(opens["url"], r"^orvo://\?")
        elif opens["activityType"] == INCIDENT:
            self.assertEqual(list(opens), ["activityType", "lineMuid"])
            self.check_numbers([opens["lineMuid"]])
        else:
            self.assertEqual(list(opens), ["activityType", "incidentMuids"])
            self.assertEqual(opens["activityType"], INCIDENT_LIST)
            self.check_numbers(opens["incidentMuids"])

    def check(self, rows):
        self.assertEqual(list(rows), ["summary", "expanded"])
        for row in [rows["summary"], *rows["expanded"]]:
            self.assertEqual(list(row),
                             ["kind", "primaryText", "secondaryText", "artwork", "artworkHidden", "opens"])
            self.assertIn(row["kind"], ("item", "summary"))
            self.check_text(row["primaryText"])
            self.check_text(row["secondaryText"])
            self.assertIsInstance(row["artworkHidden"], bool)
            self.check_artwork(row["artwork"])
            self.check_target(row["opens"])
        self.assertTrue(all(row["kind"] == "item" for row in rows["expanded"]))
        return rows

    def test_the_city(self):
        rows = self.check(self.city())
        summary = rows["summary"]
        self.assertEqual((summary["kind"], summary["primaryText"], summary["secondaryText"]),
                         ("summary", "4 advisories", None))
        self.assertEqual(summary["artwork"], {"shields": ["M1", "M2", "4", "12", "S1"], "alpha": 1})
        self.assertEqual(len(summary["opens"]["incidentMuids"]), 4)
        self.assertEqual(shown(rows), ["Delays on M1 and M2", "Trams diverted at Old Harbour", "Hospital stop moved",
                                       "Fewer trains to the coast", "Good service"])
        first, last = rows["expanded"][0], rows["expanded"][-1]
        self.assertTrue(first["secondaryText"].startswith("M1 and M2: Trains run"))
        self.assertEqual(first["artwork"], {"shields": ["MBT"], "alpha": 1})
        self.assertEqual((last["secondaryText"], last["artwork"]), ("3 lines", {"image": "good-alt-v2", "alpha": 0.3}))

    def test_the_numbers_are_those_of_the_other_program(self):
        rows = self.city()
        lines = {line["route_id"]: line
                 for line in self.orvo("incidents", "--demo", "--at", AT, "--json").json["lines"]}
        self.assertEqual([row["opens"]["lineMuid"] for row in rows["expanded"][:4]],
                         [lines[route]["muid"] for route in ("M1", "T4", "B12", "S1")])
        self.assertEqual(rows["summary"]["opens"]["incidentMuids"][0], lines["M1"]["incidents"][0]["muid"])

    def test_what_is_too_many_is_one_row(self):
        rows = self.check(self.city("--max-rows", "3"))
        self.assertEqual(shown(rows), ["Delays on M1 and M2", "3 more advisories", "Good service"])
        overflow = rows["expanded"][1]
        self.assertEqual(overflow["artwork"], {"image": "advisories-v2", "alpha": 0.3})
        self.assertEqual(overflow["opens"]["incidentMuids"], rows["summary"]["opens"]["incidentMuids"][1:])

    def test_five_rows_unless_asked_for_another_number(self):
        self.feed(*(alert(selector(route="r1"), text(10, en=f"Works {i}")) for i in range(8)))
        self.assertEqual(len(self.check(self.rows())["expanded"]), 5)
        self.assertEqual(len(self.rows("--max-rows", "0")["expanded"]), 9)
        self.assertEqual(len(self.rows("--max-rows", "9")["expanded"]), 9)
        self.assertEqual(len(self.rows("--max-rows", "2")["expanded"]), 2)

    def test_no_favorites(self):
        rows = self.check(self.rows())
        self.assertEqual(rows, {"summary": {
            "kind": "item", "primaryText": "No favorite lines",
            "secondaryText": "Add lines in Orvo to see their service here.", "artwork": None, "artworkHidden": True,
            "opens": {"url": "orvo://?t=r"}}, "expanded": []})

    def test_good_service(self):
        self.feed()
        rows = self.check(self.rows())
        self.assertEqual(rows["summary"]["secondaryText"], "All 3 lines are running normally")
        self.assertEqual(rows["summary"]["artwork"], {"image": "good-v2", "alpha": 1})
        self.assertRegex(rows["summary"]["opens"]["url"], r"^orvo://\?favorites=2&t=r&session=[0-9a-f]+$")
        self.assertEqual(rows["expanded"], [])

    def test_one_advisory_for_the_only_line_is_the_compact_row_alone(self):
        self.feed(alert(selector(route="r1"), text(10, en="Burst pipe")), favorites=["r1"])
        rows = self.check(self.rows())
        self.assertEqual((rows["summary"]["kind"], rows["summary"]["primaryText"]), ("item", "Burst pipe"))
        self.assertEqual(rows["expanded"], [])

    def test_an_error_is_a_row_like_any_other(self):
        self.feed().unlink()
        rows = self.check(self.rows())
        self.assertEqual(rows["summary"]["primaryText"], "Service status unavailable")
        self.assertTrue(rows["summary"]["secondaryText"])
        self.assertIsNone(rows["summary"]["opens"])
        self.assertEqual(rows["expanded"], [])

    def test_names_are_only_text(self):
        name = "%s\\ {}\u202e"
        self.feed(alert(selector(route="r1"), text(10, en="100 %@ \x1b[31m"), text(11, en="%n < %s & {}")),
                  alert(selector(route="r2"), text(10, ar="تأخيرات")),
                  schedule={"routes": "route_id,agency_id,route_short_name,route_long_name,route_type\n"
                                      f"r1,A,{name},,3\nr2,A,خط,,3\nr3,A,3,,3\n"})
        rows = self.check(self.rows())
        self.assertTrue(rows["expanded"][0]["primaryText"].startswith("100 %@"))
        self.assertEqual(rows["expanded"][0]["secondaryText"], "%n < %s & {}")
        self.assertEqual(rows["expanded"][1]["primaryText"], "تأخيرات")
        self.assertEqual(rows["summary"]["artwork"]["shields"][1], "خط")
        self.assertNotIn("\x1b", self.widget("--print", "text").out)


class Languages(WidgetTest):
    ROWS = {
        "en": ("4 advisories", "Delays on M1 and M2", "3 more advisories", "Good service", "3 lines"),
        "de": ("4 Meldungen", "Verspätungen auf M1 und M2", "3 weitere Meldungen", "Normaler Betrieb", "3 Linien"),
        "pl": ("4 komunikaty", "Delays on M1 and M2", "Jeszcze 3 komunikaty", "Ruch bez zakłóceń", "3 linie"),
        "ja": ("運行情報4件", "Delays on M1 and M2", "ほか3件の運行情報", "平常運転", "3路線"),
        "ar": ("٤ تنبيهات", "Delays on M1 and M2", "٣ تنبيهات أخرى", "الخدمة منتظمة", "٣ خطوط"),
    }

    def test_five_languages(self):
        for language, texts in self.ROWS.items():
            with self.subTest(language):
                rows = self.city("--language", language, "--max-rows", "3")
                self.assertEqual((rows["summary"]["primaryText"], *shown(rows), rows["expanded"][2]["secondaryText"]),
                                 texts)

    def test_the_desktops_language_is_used(self):
        self.environment["LC_ALL"] = "de_DE.UTF-8"
        self.assertEqual(self.city()["summary"]["primaryText"], "4 Meldungen")
        self.assertEqual(self.city("--language", "en")["summary"]["primaryText"], "4 advisories")


class Text(WidgetTest):
    def test_the_city(self):
        self.assertEqual(
            re.sub("(line|session)([ =])[0-9a-f]+", r"\1\2…",
                   self.widget("--demo", "--at", AT, "--max-rows", "3").out),
            "compact:\n"
            "0  4 advisories\n"
            "   [M1] [M2] [4] [12] [S1]\n"
            "   → com.zentu.Orvo.Transit.IncidentList: 4 incidents\n"
            "\n"
            "expanded:\n"
            "0  [MBT]  Delays on M1 and M2\n"
            "          M1 and M2: Trains run up to 15 minutes late after a signal failure at Central Station. Change at "
            "Market Square for the tram to Old Harbour.\n"
            "          → com.zentu.Orvo.Transit.Incident: line …\n"
            "1  !      3 more advisories\n"
            "          3 lines\n"
            "          → com.zentu.Orvo.Transit.IncidentList: 3 incidents\n"
            "2  ✓      Good service\n"
            "          3 lines\n"
            "          → orvo://?favorites=2&t=r&session=…\n")

    def test_text_is_what_is_printed_without_words(self):
        self.assertEqual(self.widget().out, self.widget("--print", "text").out)

    def on_a_terminal(self, **environment):
        """What the program prints where a person looks."""
        command = f"'{WIDGET}' --demo --at {AT} --max-rows 2"
        finished = subprocess.run(["script", "-qec", command, "/dev/null"], stdin=subprocess.DEVNULL,
                                  capture_output=True, timeout=120, cwd=self.home,
                                  env={**self.environment, "TERM": "xterm-256color", **environment})
        self.assertEqual(finished.returncode, 0)
        return finished.stdout.decode()

    def test_shields_are_coloured_on_a_terminal_only(self):
        self.environment.pop("NO_COLOR", None)
        printed = self.on_a_terminal()
        self.assertRegex(printed, "\x1b\\[48;2;[0-9;]+;38;2;[0-9;]+m M1 \x1b\\[0m")
        self.assertIn("[M1]", self.on_a_terminal(NO_COLOR="1"))
        self.assertNotIn("\x1b[48", self.on_a_terminal(NO_COLOR="1"))
        self.assertNotIn("\x1b", self.widget("--demo", "--at", AT).out)


class Bar(WidgetTest):
    def bar(self, *words):
        line, rest = self.widget("--print", "waybar", *words).out.split("\n", 1)
        self.assertEqual(rest, "")
        answer = json.loads(line)
        self.assertEqual(list(answer), ["text", "alt", "tooltip", "class", "percentage"])
        self.assertEqual(answer["alt"], answer["class"])
        return answer

    def test_the_city(self):
        bar = self.bar("--demo", "--at", AT)
        self.assertEqual((bar["text"], bar["class"], bar["percentage"]), ("4 advisories", "advisories", 28))
        self.assertIn("<b>Hospital stop moved</b>\n", bar["tooltip"])
        self.assertRegex(bar["tooltip"], '<span background="#[0-9A-F]{6}" foreground="#[0-9A-F]{6}"> 12 </span>')

    def test_markup_of_a_feed_is_text(self):
        self.feed(alert(selector(route="r1"), text(10, en="A & B < C")), favorites=["r1"])
        bar = self.bar()
        self.assertEqual(bar["text"], "A &amp; B &lt; C")
        self.assertIn("<b>A &amp; B &lt; C</b>", bar["tooltip"])

    def test_no_favorites_good_service_and_no_answer(self):
        self.assertEqual(self.bar()["class"], "no-favorites")
        alerts = self.feed()
        self.assertEqual((self.bar()["class"], self.bar()["percentage"]), ("good", 100))
        alerts.unlink()
        self.assertEqual((self.bar()["class"], self.bar()["percentage"]), ("unavailable", 0))


class Time(WidgetTest):
    def test_incidents_begin_and_end(self):
        self.feed(alert(selector(route="r1"), period(1749988860, 1749988920), text(10, en="Works")))
        self.assertEqual(self.rows()["summary"]["primaryText"], "Good service")
        during = self.rows("--at", "2025-06-15T12:01:30Z")
        self.assertEqual(shown(during), ["Works", "Good service"])
        self.assertEqual(self.rows("--at", "2025-06-15T12:02:01Z")["summary"]["primaryText"], "Good service")

    def test_printing_leaves_no_trace_on_the_persons_own_profile(self):
        self.feed(alert(selector(route="r1"), text(10, en="Works")))
        before = self.kept()
        for form in ("text", "json", "waybar"):
            self.widget("--print", form)
            self.widget("--print", form, "--at", "2025-06-15T12:01:30Z")
        self.assertEqual(self.kept(), before)

    def test_printing_without_a_profile_makes_none(self):
        self.widget()
        self.assertEqual(self.files(), {})

    def test_the_city_never_touches_the_persons_own_profile(self):
        self.widget("--demo")
        self.assertEqual({path.relative_to(self.home).parts[1] for path in self.files()},
                         {"group.com.zentu.Orvo.demo"})


class Usage(WidgetTest):
    def test_help_and_version(self):
        self.assertTrue(self.widget("--help").out.startswith("Usage: orvo-transit-widget [OPTION]…\n"))
        self.assertRegex(self.widget("--version").out, r"^orvo-transit-widget \d+\.\d+\.\d+\n$")

    def test_wrong_usage(self):
        for words in (["--print", "xml"], ["--max-rows", "many"], ["--at", "noon"], ["--open", "x"], ["rows"],
                      ["--nothing"], ["--payloads"], ["--open", "0", "--follow"], ["--mode", "compact"]):
            with self.subTest(words):
                answer = self.widget_refused(2, *words)
                self.assertEqual(answer.out, "")
                self.assertTrue(answer.err.startswith("orvo-transit-widget: "), answer.err)

    def test_output_that_cannot_be_written_is_an_error(self):
        for words in (["--demo", "--at", AT], ["--demo", "--follow"]):
            with open("/dev/full", "wb") as full:
                finished = subprocess.run([WIDGET, *words], env=self.environment, stdout=full, timeout=120,
                                          stderr=subprocess.PIPE, check=False)
            self.assertEqual((finished.returncode, finished.stderr),
                             (1, b"orvo-transit-widget: the output cannot be written\n"))


if __name__ == "__main__":
    unittest.main()
