"""Stores that another program holds all the while."""

import sqlite3
import subprocess
import unittest

from support import Answer, ProgramTest, alert, feed, selector, text


class Locked(ProgramTest):
    def setUp(self):
        super().setUp()
        alerts = self.write("city.pb", feed(0, alert(selector(route="r1"), text(10, en="Works"))))
        self.orvo("feeds", "add", "city", "--static", self.schedule(), "--alerts", alerts)
        self.orvo("favorites", "add", "city:r1")

    def hold(self, name):
        """Holds a store exclusively until the test ends, as a program that copies or mends it may."""
        path = self.home / "data" / "group.com.zentu.Orvo" / name
        holder = sqlite3.connect(path, isolation_level=None)
        self.addCleanup(holder.close)
        holder.execute("PRAGMA locking_mode = EXCLUSIVE")
        holder.execute("BEGIN EXCLUSIVE")
        return path, holder

    def side_by_side(self, *commands):
        """Each of them waits a while, so that all do at once."""
        running = [
            subprocess.Popen(self.command(*words), env=self.environment, cwd=self.home, stdin=subprocess.DEVNULL,
                             stdout=subprocess.PIPE, stderr=subprocess.PIPE)
            for words in commands
        ]
        for words, program in zip(commands, running):
            out, err = program.communicate(timeout=120)
            yield words, Answer(subprocess.CompletedProcess(words, program.returncode, out, err))

    def test_favourites(self):
        path, holder = self.hold("favorites.sqlite")
        for words, answer in self.side_by_side(["favorites", "list"], ["favorites", "add", "city:r2"],
                                               ["favorites", "remove", "1"], ["incidents", "--json"]):
            self.assertEqual(answer.code, 1, f"{words}: {answer.out}")
            self.assertIn(f"{path}: the favorites cannot be opened: database is locked\n"
                          "Another program uses the file. Try again when that is done.\n", answer.err, words)
            if "--json" in words:
                self.assertIn("database is locked", answer.json["error"]["message"])
        holder.close()
        self.assertIn("city:r1", self.orvo("favorites", "list").out)

    def test_favourites_that_are_being_written(self):
        path = self.home / "data" / "group.com.zentu.Orvo" / "favorites.sqlite"
        writer = sqlite3.connect(path, isolation_level=None)
        self.addCleanup(writer.close)
        writer.execute("BEGIN IMMEDIATE")
        self.assertIn("city:r1", self.orvo("favorites", "list").out)
        answer = self.refused(1, "favorites", "add", "city:r2")
        self.assertIn(f"{path}: the favorites cannot be changed: database is locked\nAnother program", answer.err)
        writer.close()
        self.orvo("favorites", "add", "city:r2")

    def test_schedules(self):
        path, holder = self.hold("schedules.sqlite")
        for words, answer in self.side_by_side(["lines", "ferry"], ["feeds", "list", "--json"], ["feeds", "remove", "city"],
                                               ["incidents", "--all", "--json"]):
            self.assertEqual(answer.code, 1, f"{words}: {answer.out}")
            self.assertIn(f"{path}: database is locked by another program; try again when that is done\n", answer.err,
                          words)
            if words[0] == "incidents":
                self.assertEqual(answer.json["lines"], [])
                self.assertIn("database is locked", answer.json["error"]["message"])
        holder.close()
        self.assertIn("city\t3\t", self.orvo("feeds", "list").out)


if __name__ == "__main__":
    unittest.main()
