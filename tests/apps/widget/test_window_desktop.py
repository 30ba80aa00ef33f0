"""The widget's window on a desktop that locks, sleeps and becomes dark: services stand in for the desktop's own."""

import time
import unittest

from window_support import CARD_WIDTH, COMPACT_HEIGHT, PATIENCE, MockService, WindowTest, works

LOGIN = "org.freedesktop.login1"
MANAGER = (LOGIN, "/org/freedesktop/login1", f"{LOGIN}.Manager")
SESSION = "/org/freedesktop/login1/session/auto"
PORTAL = ("org.freedesktop.portal.Desktop", "/org/freedesktop/portal/desktop", "org.freedesktop.portal.Settings")
COMMON = "org.freedesktop.appearance"
LOCALE = ("org.freedesktop.locale1", "/org/freedesktop/locale1", "org.freedesktop.locale1")
LIGHT, DARK = "#f4f4f6", "#1e1e22"


class Desktop(WindowTest):
    def setUp(self):
        super().setUp()
        self.login = MockService(self, self.system_bus(), *MANAGER)
        self.lock = self.login.add_object(SESSION, f"{LOGIN}.Session", {"LockedHint": False})
        self.live_feed(works(1, "Works on 1"))

    def is_asked(self, times):
        self.eventually(lambda: self.server.asked == times, f"the feed is asked {times} times")

    def test_a_locked_session_is_left_alone_until_it_is_unlocked(self):
        self.open_widget()
        self.shows("Works on 1")
        self.is_asked(1)
        kept = self.kept()
        self.lock.update(f"{LOGIN}.Session", {"LockedHint": True})
        self.eventually(lambda: self.kept() != kept, "what is shown is kept, since it disappears")
        self.server.tell(works(2, "Works on 2"))
        self.wake()
        self.shows("Works on 1")  # asked after the signal, and answered by the same thread
        self.assertEqual(self.server.asked, 1)
        self.lock.update(f"{LOGIN}.Session", {"LockedHint": False})
        self.shows("Works on 2")
        self.is_asked(2)
        self.close_widget()

    def test_one_alarm_is_set_for_what_comes_next_and_none_while_it_is_locked(self):
        now = int(time.time())
        self.server.tell(works(1, "Works on 1", now - 60, now + 900))
        self.open_widget()
        self.shows("Works on 1")

        def next_change():
            alarms = self.alarms()
            return len(alarms) == 1 and 900 - PATIENCE < alarms[0] <= 900
        self.eventually(next_change, "the end of the incident is waited for")
        self.lock.update(f"{LOGIN}.Session", {"LockedHint": True})
        self.eventually(lambda: self.alarms() == [], "nothing is waited for")
        self.lock.update(f"{LOGIN}.Session", {"LockedHint": False})
        self.eventually(next_change, "the end of the incident is waited for again")
        self.is_asked(2)
        self.server.tell(works(1, "Works on 1"))
        woken = 0

        def refresh():
            # An update that is under way was perhaps answered before the feed changed: it is woken again.
            nonlocal woken
            if time.monotonic() - woken > 3:
                woken = time.monotonic()
                self.wake()
            alarms = self.alarms()
            return len(alarms) == 1 and alarms[0] > 1200
        self.eventually(refresh, "the refresh is waited for")
        self.close_widget()

    def test_it_wakes_to_fresh_rows(self):
        self.open_widget()
        self.shows("Works on 1")
        self.server.tell(works(1, "Works on 1"), works(2, "Works on 2"))
        self.wake()
        self.shows("2 advisories")
        self.is_asked(2)
        self.close_widget()

    def portal(self, scheme):
        """The portal of a desktop that prefers that scheme: 0 none, 1 dark."""
        portal = MockService(self, self.environment["DBUS_SESSION_BUS_ADDRESS"], *PORTAL)
        portal.add_method("ReadAll", "as", "a{sa{sv}}",
                          "ret = {'%s': {'color-scheme': dbus.UInt32(%i, variant_level=1)}}" % (COMMON, scheme))
        return portal

    def follows(self, portal):
        self.eventually(lambda: portal.was_asked("ReadAll"), "the desktop's settings are asked")

    def test_it_follows_light_and_dark_and_begins_as_it_was_left(self):
        portal = self.portal(scheme=0)
        self.open_widget()
        self.shows("Works on 1")
        self.follows(portal)
        self.is_colored(LIGHT)
        portal.emit("SettingChanged", "ssv", COMMON, "color-scheme", self.dbus.UInt32(1, variant_level=1))
        self.is_colored(DARK)
        self.assertEqual(self.height(), COMPACT_HEIGHT)
        self.close_widget()
        portal.end()
        self.open_widget()
        self.is_colored(DARK)
        self.close_widget()

    def test_larger_text_makes_a_larger_card(self):
        portal = self.portal(scheme=0)
        self.open_widget()
        self.is_high(COMPACT_HEIGHT)
        self.follows(portal)
        portal.emit("SettingChanged", "ssv", "org.gnome.desktop.interface", "text-scaling-factor",
                    self.dbus.Double(1.5, variant_level=1))
        self.eventually(lambda: self.height() > COMPACT_HEIGHT + 20, "the card has grown")
        self.close_widget()

    def machine_language(self):
        """What changes it; it is English at first."""
        service = MockService(self, self.environment["DBUS_SYSTEM_BUS_ADDRESS"], *LOCALE)

        def locale(name):
            return self.dbus.Array([f"LANG={name}.UTF-8"], signature="s", variant_level=1)
        service.add_property("Locale", locale("en_US"))
        return lambda name: service.update(LOCALE[2], {"Locale": locale(name)})

    def test_it_follows_the_language_in_its_rows_its_header_and_its_direction(self):
        change = self.machine_language()
        self.server.tell(works(1, "Works on 1", de="Bauarbeiten auf 1"), works(2, "Works on 2", de="Bauarbeiten auf 2"))
        self.open_widget(LC_ALL="", LANG="en_US.UTF-8")
        self.shows("2 advisories")
        self.button().press()
        self.shows("Works on 1", "Works on 2", "Good service")
        self.is_asked(1)
        change("de_DE")
        self.shows("Bauarbeiten auf 1", "Bauarbeiten auf 2", "Normaler Betrieb")
        self.assertEqual(self.button().title, "Weniger anzeigen")
        right = self.button().middle[0]
        change("ar_EG")
        self.eventually(lambda: self.button().middle[0] < right - CARD_WIDTH / 2, "the button is on the other side")
        self.shows("Works on 1", "Works on 2", "الخدمة")
        self.button().press()
        self.eventually(lambda: len(self.rows()) == 1 and self.button().title == "عرض المزيد", "it is used as before")
        self.close_widget()

    def wake(self):
        for begins in (True, False):
            self.login.emit("PrepareForSleep", "b", begins)

    def is_colored(self, color):
        self.eventually(lambda: self.color_at(180, 4) == color, f"the card is {color}")


if __name__ == "__main__":
    unittest.main()
