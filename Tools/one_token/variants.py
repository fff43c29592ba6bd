"""Builds the plug-in once with many changes, one of which is chosen when it runs.

A function's body becomes a chain of its changed copies, each behind a test of its number, and the
body as it was. What does not compile is found by the places of the errors and left out.
"""

import concurrent.futures
import re
import shutil
import subprocess
import threading

from one_token.tokens import Source

# The flags of the project's own build with clang; what these refuse, nobody could land. Warnings of
# what is not used and of missing parentheses are left out: a change is no better for them.
FLAGS = ("-std=c++20 -O0 -fPIC -fvisibility=hidden -fvisibility-inlines-hidden -ffp-contract=off "
         "-Wall -Wextra -Wpedantic -Wshadow -Wconversion -Wthread-safety -Werror -Wno-unused "
         "-Wno-unused-parameter -Wno-parentheses -ferror-limit=0 -fbracket-depth=2048").split()


def flags_of_abi():
    """Make clang++ name the ABI that g++ names, which is what hosts compare."""
    name = "__GXX_ABI_VERSION"
    macros = subprocess.run(["g++", "-dM", "-E", "-x", "c++", "/dev/null"], text=True, check=True,
                            stdout=subprocess.PIPE).stdout
    version = re.search(rf"^#define {name} (\d+)$", macros, re.MULTILINE).group(1)
    return ["-Wno-builtin-macro-redefined", f"-U{name}", f"-D{name}={version}"]


FLAGS += flags_of_abi()
# Where a file for marks is given, the changes that a process comes to are marked there.
CHOICE = """\
#pragma once
#include <fcntl.h>
#include <sys/mman.h>
#include <unistd.h>
#include <cstdlib>
inline char* marksOfChanges() {
  const char* const name = std::getenv("ONE_TOKEN_MARKS");
  if (!name) return nullptr;
  const int file = open(name, O_RDWR | O_CLOEXEC);
  const auto size = static_cast<std::size_t>(lseek(file, 0, SEEK_END));
  void* const marks = mmap(nullptr, size, PROT_READ | PROT_WRITE, MAP_SHARED, file, 0);
  if (marks == MAP_FAILED) std::abort();
  close(file);
  return static_cast<char*>(marks);
}
inline bool isChosenChange(int number) {
  static char* const marks = marksOfChanges();
  if (marks) marks[number] = 1;
  static const int chosen = [] {
    const char* const text = std::getenv("ONE_TOKEN_CHANGE");
    return text ? std::atoi(text) : 0;
  }();
  return number == chosen;
}
"""
# Each copy says that it stands in a file of this name, so that a message names the change and the
# alternative of it that was tried.
PLACE = "change-{}-{}"
MESSAGE = re.compile(r"^(?:change-(\d+)-(\d+)|.*?):\d+:\d+: (error|fatal error|note): ",
                     re.MULTILINE)


class VariantsError(Exception):
    """The sources do not compile, whatever is left out."""


def bodies_of(text):
    """Start and end of each function's body, braces included; none lies within another. Those that
    compilers may run are left out: no environment chooses there."""
    source, spans = Source(text), []
    for i in sorted(source.bodies):
        start, end = source.tokens[i].start, source.tokens[source.partner[i]].end
        if spans and start < spans[-1][1]:
            continue
        declaration = re.split(r"[;{}]", text[:start])[-1]
        if not re.search(r"\bconst(expr|eval)\b", declaration):
            spans.append((start, end))
    return spans


