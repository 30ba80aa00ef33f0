"""What is installed: whole, where a desktop finds it, working from there; and taken away again, with nothing else."""

import os
import pathlib
import shutil
import subprocess
import unittest

import handing
from handing import INTERFACE, NAME, PATH, BusTest, line, tap_on_line

BUILD = pathlib.Path(os.environ["ORVO_BUILD"])
CMAKE = os.environ["CMAKE"]
RECORDS = ("install_manifest.txt", "install_folders.cmake")
EXPECTED = (
    "bin/orvo",
    "bin/orvo-transit-widget",
    "share/applications/com.zentu.Orvo.desktop",
    "share/applications/com.zentu.Orvo.TransitWidget.desktop",
    "share/dbus-1/services/com.zentu.Orvo.service",
    "share/icons/hicolor/scalable/apps/com.zentu.Orvo.svg",
    "share/bash-completion/completions/orvo",
    "share/bash-completion/completions/orvo-transit-widget",
    "share/zsh/site-functions/_orvo",
    "share/zsh/site-functions/_orvo-transit-widget",
    "share/fish/vendor_completions.d/orvo.fish",
    "share/fish/vendor_completions.d/orvo-transit-widget.fish",
    "share/orvo-transit-widget/en.lproj/Localizable.strings",
    "share/orvo-transit-widget/ar.lproj/Localizable.strings",
    "share/orvo-transit-widget/en.lproj/Windows.strings",
    "share/orvo-transit-widget/ar.lproj/Windows.strings",
    "lib/orvo-transit-widget/System/Library/PrivateFrameworks/Lockbox.framework/Lockbox",
    "lib/orvo-transit-widget/OrvoSockets.so",
)


class InstallTest(BusTest):
    def start_bus(self):
        # Where it goes is the test's to say.
        self.environment.pop("DESTDIR", None)
        # A developer's own installation from this build folder must still be known afterwards.
        saved = self.home / "records"
        saved.mkdir()
        for name in RECORDS:
            if (BUILD / name).exists():
                shutil.copy2(BUILD / name, saved)
        self.addCleanup(self.restore, {path.name: path.read_bytes() for path in saved.iterdir()})

    @staticmethod
    def restore(saved):
        for name in RECORDS:
            if name in saved:
                (BUILD / name).write_bytes(saved[name])
            else:
                (BUILD / name).unlink(missing_ok=True)

    def cmake(self, *words, **environment):
        finished = subprocess.run([CMAKE, *map(str, words)], env={**self.environment, **environment},
                                  capture_output=True, text=True, timeout=300)
        self.assertEqual(finished.returncode, 0, finished.stdout + finished.stderr)
        return finished.stdout

    def uninstall(self):
        return self.cmake("-DBUILD=" + str(BUILD), "-P", pathlib.Path(os.environ["ORVO_SOURCE"]) / "cmake/uninstall.cmake")

    @staticmethod
    def below(folder):
        return sorted(str(path.relative_to(folder)) for path in folder.rglob("*") if not path.is_dir())


