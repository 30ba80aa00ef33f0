"""What the end-to-end tests share: a machine of one's own, schedules and alerts made by hand."""

import json
import os
import pathlib
import subprocess
import tempfile
import unittest

PROGRAM = os.environ["ORVO_PROGRAM"]
FEEDS = pathlib.Path(os.environ.get("ORVO_TEST_FEEDS", "../shared/data"))


class Answer:
    """What one run of the program left."""

    def __init__(self, finished):
        self.code = finished.returncode
        self.out = finished.stdout.decode()
        self.err = finished.stderr.decode()

    @property
    def json(self):
        return json.loads(self.out)


class ProgramTest(unittest.TestCase):
    """Runs the program with folders of its own: nothing of the machine's is read or written."""

    maxDiff = None

    def setUp(self):
        folder = tempfile.TemporaryDirectory(prefix="orvo-e2e-")
        self.addCleanup(folder.cleanup)
        self.home = pathlib.Path(folder.name)
        self.environment = dict(os.environ)
        for name, below in (("DATA", "data"), ("CACHE", "cache"), ("STATE", "state"), ("CONFIG", "config")):
            self.environment[f"XDG_{name}_HOME"] = str(self.home / below)
        self.environment["HOME"] = str(self.home)
        self.environment.pop("ORVO_NOW", None)
        if "ASAN_OPTIONS" in self.environment:
            # The display's keyboard library copies texts out of the middle of others, which strict checks refuse.
            self.environment["ASAN_OPTIONS"] += ":strict_string_checks=0"

    def command(self, *words):
        return [PROGRAM, *map(str, words)]

    def run_orvo(self, *words):
        return Answer(
            subprocess.run(self.command(*words), env=self.environment, cwd=self.home, capture_output=True, timeout=120)
        )

    def orvo(self, *words):
        """Runs what must succeed."""
        answer = self.run_orvo(*words)
        self.assertEqual(answer.code, 0, f"orvo {words}: {answer.err}")
        return answer

    def refused(self, code, *words):
        """Runs what must not."""
        answer = self.run_orvo(*words)
        self.assertEqual(answer.code, code, f"orvo {words}: {answer.out}{answer.err}")
        return answer

    def schedule(self, name="schedule", **files):
        """A folder with a schedule of three lines; a file given replaces that of the same name."""
        folder = self.home / name
        folder.mkdir()
        for file, text in {**SCHEDULE, **files}.items():
            (folder / f"{file}.txt").write_text(text, encoding="utf-8")
        return folder

    def write(self, name, content):
        path = self.home / name
        path.write_bytes(content)
        return path

    def run_without_rights(self, *words, hidden=()):
        """Runs it where it may read the home folder, but for what is hidden, and write nowhere in it."""
        root = os.geteuid() == 0
        changed = []
        for path in [self.home, *self.home.rglob("*")]:
            changed.append((path, path.stat().st_mode))
            path.chmod(0o555 if path.is_dir() else 0o444)
        for path in hidden:
            path.chmod(0)
        nobody = {"user": 65534, "group": 65534, "extra_groups": []} if root else {}
        try:
            return Answer(subprocess.run(self.command(*words), env=self.environment, cwd="/", capture_output=True,
                                         timeout=120, **nobody))
        finally:
            for path, mode in changed:
                path.chmod(mode)

    def files(self):
        """Everything below the home folder with its bytes."""
        return {path: path.read_bytes() for path in sorted(self.home.rglob("*")) if path.is_file()}


SCHEDULE = {
    "agency": "agency_id,agency_name,agency_url,agency_timezone,agency_lang\nA,Test Transit,https://t.example,UTC,en\n",
    "routes": "route_id,agency_id,route_short_name,route_long_name,route_type,route_color,route_text_color\n"
    "r1,A,1,First Street,3,FF0000,FFFFFF\n"
    "r2,A,2,Second Street,0,,\n"
    "r3,A,,Harbour Ferry,4,,\n",
    "stops": "stop_id,stop_name,stop_lat,stop_lon\ns1,One,1,1\n",
    "trips": "route_id,service_id,trip_id\nr1,d,t1\n",
    "stop_times": "trip_id,arrival_time,departure_time,stop_id,stop_sequence\nt1,08:00:00,08:00:00,s1,1\n",
    "feed_info": "feed_publisher_name,feed_publisher_url,feed_lang,feed_start_date,feed_end_date,feed_version\n"
    "Test,https://t.example,en,20240101,20241231,v7\n",
}


def varint(number):
    encoded = bytearray()
    while number > 0x7F:
        encoded.append(number & 0x7F | 0x80)
        number >>= 7
    encoded.append(number)
    return bytes(encoded)


def field(number, value):
    """A protobuf field: a number, or bytes, text or a message."""
    if isinstance(value, int):
        return varint(number << 3) + varint(value)
    content = value.encode() if isinstance(value, str) else value
    return varint(number << 3 | 2) + varint(len(content)) + content


def text(number, **languages):
    return field(number, b"".join(field(1, field(1, words) + field(2, tag)) for tag, words in languages.items()))


def period(start=None, end=None):
    return field(1, (field(1, start) if start else b"") + (field(2, end) if end else b""))


def selector(agency=None, route=None, stop=None):
    return field(5, b"".join(field(n, v) for n, v in ((1, agency), (2, route), (5, stop)) if v))


def alert(*parts, effect=3, cause=3, severity=3):
    return b"".join(parts) + field(6, cause) + field(7, effect) + field(14, severity)


def feed(timestamp, *alerts):
    header = field(1, field(1, "2.0") + (field(3, timestamp) if timestamp else b""))
    return header + b"".join(field(2, field(1, f"e{i}") + field(5, one)) for i, one in enumerate(alerts))
