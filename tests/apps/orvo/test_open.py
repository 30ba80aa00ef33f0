"""URLs of the map application."""

import unittest

from support import ProgramTest


class Opened(ProgramTest):
    def test_without_favourites_it_says_how_to_add_one(self):
        for url in ("orvo://?t=r", "orvo://?favorites=2&t=r&session=00ff"):
            told = self.orvo("open", url).out
            self.assertIn("No favourite lines yet", told)
            self.assertIn("orvo favorites add", told)
            self.assertEqual(self.orvo("show").out, told)

    def test_the_favourites_are_told(self):
        self.orvo("feeds", "add", "city", "--static", self.schedule(), "--alerts", "nowhere.pb")
        self.orvo("favorites", "add", "city:r2")
        told = self.orvo("open", "orvo://?favorites=2&t=r").out
        self.assertIn("city:r2", told)
        self.assertNotIn("city:r1", told)

    def test_the_demonstration_city_has_its_own(self):
        self.assertIn("city:M1", self.orvo("open", "orvo://?favorites=2&t=r", "--demo").out)
        self.assertEqual(self.orvo("show").out, "")
        self.assertIn("city:M1", self.orvo("show", "--demo").out)

    def test_what_is_no_url_of_ours_is_wrong_usage(self):
        for url in ("junk", "https://t.example/", "orvo", "", "file:///etc/passwd"):
            answer = self.refused(2, "open", url)
            self.assertIn("no URL", answer.err)
            self.assertEqual(answer.out, "")

    def test_what_there_is_not_could_not_be_opened(self):
        for url in ("orvo://place", "orvo://?favorites=7", "orvo://?t=%00", "orvo://?favorites=" + "9" * 50,
                    "orvo://?" + "x" * 10_000):
            answer = self.refused(1, "open", url)
            self.assertTrue(answer.err.startswith("orvo: "), answer.err)
            self.assertLess(len(answer.err), 400)

    def test_nothing_is_kept_of_what_was_refused_or_asked_about_another_time(self):
        self.refused(2, "open", "junk")
        self.refused(2, "open", "orvo://?t=r", "--at", "2024-07-24T01:28:40Z")
        self.assertFalse([path for path in self.files() if "hand-off" in path.name])

    def test_nothing_handed_over_yet(self):
        answer = self.orvo("show")
        self.assertEqual(answer.out, "")
        self.assertIn("Nothing has been handed over yet", answer.err)

    def test_analytics_of_a_machine_without_any(self):
        self.assertIn("recorded nothing yet", self.orvo("analytics").err)
        self.assertEqual(self.orvo("analytics", "--json").json, {"sessions": [], "actions": [], "error": None})


if __name__ == "__main__":
    unittest.main()
