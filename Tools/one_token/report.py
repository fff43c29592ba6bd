"""The report of the changes that were tried, and the list of those that are known to go unnoticed.
"""

import collections
import re
import threading


class Report:
    """A file with one line a change. What stands there already is not tried again, as long as the
    file that it changes is the same."""

    def __init__(self, path, hashes):
        self.path = path
        self.hashes = hashes  # Of the sources, by file.
        self.lock = threading.Lock()
        self.verdicts = {}
        if path.exists():
            self._read()

    def forget_unnoticed(self):
        """Those are tried again, because tests may have been added."""
        self.verdicts = {name: verdict for name, verdict in self.verdicts.items()
                         if verdict != "nobody"}

    def write(self):
        """Writes down what is known, before the first `add`."""
        lines = [self._head(file) + "\n" for file in self.hashes]
        lines += [line_of(name, verdict) for name, verdict in self.verdicts.items()]
        self.path.write_text("".join(lines), encoding="utf-8")

    def add(self, change, verdict):
        with self.lock:
            self.verdicts[change.name()] = verdict
            with self.path.open("a", encoding="utf-8") as file:
                file.write(line_of(change.name(), verdict))

    def _read(self):
        lines = self.path.read_text(encoding="utf-8").splitlines()
        known = {line for line in lines if line.startswith("# ")}
        same = {file for file in self.hashes if self._head(file) in known}
        self.verdicts = dict(parsed(line) for line in lines if line.split(":")[0] in same)

    def _head(self, file):
        return f"# {file} {self.hashes[file]}"


def line_of(name, verdict):
    words = {"nobody": "not noticed", "compiler": "does not compile"}
    return f"{name}: {words.get(verdict, 'noticed by ' + verdict)}\n"


def parsed(line):
    name, words = line.rsplit(": ", 1)
    verdicts = {"not noticed": "nobody", "does not compile": "compiler"}
    return name, verdicts.get(words, words.removeprefix("noticed by "))


class Reasons:
    """Why changes go unnoticed, by their known names: each paragraph holds names and, indented, the
    reason that they share. Changes of one name stand there as often as they go unnoticed."""

    def __init__(self, path):
        self.names = []
        for paragraph in re.split(r"\n(?:\s*\n)+", path.read_text(encoding="utf-8")):
            lines = [line for line in paragraph.splitlines() if not line.startswith("#")]
            if any(line.startswith(" ") for line in lines):
                self.names += [line for line in lines if not line.startswith(" ")]
        self.left = collections.Counter(self.names)

    def take(self, name):
        """Says whether there is a reason that no other change of the name has taken."""
        self.left[name] -= 1
        return self.left[name] >= 0

    def without_change(self, changes):
        """The names that stand there more often than among all changes."""
        return list((collections.Counter(self.names) -
                     collections.Counter(change.known_name() for change in changes)).elements())