class Staged(InstallTest):
    def setUp(self):
        super().setUp()
        self.stage = self.home / "stage"
        self.cmake("--install", BUILD, "--prefix", "/opt/transit map", DESTDIR=str(self.stage))
        self.prefix = self.stage / "opt/transit map"

    def test_everything_is_there(self):
        files = self.below(self.prefix)
        for name in EXPECTED:
            self.assertIn(name, files)
        self.assertEqual(self.below(self.stage), ["opt/transit map/" + name for name in files])

    def test_descriptions_name_the_programs_where_they_will_be(self):
        service = (self.prefix / "share/dbus-1/services/com.zentu.Orvo.service").read_text()
        self.assertIn('Exec="/opt/transit map/bin/orvo" service\n', service)
        self.assertIn("Name=com.zentu.Orvo\n", service)
        desktop = (self.prefix / "share/applications/com.zentu.Orvo.desktop").read_text()
        self.assertIn('Exec="/opt/transit map/bin/orvo" open %U\n', desktop)
        self.assertIn("MimeType=x-scheme-handler/orvo;\n", desktop)
        self.assertIn("DBusActivatable=true\n", desktop)

    def test_the_desktop_files_are_valid(self):
        if not shutil.which("desktop-file-validate"):
            self.skipTest("there is no desktop-file-validate")
        for path in (self.prefix / "share/applications").iterdir():
            finished = subprocess.run(["desktop-file-validate", path], capture_output=True, text=True)
            self.assertEqual((finished.returncode, finished.stdout + finished.stderr), (0, ""))

    def test_the_programs_run_from_there(self):
        for program in ("orvo", "orvo-transit-widget"):
            finished = subprocess.run([self.prefix / "bin" / program, "--version"], env=self.environment,
                                      capture_output=True, text=True)
            self.assertEqual(finished.returncode, 0, finished.stderr)

    def test_their_resources_are_those_beside_them(self):
        texts = self.prefix / "share/orvo-transit-widget/en.lproj/Localizable.strings"
        words = texts.read_text()
        self.assertIn("Good service", words)
        texts.write_text(words.replace("Good service", "Splendid service"))
        finished = subprocess.run([self.prefix / "bin/orvo-transit-widget", "--demo", "--print", "text"],
                                  env=self.environment, capture_output=True, text=True, timeout=120)
        self.assertIn("Splendid service", finished.stdout, finished.stderr)

    def test_servers_are_asked_by_the_library_beside_them(self):
        def reason():
            finished = subprocess.run([self.prefix / "bin/orvo", "feeds", "add", "city", "--static", "http://127.0.0.1:9/city.zip",
                                       "--alerts", "http://127.0.0.1:9/alerts.pb"],
                                      env=self.environment, capture_output=True, text=True, timeout=120)
            self.assertEqual(finished.returncode, 1, finished.stdout)
            return finished.stderr

        self.assertIn("refused", reason())
        library = self.prefix / "lib/orvo-transit-widget/OrvoSockets.so"
        library.unlink()
        self.assertIn(str(library.resolve()), reason())

    def test_nothing_is_left_of_it(self):
        self.uninstall()
        self.assertFalse(self.stage.exists(), self.below(self.stage) if self.stage.exists() else "")

    def test_what_others_put_there_stays(self):
        own = self.prefix / "share/applications/other.desktop"
        own.write_text("[Desktop Entry]\n")
        in_ours = self.prefix / "share/orvo-transit-widget/note.txt"
        in_ours.write_text("mine")
        self.uninstall()
        self.assertEqual(self.below(self.prefix), ["share/applications/other.desktop", "share/orvo-transit-widget/note.txt"])

    def test_folders_that_were_there_stay(self):
        self.uninstall()
        (self.prefix / "share/fish").mkdir(parents=True)
        (self.prefix / "bin").mkdir()
        for _ in range(2):  # installing twice makes no difference
            self.cmake("--install", BUILD, "--prefix", "/opt/transit map", DESTDIR=str(self.stage))
        self.uninstall()
        self.assertEqual(sorted(str(path.relative_to(self.prefix)) for path in self.prefix.rglob("*")),
                         ["bin", "share", "share/fish"])

    def test_there_is_nothing_to_take_away_twice(self):
        self.uninstall()
        finished = subprocess.run([CMAKE, "-DBUILD=" + str(BUILD), "-P",
                                   pathlib.Path(os.environ["ORVO_SOURCE"]) / "cmake/uninstall.cmake"],
                                  capture_output=True, text=True)
        self.assertNotEqual(finished.returncode, 0)
        self.assertIn("Nothing was installed", finished.stderr)


class InPlace(InstallTest):
    def setUp(self):
        super().setUp()
        self.prefix = self.home / "prefix"
        self.cmake("--install", BUILD, "--prefix", self.prefix)

    def test_a_bus_starts_the_installed_program(self):
        self.bus_with(f"<servicedir>{self.prefix}/share/dbus-1/services</servicedir>")
        self.assertFalse(self.is_running())
        answer = self.ask(NAME, PATH, f"{INTERFACE}.Open", "['orvo://?t=r']", "{}")
        self.assertEqual(answer.returncode, 0, answer.stderr)
        self.assertEqual(os.readlink(f"/proc/{self.owner()}/exe"), str((self.prefix / "bin/orvo").resolve()))
        self.assertIn("No favourite lines", self.orvo("show").out)

    def test_the_installed_program_takes_activities_without_a_bus(self):
        self.environment["DBUS_SESSION_BUS_ADDRESS"] = "disabled:"
        finished = subprocess.run([self.prefix / "bin/orvo", "receive", "ContinueUserActivity"], env=self.environment,
                                  input=tap_on_line(line("U1")), capture_output=True, timeout=handing.PATIENCE)
        self.assertEqual(finished.returncode, 0, finished.stderr)
        self.assertIn("U1 · Metro", finished.stdout.decode())

    def test_links_find_it_and_no_longer_when_it_is_gone(self):
        if not shutil.which("update-desktop-database"):
            self.skipTest("there is no update-desktop-database")
        cache = self.prefix / "share/applications/mimeinfo.cache"
        self.assertIn("x-scheme-handler/orvo=com.zentu.Orvo.desktop;", cache.read_text())
        self.uninstall()
        self.assertFalse(self.prefix.exists())


if __name__ == "__main__":
    unittest.main()
