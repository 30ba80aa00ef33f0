"""What the widget hands over where there is no bus: decoded from real bytes, told, kept; and refused when it is hostile."""

import bz2
import plistlib
import resource
import subprocess
import unittest

from handing import BusTest, activity, archive, incident, line, line_message, tap_on_incidents, tap_on_line
from support import Answer, ProgramTest, field

ACTION = "ContinueUserActivity"


class Received(ProgramTest):
    def receive(self, given, *words, code=0):
        answer = Answer(subprocess.run(self.command("receive", ACTION, *words), env=self.environment, cwd=self.home,
                                       input=given, capture_output=True, timeout=120, preexec_fn=self.limit_memory))
        self.assertEqual(answer.code, code, f"{answer.out}{answer.err}")
        return answer

    @staticmethod
    def limit_memory():
        resource.setrlimit(resource.RLIMIT_CORE, (0, 0))

    def test_a_line_is_told_with_its_incidents_in_full_and_kept(self):
        told = self.receive(tap_on_line(line("U1", incident("Works", summary="In short.", description="At length.",
                                                            feed="city", link="https://t.example/i"),
                                             incident("Fire"))))
        self.assertEqual(told.out, "U1 · Metro\n  Works\n  until further notice\n  In short.\n\n  At length.\n"
                                   "  https://t.example/i\n\n  Fire\n  until further notice\n")
        self.assertEqual(self.orvo("show").out, told.out)

    def test_a_list_of_incidents_is_told_in_its_order(self):
        told = self.receive(tap_on_incidents(incident("Works", summary="In short."), incident("Fire")))
        self.assertEqual(told.out, "2 incidents\n\n  Works\n  until further notice\n  In short.\n\n"
                                   "  Fire\n  until further notice\n")
        self.assertEqual(self.orvo("show").out, told.out)

    def test_the_demonstration_has_its_own_last_one(self):
        self.receive(tap_on_line(line("U1")), "--demo")
        self.assertIn("U1", self.orvo("show", "--demo").out)
        self.assertEqual(self.orvo("show").out, "")

    def test_an_empty_or_foreign_input_is_refused_with_the_reason(self):
        for given, reason in ((b"", "no activity"), (b"junk" * 1000, "bplist00"), (plistlib.dumps({"a": 1}), "bplist00"),
                              (plistlib.dumps([], fmt=plistlib.FMT_BINARY), "no activity"),
                              (activity("Other", "bs", b""), "Transit.Other"),
                              (activity("Incident", "bs", "text"), "key bs"),
                              (activity("Incident", "bs", b"BZh9"), "bzip2"),
                              (activity("Incident", "bs", bz2.compress(b"\xff\xff")), "message"),
                              (activity("Incident", "bs", bz2.compress(field(1, b""))), "no line"),
                              (activity("IncidentList", "incidentListKey", b"junk"), "archive"),
                              (activity("IncidentList", "incidentListKey", archive(b"\xff")), "archive"),
                              (activity("IncidentList", "incidentListKey", archive(b"", name="Sneaky")), "archive")):
            answer = self.receive(given, code=1)
            self.assertIn(reason, answer.err)
            self.assertEqual(answer.out, "")
        self.assertFalse([path for path in self.files() if "hand-off" in path.name])

    def test_the_last_good_one_stays_when_a_bad_one_comes(self):
        told = self.receive(tap_on_line(line("U1")))
        self.receive(b"junk", code=1)
        self.assertEqual(self.orvo("show").out, told.out)

    def test_what_unfolds_without_end_is_refused(self):
        many = bz2.compress(line_message(field(13, b"") * 600_000))
        self.assertIn("more than", self.receive(activity("Incident", "bs", many), code=1).err)
        self.assertIn("bzip2", self.receive(activity("Incident", "bs", bz2.compress(bytes(50_000_000))), code=1).err)
        self.assertIn("more than", self.receive(bytes(9_000_000), code=1).err)

    def test_cycles_and_references_to_nowhere_are_refused(self):
        for references in ([1], [99], [0]):
            objects = plistlib.loads(archive())
            objects["$objects"][1]["NS.objects"] = [plistlib.UID(number) for number in references]
            payload = plistlib.dumps(objects, fmt=plistlib.FMT_BINARY)
            self.assertIn("archive", self.receive(activity("IncidentList", "incidentListKey", payload), code=1).err)

    def test_every_cut_is_an_error_and_never_a_crash(self):
        whole = tap_on_line(line("U1", incident("Works")))
        for length in range(0, len(whole), 7):
            self.receive(whole[:length], code=1)

    def test_there_is_one_action(self):
        answer = self.refused(2, "receive", "Explode")
        self.assertIn(ACTION, answer.err)


class Directly(BusTest):
    """A bus on which nobody serves the application, and nothing would start it."""

    activates = False

    def test_the_program_is_started_with_the_activity(self):
        self.assertEqual(self.hand_over("activity", given=tap_on_line(line("U1"))).returncode, 0)
        self.assertIn("U1", self.orvo("show").out)

    def test_without_any_bus_too(self):
        self.environment["DBUS_SESSION_BUS_ADDRESS"] = "disabled:"
        self.assertEqual(self.hand_over("--demo", "activity", given=tap_on_line(line("U1"))).returncode, 0)
        self.assertIn("U1", self.orvo("show", "--demo").out)
        self.assertEqual(self.hand_over("open", "orvo://?t=r").returncode, 0)

    def test_no_program_is_an_error_that_says_so(self):
        self.environment["PATH"] = str(self.home)
        answer = self.hand_over("open", "orvo://?t=r")
        self.assertEqual(answer.returncode, 1)
        self.assertIn(b"is not installed", answer.stderr)


if __name__ == "__main__":
    unittest.main()
