"""What the widget keeps between two lives, read and written by others than ourselves."""

import plistlib
import subprocess
import unittest

from widget_support import WidgetTest

KEY = "Orvo.TransitWidget.savedUIData"
RECORD = "OWTransitIncidentViewControllerState"
SUCCESS, ERROR, EXPANDED = "lineItemResultSuccess", "lineItemResultError", "expanded"


def message(data):
    """The fields of an encoded message as `protoc` reads them."""
    return subprocess.run(["protoc", "--decode_raw"], input=data, capture_output=True, check=True).stdout.decode()


class Archive:
    """A keyed archive, followed by its references."""

    def __init__(self, data):
        document = plistlib.loads(data, fmt=plistlib.FMT_BINARY)
        assert sorted(document) == ["$archiver", "$objects", "$top", "$version"]
        assert (document["$archiver"], document["$version"]) == ("NSKeyedArchiver", 100000)
        assert list(document["$top"]) == ["root"] and document["$objects"][0] == "$null"
        self.objects = document["$objects"]
        self.root = self.at(document["$top"]["root"])

    def at(self, reference):
        assert isinstance(reference, plistlib.UID)
        return self.objects[reference.data]

    def classes(self, value):
        """The class of an object and those above it."""
        described = self.at(value["$class"])
        assert described["$classname"] == described["$classes"][0]
        return described["$classes"]

    def elements(self, array):
        assert self.classes(array)[-2:] == ["NSArray", "NSObject"]
        return [self.at(reference) for reference in array["NS.objects"]]

    def data(self, value):
        """The one piece of data that the object holds."""
        held = [self.at(entry) if isinstance(entry, plistlib.UID) else entry
                for key, entry in value.items() if key != "$class"]
        (content,) = [entry for entry in held if isinstance(entry, bytes)]
        return content


def archive(name, items, expanded):
    """An archive made without the program: a record under that name with a success of those encoded line items."""
    def described(*classes):
        return {"$classname": classes[0], "$classes": [*classes, "NSObject"]}

    first = 6
    data = [{"$class": plistlib.UID(5), "message": plistlib.UID(first + len(items) + at)} for at in range(len(items))]
    objects = ["$null",
               {"$class": plistlib.UID(2), SUCCESS: plistlib.UID(3), EXPANDED: expanded},
               described(name),
               {"$class": plistlib.UID(4), "NS.objects": [plistlib.UID(first + at) for at in range(len(items))]},
               described("NSMutableArray", "NSArray"),
               described("TransitStorageLineItem"),
               *data, *items]
    return plistlib.dumps({"$archiver": "NSKeyedArchiver", "$version": 100000, "$top": {"root": plistlib.UID(1)},
                           "$objects": objects}, fmt=plistlib.FMT_BINARY)


class SavedState(WidgetTest):
    def defaults(self, demo=True):
        return (self.home / "data" / ("group.com.zentu.Orvo.demo" if demo else "group.com.zentu.Orvo") /
                "group.com.zentu.Orvo.plist")

    def kept_archive(self, demo=True):
        kept = plistlib.loads(self.defaults(demo).read_bytes(), fmt=plistlib.FMT_BINARY)[KEY]
        self.assertIsInstance(kept, bytes)
        return Archive(kept)

    def open_row(self, row, *words):
        """Taps that row of the demonstration city; the widget then keeps what it shows."""
        folder = self.home / "bin"
        if not folder.exists():
            self.recording_orvo()
        self.widget("--demo", "--open", row, *words, program=folder / "orvo-transit-widget")

    def keep(self, data):
        """Puts that data in the place of what the widget kept."""
        path = self.defaults()
        defaults = plistlib.loads(path.read_bytes(), fmt=plistlib.FMT_BINARY)
        defaults[KEY] = data
        path.write_bytes(plistlib.dumps(defaults, fmt=plistlib.FMT_BINARY))

    def told(self):
        """What the widget logs of itself in one more life."""
        answer = self.run_widget("--demo", "--print", "json", ORVO_LOG="TransitWidget=debug,*=fault,private")
        self.assertEqual(answer.code, 0, answer.err)
        return answer.err

    def lines(self):
        """The numbers of the city's favourite lines in their order, and of one of them by its route."""
        lines = self.orvo("incidents", "--demo", "--json").json["lines"]
        return [line["muid"] for line in lines], {line["route_id"]: line["muid"] for line in lines}

    def test_a_success_is_an_archive_of_the_lines_in_order(self):
        self.open_row(0)
        kept = self.kept_archive()
        self.assertEqual(kept.classes(kept.root), [RECORD, "NSObject"])
        self.assertEqual(sorted(kept.root), ["$class", EXPANDED, SUCCESS])
        self.assertIs(kept.root[EXPANDED], True)
        items = kept.elements(kept.at(kept.root[SUCCESS]))
        self.assertEqual({tuple(kept.classes(item)) for item in items}, {("TransitStorageLineItem", "NSObject")})
        muids, by_route = self.lines()
        self.assertGreater(len(muids), 2)
        self.assertEqual([message(kept.data(item)).split("\n")[0] for item in items],
                         [f"1: {muid}" for muid in muids])
        self.assertIn("Delays on M1 and M2", message(kept.data(items[muids.index(by_route["M1"])])))

    def test_the_mode_is_kept_as_it_was_last(self):
        self.open_row(0)
        self.assertIs(self.kept_archive().root[EXPANDED], True)
        self.open_row(0, "--mode", "compact")
        self.assertIs(self.kept_archive().root[EXPANDED], False)

    def test_a_failure_is_an_archive_of_the_error(self):
        self.feed().unlink()
        self.widget_refused(1, "--open", "0")
        kept = self.kept_archive(demo=False)
        self.assertEqual(sorted(kept.root), ["$class", EXPANDED, ERROR])
        self.assertIs(kept.root[EXPANDED], False)
        error = kept.at(kept.root[ERROR])
        self.assertEqual(kept.classes(error)[-2:], ["NSError", "NSObject"])
        self.assertTrue(kept.at(error["NSDomain"]))
        self.assertIn("NSCode", error)

    def test_an_archive_of_another_writer_under_the_former_name_is_loaded(self):
        self.open_row(0, "--mode", "compact")
        kept = self.kept_archive()
        own = kept.elements(kept.at(kept.root[SUCCESS]))
        self.assertGreater(len(own), 2)
        self.keep(archive("OWTransitListItemData", [kept.data(item) for item in own[:2]], True))
        (loaded,) = [line for line in self.told().splitlines() if "View model loaded" in line]
        self.assertIn(f"View model loaded from NSUserDefaults (key: {KEY}): <", loaded)
        self.assertIn("expanded: YES", loaded)
        self.assertEqual(loaded.count("TransitStorageLineItem"), 2)
        again = self.kept_archive()
        self.assertEqual(again.classes(again.root), [RECORD, "NSObject"])

    def test_what_does_not_decode_is_told_from_what_cannot_be_opened(self):
        self.open_row(0)
        self.keep(archive("AnotherClass", [], False))
        self.assertIn("Error parsing ViewModel data loaded from NSUserDefaults, removing it (key: " + KEY + ")",
                      self.told())
        self.keep(b"no archive")
        self.assertIn("View model loaded from NSUserDefaults (key: " + KEY + "): (null)", self.told())


if __name__ == "__main__":
    unittest.main()
