"""What a tap hands over, read by readers that are not ours."""

import base64
import bz2
import plistlib
import subprocess
import time
import unittest

from widget_support import AT, INCIDENT, INCIDENT_LIST, WidgetTest

SESSION = "com.zentu.Orvo.sharedSession"


def message(data):
    """The fields of an encoded message as `protoc` reads them."""
    return subprocess.run(["protoc", "--decode_raw"], input=data, capture_output=True, check=True).stdout.decode()


def archived_incidents(archive):
    """The messages in an archive of incidents, in order."""
    document = plistlib.loads(archive, fmt=plistlib.FMT_BINARY)
    objects = document["$objects"]
    assert document["$archiver"] == "NSKeyedArchiver" and document["$version"] == 100000
    root = objects[document["$top"]["root"].data]
    assert objects[root["$class"].data]["$classes"][-2:] == ["NSArray", "NSObject"]
    messages = []
    for reference in root["NS.objects"]:
        incident = objects[reference.data]
        assert objects[incident["$class"].data]["$classname"] == "TransitStorageIncident"
        values = [objects[value.data] if isinstance(value, plistlib.UID) else value
                  for key, value in incident.items() if key != "$class"]
        (content,) = [value for value in values if isinstance(value, bytes)]
        messages.append(message(content))
    return messages


class Payloads(WidgetTest):
    def test_an_incidents_line_travels_as_a_compressed_message(self):
        row = self.city("--payloads")["expanded"][0]["opens"]
        self.assertEqual(list(row), ["activityType", "lineMuid", "userInfo"])
        self.assertEqual(list(row["userInfo"]), ["bs", SESSION])
        self.assertRegex(row["userInfo"][SESSION], "^[0-9a-f]{16,}$")
        fields = message(bz2.decompress(base64.b64decode(row["userInfo"]["bs"], validate=True)))
        # Display options with the transit map, then the line: nothing else.
        self.assertRegex(fields, r'^1 \{\n  \d+: 3\n\}\n15 \{\n  1: ' + row["lineMuid"] + r'\n  2: "M1"\n')
        self.assertEqual([line for line in fields.splitlines() if not line.startswith((" ", "}"))], ["1 {", "15 {"])
        self.assertIn("Delays on M1 and M2", fields)

    def test_incident_lists_travel_as_archives_in_order(self):
        rows = self.city("--payloads", "--max-rows", "3")
        for row, count in ((rows["summary"], 4), (rows["expanded"][1], 3)):
            opens = row["opens"]
            self.assertEqual(list(opens), ["activityType", "incidentMuids", "userInfo"])
            incidents = archived_incidents(base64.b64decode(opens["userInfo"]["incidentListKey"], validate=True))
            self.assertEqual([incident.split("\n")[0] for incident in incidents],
                             [f"1: {muid}" for muid in opens["incidentMuids"]])
            self.assertEqual(len(incidents), count)

    def test_one_run_has_one_session(self):
        rows = self.city("--payloads")
        sessions = {row["opens"]["userInfo"][SESSION] for row in [rows["summary"], *rows["expanded"][:4]]}
        self.assertEqual(len(sessions), 1)
        self.assertTrue(rows["expanded"][4]["opens"]["url"].endswith("session=" + sessions.pop()))

    def test_urls_have_no_payload(self):
        self.assertEqual(list(self.city("--payloads")["expanded"][4]["opens"]), ["url"])


