"""Words, options, exit codes and what stands where."""

import fcntl
import os
import pathlib
import pty
import struct
import subprocess
import termios
import unittest

from completing import Completing
from support import PROGRAM, ProgramTest


class Usage(ProgramTest):
    def test_help_is_an_answer_and_a_missing_command_is_not(self):
        self.assertIn("Commands:", self.orvo("--help").out)
        answer = self.refused(2)
        self.assertEqual(answer.out, "")
        self.assertIn("orvo --help", answer.err)

    def test_every_command_has_help_with_examples(self):
        for group in ("incidents", "lines", "feeds add", "feeds list", "feeds update", "feeds remove", "feeds check",
                      "favorites add", "favorites list", "favorites move", "favorites remove", "settings",
                      "defaults read", "defaults write", "defaults delete", "demo", "completion", "help"):
            answer = self.orvo(*group.split(), "--help")
            self.assertIn("Examples:", answer.out, group)
            self.assertIn(f"Usage: orvo {group}", answer.out)
            self.assertEqual(answer.err, "")

    def test_a_group_alone_says_what_it_has(self):
        self.assertIn("feeds add NAME", self.orvo("feeds", "--help").out)
        self.assertIn("orvo feeds --help", self.refused(2, "feeds").err)

    def test_slips_are_wrong_usage_with_the_cure(self):
        for words, cure in (
            (["incidnets"], "Did you mean orvo incidents?"),
            (["feeds", "lst"], "Did you mean orvo feeds list?"),
            (["incidents", "--jsno"], "Did you mean --json?"),
            (["lines"], "Usage: orvo lines SEARCH"),
            (["lines", ""], "Write a part of a name"),
            (["incidents", "--language", "%%"], "Write it as de or pt-BR."),
            (["help", "incidnets"], "Did you mean orvo incidents?"),
            (["incidents", "--at", "yesterday"], "2024-07-24T01:28:40Z"),
            (["settings", "step-free", "perhaps"], "on, off"),
        ):
            answer = self.refused(2, *words)
            self.assertIn(cure, answer.err)
            self.assertTrue(answer.err.startswith("orvo: "), answer.err)
            self.assertEqual(answer.out, "")

    def test_version(self):
        self.assertRegex(self.orvo("--version").out, r"^orvo \d+\.\d+\.\d+\n$")

    def test_global_options_may_stand_before_the_command(self):
        self.assertEqual(self.orvo("--at", "2024-07-24T01:28:40Z", "incidents", "--json").json["at"],
                         "2024-07-24T01:28:40Z")

    def test_an_empty_machine_answers_and_says_how_to_go_on(self):
        answer = self.orvo("incidents")
        self.assertEqual(answer.out, "")
        self.assertIn("orvo favorites add", answer.err)
        self.assertIn("orvo favorites add", self.orvo("favorites", "list").err)
        self.assertIn("orvo feeds add", self.orvo("feeds", "list").err)
        self.assertIn("orvo feeds add", self.orvo("lines", "harbour").err)
        self.assertEqual(self.orvo("lines", "harbour", "--json").json, {"lines": [], "total": 0, "error": None})

    def test_asking_makes_no_favourites_file(self):
        self.orvo("incidents")
        self.orvo("favorites", "list")
        self.assertFalse([path for path in self.files() if "favorites" in path.name])

    def test_output_that_cannot_be_written_is_a_failure(self):
        with open("/dev/full", "wb") as full:
            finished = subprocess.run(self.command("--help"), env=self.environment, stdout=full, stderr=subprocess.PIPE)
        self.assertEqual(finished.returncode, 1)
        self.assertIn(b"cannot be written", finished.stderr)


class Settings(ProgramTest):
    def test_step_free_is_kept(self):
        self.assertIn("step-free\toff", self.orvo("settings").out)
        self.orvo("settings", "step-free", "on")
        self.assertEqual(self.orvo("settings", "step-free").out, "on\n")
        self.assertEqual(self.orvo("settings", "--json").json, {"step-free": True})

    def test_the_debug_keys_are_defaults(self):
        key = "Orvo.TransitWidget.internal.injectFakeIncidents"
        self.refused(1, "defaults", "read", key)
        self.orvo("defaults", "write", key, "true")
        self.assertEqual(self.orvo("defaults", "read", key).out, "true\n")
        self.assertEqual(self.orvo("defaults", "read", "--json").json, {key: True})
        self.orvo("defaults", "delete", key)
        self.assertIn("is not set", self.refused(1, "defaults", "delete", key).err)

    def test_kinds_of_values(self):
        for text, kind, value in (("7", [], 7), ("7", ["--type", "string"], "7"), ("0.5", [], 0.5), ("on", [], "on")):
            self.orvo("defaults", "write", "k", text, *kind)
            self.assertEqual(self.orvo("defaults", "read", "k", "--json").json, {"k": value})
        self.refused(2, "defaults", "write", "k", "x", "--type", "integer")


