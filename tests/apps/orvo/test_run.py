"""./run shows the person's own favourites, of whatever kind, before those of the demonstration."""

import os
import pathlib
import shutil
import subprocess
import unittest

from support import PROGRAM, Answer, ProgramTest


class Run(ProgramTest):
    def setUp(self):
        super().setUp()
        self.tree = self.home / "tree"
        shutil.copy(pathlib.Path(os.environ["ORVO_SOURCE"]) / "run", self.place("run"))
        # What it builds stands there already; only the widget is one that tells how it was started.
        self.place("build/release/build.ninja").touch()
        self.place("build/release/apps/orvo/orvo").symlink_to(PROGRAM)
        self.script("build/release/apps/widget/orvo-transit-widget", 'echo "widget $*"')
        self.script("tools/install-packages", ":")
        self.script("bin/ninja", ":")
        self.environment["PATH"] = f"{self.tree}/bin:{self.environment['PATH']}"

    def place(self, name):
        path = self.tree / name
        path.parent.mkdir(parents=True, exist_ok=True)
        return path

    def script(self, name, text):
        path = self.place(name)
        path.write_text(f"#!/bin/sh\n{text}\n")
        path.chmod(0o755)

    def run_it(self, *words):
        return Answer(subprocess.run([self.tree / "run", *words], env=self.environment, capture_output=True, timeout=60))

    def test_without_favourites_it_shows_the_demonstration(self):
        answer = self.run_it("--max-rows", "3")
        self.assertEqual((answer.code, answer.out), (0, "widget --demo --max-rows 3\n"), answer.err)
        self.assertIn("no favourites yet", answer.err)

    def test_without_a_display_there_are_pictures(self):
        self.assertEqual(self.run_it().out, "widget --demo --pictures build/pictures --scale 2\n")
        self.assertEqual(self.run_it("--print", "json").out, "widget --demo --print json\n")

    def test_a_favourite_line_is_one_of_ones_own(self):
        self.orvo("feeds", "add", "city", "--static", self.schedule(), "--alerts", "nowhere.pb")
        self.orvo("favorites", "add", "city:r1")
        self.assertEqual(self.run_it().out, "widget --pictures build/pictures --scale 2\n")

    def test_a_favourite_place_is_one_of_ones_own(self):
        self.orvo("favorites", "add", "--place", "Home", "--location", "54.3821,10.1401")
        self.assertEqual(self.run_it().out, "widget --pictures build/pictures --scale 2\n")

    def test_unreadable_favourites_are_not_like_none(self):
        self.orvo("favorites", "add", "--place", "Home", "--location", "54.3821,10.1401")
        for path in self.home.rglob("favorites.sqlite*"):
            path.write_bytes(b"no database at all, though long enough for a header of one")
        answer = self.run_it()
        self.assertEqual(answer.code, 1)
        self.assertNotIn("widget", answer.out)
        self.assertIn("favorites.sqlite is damaged", answer.err)


if __name__ == "__main__":
    unittest.main()