class Taps(WidgetTest):
    def tapped(self, *words, code=0):
        """The words and standard input with which the map application was started."""
        folder = self.recording_orvo(code)
        self.widget("--demo", "--at", AT, *words, program=folder / "orvo-transit-widget")
        deadline = time.monotonic() + 60
        while not (folder / "words").exists():
            self.assertLess(time.monotonic(), deadline, "the map application was not started")
            time.sleep(0.01)  # it lives on its own, and the widget does not wait for its end
        return (folder / "words").read_text().splitlines(), (folder / "input").read_bytes()

    def activity(self, *words):
        arguments, content = self.tapped(*words)
        self.assertEqual(arguments[:2], ["receive", "ContinueUserActivity"])
        self.assertIn("--demo", arguments)
        activity = plistlib.loads(content, fmt=plistlib.FMT_BINARY)
        self.assertEqual(sorted(activity), ["activityType", "userInfo"])
        return activity

    def test_an_expanded_row_hands_its_incident_over(self):
        activity = self.activity("--open", "2")
        self.assertEqual(activity["activityType"], INCIDENT)
        self.assertIn("Hospital stop moved", message(bz2.decompress(activity["userInfo"]["bs"])))

    def test_the_compact_row_hands_the_list_over(self):
        activity = self.activity("--open", "0", "--mode", "compact")
        self.assertEqual(activity["activityType"], INCIDENT_LIST)
        self.assertEqual(len(archived_incidents(activity["userInfo"]["incidentListKey"])), 4)

    def test_the_overflow_row_hands_the_hidden_incidents_over(self):
        activity = self.activity("--open", "1", "--max-rows", "3")
        self.assertEqual(len(archived_incidents(activity["userInfo"]["incidentListKey"])), 3)

    def test_the_clear_row_opens_the_favorites(self):
        arguments, content = self.tapped("--open", "4")
        self.assertEqual(arguments[0], "open")
        self.assertTrue(any(word.startswith("orvo://?favorites=2&t=r&session=") for word in arguments), arguments)
        self.assertEqual(content, b"")

    def test_a_tap_is_listed_with_its_session(self):
        folder = self.recording_orvo()
        self.widget("--demo", "--open", "1", program=folder / "orvo-transit-widget")
        recorded = self.orvo("analytics", "--demo", "--json").json
        (session,) = recorded["sessions"]
        self.assertEqual((session["end_state"], session["tapped_item_index"]), (1, 1))
        self.assertIn("Delays on M1 and M2", [incident["title"] for incident in session["incidents"]])
        self.assertIn(9001, [action["action"] for action in recorded["actions"]])

    def test_what_is_printed_or_of_another_time_is_not_recorded(self):
        folder = self.recording_orvo()
        self.feed()
        self.widget("--print", "text")
        self.widget("--demo", "--at", AT, "--print", "text")
        self.widget("--demo", "--at", AT, "--open", "1", program=folder / "orvo-transit-widget")
        for words in ((), ("--demo",)):
            recorded = self.orvo("analytics", "--json", *words).json
            self.assertEqual((recorded["sessions"], recorded["actions"]), ([], []))

    def test_without_expanded_rows_the_compact_one_is_meant(self):
        folder = self.recording_orvo()
        self.widget("--open", "0", program=folder / "orvo-transit-widget")
        self.widget_refused(1, "--open", "0", "--mode", "expanded", program=folder / "orvo-transit-widget")

    def test_a_row_that_is_not_there_is_refused(self):
        answer = self.widget_refused(1, "--demo", "--at", AT, "--open", "5")
        self.assertEqual(answer.err, "orvo-transit-widget: there is no row 5 in expanded mode: the last is 4\n")

    def test_an_error_row_opens_nothing(self):
        self.feed().unlink()
        answer = self.widget_refused(1, "--open", "0")
        self.assertEqual(answer.err, "orvo-transit-widget: row 0 opens nothing\n")

    def test_without_the_map_application_the_reason_is_said(self):
        folder = self.recording_orvo()
        (folder / "orvo").unlink()
        for row in ("0", "4"):
            answer = self.widget_refused(1, "--demo", "--at", AT, "--open", row,
                                         program=folder / "orvo-transit-widget", PATH="/nonexistent")
            self.assertIn("com.zentu.Orvo is not installed", answer.err)


if __name__ == "__main__":
    unittest.main()