class Completions(Completing, ProgramTest):
    def test_installed_scripts_are_what_the_program_prints(self):
        folder = pathlib.Path(os.environ["ORVO_SOURCE"]) / "packaging/completions"
        for shell, name in (("bash", "orvo.bash"), ("zsh", "_orvo"), ("fish", "orvo.fish")):
            printed = self.orvo("completion", shell).out
            if os.environ.get("ORVO_UPDATE_EXPECTATIONS"):
                (folder / name).write_text(printed)
            self.assertEqual(printed, (folder / name).read_text(), f"update with ORVO_UPDATE_EXPECTATIONS=1: {name}")

    def test_shells_can_read_them(self):
        for shell in ("bash", "zsh", "fish"):
            script = self.write(f"completion.{shell}", self.orvo("completion", shell).out.encode())
            subprocess.run([shell, "-n", script], check=True)

    HOSTILE = ("$(touch x)", "`touch y`", "it's", 'a"b', "back\\slash", "two words", "semi;colon", "*")

    def hostile_city(self):
        """A feed whose lines have such names, and one that no shell can offer: a line break divides it."""
        quoted = "".join('"%s",A,%d,3\n' % (name.replace('"', '""'), i) for i, name in enumerate(self.HOSTILE))
        routes = "route_id,agency_id,route_short_name,route_type\n" + quoted + '"new\nline",A,N,3\n'
        self.orvo("feeds", "add", "h", "--static", self.schedule(routes=routes), "--alerts", "nowhere.pb")

    def offered(self, shell, line):
        """What that shell offers at the end of the line."""
        return getattr(self, f"offered_by_{shell}")(self.orvo("completion", shell).out, line, [os.path.dirname(PROGRAM)])

    def offers_commands_options_and_this_machines_names(self, shell):
        self.assertEqual(self.offered(shell, "orvo fe"), ["feeds"])
        self.assertEqual(self.offered(shell, "orvo feeds re"), ["remove"])
        self.assertIn("--json", self.offered(shell, "orvo incidents --"))
        self.assertEqual(self.offered(shell, "orvo settings step-free o"), ["off", "on"])
        for command in ("read", "write", "delete"):
            self.assertEqual(self.offered(shell, f"orvo defaults {command} Orvo"), self.KEYS)
        self.hostile_city()
        self.assertEqual(self.offered(shell, "orvo feeds check "), ["h"])

    KEYS = [f"Orvo.TransitWidget.internal.{key}" for key in ("injectFakeIncidents", "randomNumberIncidents")]

    def test_help_takes_the_words_of_any_command(self):
        for shell in ("bash", "zsh", "fish"):
            with self.subTest(shell):
                commands = self.offered(shell, "orvo help ")
                self.assertIn("feeds", commands)
                self.assertIn("incidents", commands)
                self.assertEqual(self.offered(shell, "orvo help fe"), ["feeds"])
                self.assertEqual(self.offered(shell, "orvo help feeds "), ["add", "check", "list", "remove", "update"])
                self.assertEqual(self.offered(shell, "orvo help feeds --demo re"), ["remove"])
                self.assertEqual(self.offered(shell, "orvo help lines "), [])
                self.assertEqual(self.offered(shell, "orvo help feeds add "), [])
                self.assertIn("--demo", self.offered(shell, "orvo help --"))
                self.assertEqual(self.offered(shell, "orvo defaults "), ["delete", "read", "write"])

    def test_fish_offers_commands_options_and_this_machines_names(self):
        self.offers_commands_options_and_this_machines_names("fish")
        self.assertIn("h:$(touch x)", self.offered("fish", "orvo favorites add h:"))
        self.assertEqual(self.offered("fish", "orvo favorites add --demo city:S"), ["city:S1", "city:SKY"])
        self.assertFalse((self.home / "x").exists())

    def test_zsh_offers_commands_options_and_this_machines_names(self):
        self.offers_commands_options_and_this_machines_names("zsh")
        self.assertIn(r"h:\$\(touch\ x\)", self.offered("zsh", "orvo favorites add h:"))
        self.assertEqual(self.offered("zsh", "orvo favorites add --demo city:S"), ["city:S1", "city:SKY"])
        self.assertFalse((self.home / "x").exists())

    def test_bash_offers_commands_options_and_this_machines_names(self):
        self.offers_commands_options_and_this_machines_names("bash")
        self.orvo("feeds", "add", "city", "--static", self.schedule("other"), "--alerts", "nowhere.pb")
        self.assertEqual(self.offered("bash", "orvo favorites add city:r"), ["r1", "r2", "r3"])

    def test_files_are_offered_where_a_file_stands(self):
        (self.home / "a schedule").mkdir()
        for shell in ("bash", "zsh", "fish"):
            offered = self.offered(shell, "orvo feeds add city --static a")
            self.assertEqual([offer.rstrip("/").replace("\\", "") for offer in offered], ["a schedule"], shell)

    def test_bash_expands_nothing_that_strangers_wrote(self):
        self.hostile_city()
        script = self.write("completion.bash", self.orvo("completion", "bash").out.encode())
        commands = f"""
            source {script}
            PATH={os.path.dirname(PROGRAM)}:$PATH
            COMP_WORDS=(orvo favorites add '') COMP_CWORD=3 COMP_LINE='orvo favorites add ' COMP_POINT=19
            _orvo orvo '' add
            # As readline puts them into the line, read by the shell again.
            for reply in "${{COMPREPLY[@]}}"; do eval "printf '%s\\0' $reply"; done
        """
        finished = subprocess.run(["bash", "-c", commands], env=self.environment, cwd=self.home, capture_output=True,
                                  check=True)
        offered = finished.stdout.decode().split("\0")[:-1]
        self.assertEqual(sorted(offered), sorted("h:" + name for name in self.HOSTILE))
        self.assertEqual([path.name for path in self.home.iterdir() if path.name in ("x", "y")], [])

    def test_bash_asks_the_demonstration_where_the_line_does(self):
        self.assertEqual(self.offered("bash", "orvo favorites add city:S"), [])
        self.assertEqual(self.offered("bash", "orvo favorites add --demo city:S"), ["S1", "SKY"])
        self.assertEqual(self.offered("bash", "orvo --demo favorites add city:S"), ["S1", "SKY"])
        self.assertIn("--demo", self.offered("bash", "orvo incidents --"))


