"""What the real shells offer with a program's completion script."""

import os
import shutil
import subprocess

# A shell of its own on a terminal, as completion needs one; what it would offer goes into a file. Nothing is typed before its line
# editor has the terminal: until then the system itself would take \x15 as the order to forget what was typed.
CAPTURE = r"""
zmodload zsh/zpty
zpty shell zsh -f -i
zpty -w shell "PROMPT= PS2= fpath=($FOLDER \$fpath); cd $PLACE; autoload -Uz compinit; compinit -u -D; bindkey '^I' complete-word
compadd() {
    local -a hits
    if [[ \${@[1,(i)(-|--)]} != *-(O|A|D)\\ * ]]; then
        builtin compadd -A hits \"\$@\"
        (( \$#hits )) && print -rl -- \$hits >> $OFFERS
    fi
    builtin compadd \"\$@\"
}
zle-line-init() { print begin''done }
zle -N zle-line-init"
zpty -r shell text '*begindone*'
zpty -w -n shell "$LINE"$'\t'
zpty -w -n shell $'\x15print fin''ished\n'
zpty -r shell text '*finished*'
zpty -d shell
"""


class Completing:
    """For a `ProgramTest`. The programs are found in `folders`; a script is text."""

    PATIENCE = 60

    def shell_environment(self, folders, **more):
        path = os.pathsep.join([*map(str, folders), self.environment["PATH"]])
        return dict(self.environment, PATH=path, **more)

    def need(self, shell):
        if not shutil.which(shell):
            self.skipTest(f"there is no {shell}")

    def offered_by_bash(self, script, line, folders):
        """What it replies at the end of the line."""
        file = self.write("completion.bash", script.encode())
        words = line.split(" ")
        quoted = " ".join(f"'{word}'" for word in words)
        function = f"_{words[0].replace('-', '_')}"
        commands = f"""
            source {file}
            COMP_WORDS=({quoted}) COMP_CWORD={len(words) - 1} COMP_LINE='{line}' COMP_POINT={len(line)}
            {function} {words[0]} '{words[-1]}' '{words[-2]}'
            printf '%s\\0' "${{COMPREPLY[@]}}"
        """
        finished = subprocess.run(["bash", "-c", commands], env=self.shell_environment(folders), cwd=self.home,
                                  capture_output=True, timeout=self.PATIENCE)
        self.assertEqual((finished.returncode, finished.stderr), (0, b""))
        return sorted(filter(None, finished.stdout.decode().split("\0")))

    def offered_by_fish(self, script, line, folders):
        self.need("fish")
        file = self.write("completion.fish", script.encode())
        finished = subprocess.run(["fish", "--no-config", "-c", f"source {file}; complete -C $LINE"], cwd=self.home,
                                  env=self.shell_environment(folders, LINE=line), capture_output=True,
                                  timeout=self.PATIENCE)
        self.assertEqual((finished.returncode, finished.stderr), (0, b""))
        return sorted(offer.split("\t")[0] for offer in finished.stdout.decode().splitlines())

    def offered_by_zsh(self, script, line, folders):
        """Each as it will stand in the line, backslashes and all."""
        self.need("zsh")
        scripts = self.home / "zsh"
        scripts.mkdir(exist_ok=True)
        (scripts / f"_{line.split(' ')[0]}").write_text(script)
        offers = self.write("offers", b"")
        finished = subprocess.run(["zsh", "-f", "-c", CAPTURE], capture_output=True, timeout=self.PATIENCE,
                                  env=self.shell_environment(folders, LINE=line, FOLDER=str(scripts), PLACE=str(self.home),
                                                             OFFERS=str(offers)))
        self.assertEqual((finished.returncode, finished.stderr), (0, b""))
        return sorted(set(offers.read_text().splitlines()))