class Variants:
    """The changed copies of one file."""

    def __init__(self, text, changes):
        """`changes` are those of the file, by number."""
        self.text = text
        self.spans = bodies_of(text)
        self.changes = {number: change for number, change in changes.items()
                        if self._is_in_body(change)}
        self.alternative = dict.fromkeys(self.changes, 0)

    def written(self):
        """The file with all copies."""
        pieces, done = [], 0
        for start, end in self.spans:
            copies = [self._copy(number, start, end) for number, change in self.changes.items()
                      if start < change.start < end]
            if copies:
                pieces += [self.text[done:start], "{", *copies, self.text[start:end], "}"]
                done = end
        return "".join(pieces) + self.text[done:]

    def leave_out(self, number, alternative):
        """Takes the next alternative for a change, or leaves it out."""
        if number not in self.changes or self.alternative[number] != alternative:
            return
        self.alternative[number] += 1
        if self.alternative[number] == len(self.changes[number].alternatives):
            del self.changes[number]

    def _is_in_body(self, change):
        end = change.start + len(change.before)
        return any(first < change.start and end < last for first, last in self.spans)

    def _copy(self, number, start, end):
        change, alternative = self.changes[number], self.alternative[number]
        body = self.text[start:end]
        at = change.start - start
        changed = body[:at] + change.alternatives[alternative] + body[at + len(change.before):]
        place = PLACE.format(number, alternative)
        return (f'\n#line 1 "{place}"\nif (::isChosenChange({number})) {changed} else'
                f'\n#line 1 "unchanged"\n')


class VariantBuild:
    """The objects of all units, with the changes of the units and of the headers."""

    def __init__(self, sources, folder, changes):
        """`sources` holds the sources as they are, `changes` are by number; all is made in
        `folder`."""
        self.sources = sources
        self.folder = folder
        self.choice = folder / "choice.h"
        self.changes = changes
        self.variants = {}  # By file.
        self.lock = threading.Lock()

    def objects(self, units, jobs):
        """Compiles `units` with all changes that do compile; gives the objects."""
        shutil.copytree(self.sources, self.folder / "Sources")
        self.choice.write_text(CHOICE)
        for file in sorted({change.file for change in self.changes.values()}):
            text = (self.folder / file).read_text(encoding="utf-8")
            chosen = {number: change for number, change in self.changes.items()
                      if change.file == file}
            self.variants[file] = Variants(text, chosen)
            self._write(file)
        with concurrent.futures.ThreadPoolExecutor(jobs) as pool:
            return list(pool.map(self._compile, units))

    def built(self):
        """The numbers of the changes that were built."""
        return {number for variants in self.variants.values() for number in variants.changes}

    def left_out(self):
        """The numbers of those that do not compile."""
        return {number for variants in self.variants.values() for number in variants.alternative
                if number not in variants.changes}

    def _write(self, file):
        """Replaces the file at once: another unit may be about to include it."""
        made = self.folder / f"{file}.new"
        made.write_text(self.variants[file].written(), encoding="utf-8")
        made.replace(self.folder / file)

    def _compile(self, unit):
        source, target = self.folder / unit, self.folder / f"{unit}.o"
        while True:
            # A function ends with all copies of its body at once, so nothing said about its end
            # could be told to be about one of them.
            done = subprocess.run(["clang++", *FLAGS, "-Wno-return-type",
                                   "-Wno-invalid-noreturn", "-include", str(self.choice),
                                   f"-I{self.folder}/Sources", "-c", str(source), "-o",
                                   str(target)], stderr=subprocess.PIPE, text=True, check=False)
            if done.returncode == 0:
                return str(target)
            self._leave_out(done.stderr)

    def _leave_out(self, messages):
        """Leaves out what the errors are about."""
        wrong, is_elsewhere = set(), False
        for number, alternative, kind in MESSAGE.findall(messages):
            # Behind an error in a header, a note says where that was called.
            if kind != "note" or is_elsewhere:
                is_elsewhere = not number
                if number:
                    wrong.add((int(number), int(alternative)))
        if not wrong:
            raise VariantsError(messages)
        with self.lock:
            for number, alternative in wrong:
                self.variants[self.changes[number].file].leave_out(number, alternative)
            for file in {self.changes[number].file for number, _ in wrong}:
                self._write(file)