class OnATerminal(ProgramTest):
    def on_terminal(self, columns, *words):
        """What the program shows on a terminal of that width."""
        leader, follower = pty.openpty()
        fcntl.ioctl(follower, termios.TIOCSWINSZ, struct.pack("HHHH", 24, columns, 0, 0))
        environment = dict(self.environment, TERM="xterm")
        with subprocess.Popen(self.command(*words), env=environment, cwd=self.home, stdin=follower, stdout=follower,
                              stderr=follower) as process:
            os.close(follower)
            shown = b""
            while True:
                try:
                    chunk = os.read(leader, 65536)
                except OSError:
                    break
                if not chunk:
                    break
                shown += chunk
            self.assertEqual(process.wait(), 0, shown)
        os.close(leader)
        return shown.decode().replace("\r\n", "\n")

    def test_tables_fit_and_have_headings(self):
        self.orvo("feeds", "add", "city", "--static", self.schedule(), "--alerts", "nowhere.pb")
        for columns in (40, 60, 100):
            shown = self.on_terminal(columns, "lines", "city").replace("\x1b[2m", "").replace("\x1b[0m", "")
            self.assertIn("Line", shown.splitlines()[0])
            for line in shown.splitlines():
                self.assertLessEqual(len(line), columns, line)

    def test_the_feeds_fit_any_terminal(self):
        self.orvo("feeds", "add", "city", "--static", self.schedule(), "--alerts", "nowhere.pb")
        for columns in (30, 50, 80):
            for line in self.on_terminal(columns, "feeds", "list").splitlines():
                line = line.replace("\x1b[2m", "").replace("\x1b[0m", "")
                # A path is not broken: it could not be copied.
                self.assertTrue(len(line) <= columns or "/" in line, line)
        self.assertEqual(self.orvo("feeds", "list").out.count("\n"), 1)

    def test_an_import_shows_its_progress_and_takes_it_away(self):
        shown = self.on_terminal(80, "feeds", "add", "city", "--static", self.schedule(), "--alerts", "nowhere.pb")
        self.assertIn("\r\x1b[K", shown)
        self.assertIn("Importing", shown)


if __name__ == "__main__":
    unittest.main()
