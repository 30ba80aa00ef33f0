"""What the widget's end-to-end tests share, on top of what the other program's have."""

import os
import shutil
import stat
import subprocess

from support import Answer, ProgramTest, alert, feed, field, period, selector, text

WIDGET = os.environ["ORVO_WIDGET"]
AT = "2025-06-15T12:00:00Z"
NOW = 1749988800

INCIDENT = "com.zentu.Orvo.Transit.Incident"
INCIDENT_LIST = "com.zentu.Orvo.Transit.IncidentList"


class WidgetTest(ProgramTest):
    def run_widget(self, *words, program=WIDGET, **environment):
        return Answer(subprocess.run([program, *map(str, words)], env={**self.environment, **environment},
                                     cwd=self.home, capture_output=True, timeout=120))

    def widget(self, *words, **more):
        """Runs what must succeed."""
        answer = self.run_widget(*words, **more)
        self.assertEqual((answer.code, answer.err), (0, ""), f"{words}: {answer.out}")
        return answer

    def widget_refused(self, code, *words, **more):
        answer = self.run_widget(*words, **more)
        self.assertEqual(answer.code, code, f"{words}: {answer.out}{answer.err}")
        return answer

    def rows(self, *words):
        return self.widget("--print", "json", *words).json

    def city(self, *words, at=AT):
        """The rows of the demonstration city at a time of its own."""
        return self.rows("--demo", "--at", at, *words)

    def feed(self, *alerts, favorites=("r1", "r2", "r3"), schedule=None):
        """The person's own feed with these alerts, at the time that its tests run at."""
        self.environment["ORVO_NOW"] = AT
        path = self.write("alerts.pb", feed(NOW, *alerts))
        self.orvo("feeds", "add", "city", "--static", self.schedule(**(schedule or {})), "--alerts", path)
        if favorites:
            self.orvo("favorites", "add", *(f"city:{route}" for route in favorites))
        return path

    def kept(self):
        """Everything below the home folder with its bytes, but for what readers of a store use among themselves."""
        files = self.files()
        for path, content in files.items():
            self.assertFalse(path.name.endswith("-wal") and content, f"{path} has been written to")
        return {path: content for path, content in files.items() if not path.name.endswith(("-shm", "-wal"))}

    def recording_orvo(self, code=0):
        """A copy of the widget beside an `orvo` that notes its words and standard input; their folder."""
        folder = self.home / "bin"
        folder.mkdir()
        copy = folder / "orvo-transit-widget"
        try:
            os.link(WIDGET, copy)
        except OSError:
            shutil.copy(WIDGET, copy)
        orvo = folder / "orvo"
        orvo.write_text(f'#!/bin/sh\ncat > "{folder}/input.part"\nprintf "%s\\n" "$@" > "{folder}/words.part"\n'
                        f'mv "{folder}/input.part" "{folder}/input"\nmv "{folder}/words.part" "{folder}/words"\n'
                        f"exit {code}\n", encoding="utf-8")
        orvo.chmod(orvo.stat().st_mode | stat.S_IXUSR)
        return folder


def shown(rows):
    """The titles of the expanded rows."""
    return [row["primaryText"] for row in rows["expanded"]]


__all__ = ["AT", "INCIDENT", "INCIDENT_LIST", "NOW", "WIDGET", "WidgetTest", "alert", "field", "period",
           "selector", "shown", "text"]
