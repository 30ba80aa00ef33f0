"""The widget in a real window: read as assistive tools read it, used with a pointer and keys, beside a live feed and a real `orvo`."""

import time
import unittest

from window_support import CARD_WIDTH, COMPACT_HEIGHT, WindowTest, signal, works

ROW = 110


class Shown(WindowTest):
    def test_rows_of_the_last_time_stand_before_anything_is_fetched(self):
        self.live_feed(works(1, "Works on 1"), works(2, "Works on 2"))
        self.open_widget()
        self.shows("2 advisories")
        self.close_widget()
        self.server.tell(works(3, "Ferry cancelled"))
        self.server.may_answer.clear()
        self.open_widget()
        self.shows("2 advisories")
        self.eventually(lambda: self.server.asked == 2, "the feed is asked again")
        self.shows("2 advisories")
        self.server.may_answer.set()
        self.shows("Ferry cancelled")
        self.close_widget(signal.SIGINT)

    def test_nothing_saved_is_lost_when_it_is_killed(self):
        self.live_feed(works(1, "Works on 1"), works(2, "Works on 2"))
        self.open_widget()
        self.shows("2 advisories")
        self.click(self.button())
        self.shows("Works on 1", "Works on 2", "Good service")
        self.close_widget()
        self.server.may_answer.clear()
        for _ in range(2):
            self.open_widget()
            self.shows("Works on 1", "Works on 2", "Good service")
            self.is_high(COMPACT_HEIGHT + 2 * ROW)
            self.kill_widget()

    def test_incidents_begin_and_end_while_one_watches(self):
        now = int(time.time())
        self.live_feed(works(1, "It ends", now - 60, now + 6), works(2, "It begins", now + 6, now + 600),
                       works(3, "It stays"))
        self.open_widget("--mode", "expanded")
        self.shows("It begins", "It stays", "Good service")
        self.assertGreater(time.time(), now + 6)
        self.close_widget()

    def test_it_is_told_to_assistive_tools(self):
        self.live_feed(works(1, "Works on 1"))
        self.open_widget("--mode", "expanded")
        self.shows("Works on 1", "Good service")
        (table,) = self.parts("list")
        self.assertEqual(table.title, "Orvo Transit")
        rows = self.parts("list item")
        self.assertIn("Works on 1", rows[0].title)
        self.assertIn("2 lines", rows[1].title)
        self.assertEqual([row.actions[0] for row in rows], ["Press", "Press"])
        self.assertEqual(self.button().title, "Show Less")
        self.button().press()
        self.shows("Works on 1")
        self.assertEqual(self.button().title, "Show More")
        self.is_high(COMPACT_HEIGHT)
        self.button().press()
        self.shows("Works on 1", "Good service")
        self.parts("list item")[0].press()
        self.eventually(lambda: "Works on 1" in self.handed_over(), "the row's incident is handed over")


class Used(WindowTest):
    def setUp(self):
        super().setUp()
        self.live_feed(works(1, "Works on 1"), works(2, "Works on 2"))
        self.open_widget()
        self.shows("2 advisories")

    def test_a_click_shows_more_and_the_choice_is_kept(self):
        self.is_high(COMPACT_HEIGHT)
        self.click(self.button())
        self.shows("Works on 1", "Works on 2", "Good service")
        self.is_high(COMPACT_HEIGHT + 2 * ROW)
        self.close_widget()
        self.open_widget()
        self.shows("Works on 1", "Works on 2", "Good service")
        self.click(self.button())
        self.is_high(COMPACT_HEIGHT)
        self.close_widget()
        self.open_widget()
        self.shows("2 advisories")
        self.is_high(COMPACT_HEIGHT)

    def test_a_click_on_a_row_opens_it_in_orvo(self):
        self.click(self.parts("list item")[0])
        self.eventually(lambda: "Works on 2" in self.handed_over(), "the list is handed over")
        self.assertIn("Works on 1", self.handed_over())
        self.assertTrue(self.is_running())
        self.click(self.button())
        self.is_high(COMPACT_HEIGHT + 2 * ROW)
        self.click(self.parts("list item")[1])
        self.eventually(lambda: "Works on 1" not in self.handed_over(), "the line is handed over")
        self.assertIn("Works on 2", self.handed_over())
        self.close_widget()
        # The first tap ends the session; each tap is an action.
        recorded = self.orvo("analytics", "--json").json
        (session,) = recorded["sessions"]
        self.assertEqual((session["end_state"], session["tapped_item_index"]), (1, 0))
        self.assertEqual([incident["title"] for incident in session["incidents"]], ["Works on 1", "Works on 2"])
        self.assertEqual([action["action"] for action in recorded["actions"]], [9001, 9001])

    def test_keys_do_all_that_a_pointer_does(self):
        self.keys("Tab", "Tab")
        self.eventually(lambda: self.button().is_focused, "the button has the focus")
        self.keys("Return")
        self.shows("Works on 1", "Works on 2", "Good service")
        self.is_high(COMPACT_HEIGHT + 2 * ROW)
        self.keys("Tab", "Down")
        self.eventually(lambda: self.parts("list item")[1].is_focused, "the second row has the focus")
        self.keys("Return")
        self.eventually(lambda: "Works on 2" in self.handed_over(), "the line is handed over")
        self.assertNotIn("Works on 1", self.handed_over())
        self.keys("Escape")
        self.shows("2 advisories")
        self.keys("Escape")
        self.has_closed()


class Failing(WindowTest):
    def test_rows_stand_without_network_until_they_are_too_old(self):
        self.live_feed(works(1, "Works on 1"))
        self.open_widget()
        self.shows("Works on 1")
        self.server.fails = True
        for minutes, shown in ((0, "Works on 1"), (9, "Works on 1"), (11, "Service status unavailable")):
            self.close_widget()
            later = time.strftime("%Y-%m-%dT%H:%M:%SZ", time.gmtime(time.time() + 60 * minutes))
            asked = self.server.asked
            self.open_widget(ORVO_NOW=later)
            self.eventually(lambda: self.server.asked > asked, "the feed is asked")
            self.shows(shown)


if __name__ == "__main__":
    unittest.main()
