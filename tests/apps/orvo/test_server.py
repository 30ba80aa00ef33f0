"""Feeds that come from a server of this machine: conditional requests, keys, failures."""

import collections
import gzip
import http.server
import io
import pathlib
import threading
import unittest
import zipfile

from support import SCHEDULE, ProgramTest, alert, feed, selector, text

NOW = 1721822400


Request = collections.namedtuple("Request", ("path", "headers"))


class Server(http.server.ThreadingHTTPServer):
    """Answers from a table of paths, and remembers what was asked."""

    daemon_threads = True

    def __init__(self):
        super().__init__(("127.0.0.1", 0), Handler)
        self.answers = {}
        self.requests = []

    def url(self, path):
        return f"http://127.0.0.1:{self.server_port}{path}"


class Handler(http.server.BaseHTTPRequestHandler):
    protocol_version = "HTTP/1.1"

    def do_GET(self):
        self.server.requests.append(Request(self.path, self.headers))
        status, body, headers = self.server.answers.get(self.path.split("?")[0], (404, b"", {}))
        if status == 200 and "ETag" in headers and self.headers.get("If-None-Match") == headers["ETag"]:
            status, body = 304, b""
        self.send_response(status)
        for name, value in {"Content-Length": str(len(body)), **headers}.items():
            self.send_header(name, value)
        self.end_headers()
        self.wfile.write(body)

    def log_message(self, *_):
        pass


def archive():
    content = io.BytesIO()
    with zipfile.ZipFile(content, "w", zipfile.ZIP_DEFLATED) as zipped:
        for name, words in SCHEDULE.items():
            zipped.writestr(f"{name}.txt", words)
    return content.getvalue()


class FromAServer(ProgramTest):
    def setUp(self):
        super().setUp()
        self.server = Server()
        self.addCleanup(self.server.server_close)
        threading.Thread(target=self.server.serve_forever, daemon=True).start()
        self.addCleanup(self.server.shutdown)
        self.server.answers["/s.zip"] = (200, archive(), {"ETag": '"s1"'})
        self.alerts(alert(selector(route="r1"), text(10, en="Works")))
        # The server's answers are judged at the time of the alerts, and what is fetched is kept.
        self.later("12:00:00")

    def later(self, time, day=24):
        """Each run of the program begins at the time set, so what comes later must be set later."""
        self.environment["ORVO_NOW"] = f"2024-07-{day}T{time}Z"

    def alerts(self, *alerts, tag='"a1"'):
        self.server.answers["/a.pb"] = (200, feed(NOW, *alerts), {"ETag": tag})

    def add(self, *options):
        return self.orvo("feeds", "add", "city", "--static", self.server.url("/s.zip"), "--alerts",
                         self.server.url("/a.pb"), *options)

    def incidents(self):
        return {line["route_id"]: [incident["title"] for incident in line["incidents"]]
                for line in self.orvo("incidents", "--all", "--json").json["lines"]}

    def test_schedule_and_alerts_are_fetched(self):
        self.assertEqual(self.add().err, "")
        self.assertEqual(self.incidents(), {"r1": ["Works"], "r2": [], "r3": []})

    def test_what_did_not_change_is_not_sent_again(self):
        self.add()
        self.server.requests.clear()
        self.later("12:01:00")
        self.assertEqual(self.orvo("feeds", "update").out, "city: nothing newer\n")
        self.assertEqual(self.incidents()["r1"], ["Works"])
        self.assertEqual([request.headers["If-None-Match"] for request in self.server.requests], ['"s1"', '"a1"'])
        self.later("12:02:00")
        self.alerts(tag='"a2"')
        self.assertEqual(self.incidents()["r1"], [])

    def test_compressed_answers(self):
        self.server.answers["/a.pb"] = (200, gzip.compress(feed(NOW, alert(selector(route="r2"), text(10, en="Zip")))),
                                        {"Content-Encoding": "gzip"})
        self.add()
        self.assertEqual(self.incidents()["r2"], ["Zip"])

    def test_keys_are_sent_and_shown_nowhere(self):
        secrets = ("Sesame", "Swordfish", "Xyzzy")
        shown = self.add("--header", "X-Api-Key: Sesame", "--query", "key=Swordfish", "--user", "me:Xyzzy")
        request = self.server.requests[0]
        self.assertEqual(request.headers["X-Api-Key"], "Sesame")
        self.assertIn("key=Swordfish", request.path)
        self.assertTrue(request.headers["Authorization"].startswith("Basic "))
        self.server.answers["/a.pb"] = (403, b"", {})
        self.environment["ORVO_LOG"] = "*=debug"
        answers = [shown, self.orvo("feeds", "list"), self.orvo("feeds", "list", "--json"),
                   self.run_orvo("feeds", "check"), self.run_orvo("feeds", "check", "--json"),
                   self.run_orvo("incidents", "--all", "--json"), self.run_orvo("feeds", "update", "--force")]
        for answer in answers:
            for secret in secrets:
                self.assertNotIn(secret, answer.out + answer.err)
        holding = [path for path, content in self.files().items()
                   if any(secret.encode() in content for secret in secrets)]
        self.assertEqual([path.name for path in holding], ["feeds-secrets.plist"])
        self.assertEqual(pathlib.Path(holding[0]).stat().st_mode & 0o777, 0o600)

    def test_a_failing_server_leaves_what_was_known_for_ten_minutes(self):
        self.add()
        self.assertEqual(self.incidents()["r1"], ["Works"])
        self.server.answers["/a.pb"] = (500, b"", {})
        self.later("12:09:00")
        self.assertEqual(self.incidents()["r1"], ["Works"])
        self.later("12:11:00")
        self.assertIn("500", self.refused(1, "incidents", "--all").err)

    def test_a_body_that_is_too_short_is_a_failed_fetch(self):
        whole = feed(NOW, alert(selector(route="r1"), text(10, en="Works")))
        self.server.answers["/a.pb"] = (200, whole[:-10], {"Content-Length": str(len(whole)), "Connection": "close"})
        self.assertIn("warning: the alerts", self.add().err)

    def test_one_request_however_many_lines(self):
        self.add()
        self.orvo("favorites", "add", "city:r1", "city:r2", "city:r3")
        self.server.requests.clear()
        self.orvo("incidents")
        self.assertEqual([request.path for request in self.server.requests], ["/a.pb"])

    def test_a_schedule_is_asked_for_again_after_a_day(self):
        self.add()
        self.orvo("favorites", "add", "city:r1")
        self.server.requests.clear()
        self.later("12:30:00", day=25)
        self.server.answers["/a.pb"] = (200, feed(NOW + 88000), {})
        self.orvo("incidents")
        self.assertEqual([request.path for request in self.server.requests], ["/a.pb", "/s.zip"])
        self.server.requests.clear()
        self.later("12:31:00", day=25)
        self.orvo("incidents")
        self.assertEqual([request.path for request in self.server.requests], ["/a.pb"])

    def test_a_missing_schedule_names_the_address_and_the_status(self):
        del self.server.answers["/s.zip"]
        answer = self.refused(1, "feeds", "add", "city", "--static", self.server.url("/s.zip"), "--alerts", "x.pb")
        self.assertIn("/s.zip", answer.err)
        self.assertIn("404", answer.err)


if __name__ == "__main__":
    unittest.main()
