"""Finds out which tests come to which change, so that only these are run on it."""

import concurrent.futures
import subprocess
import tempfile


class Reach:
    """The tests of each program that come to each change."""

    def __init__(self, programs, count, jobs):
        """Runs every test of `programs` alone, once, without any change; `count` is that of the
        changes. `failed` names the tests that fail."""
        self.tests = {}  # By number, then by program.
        self.failed = []
        names = [(program, test) for program in programs.files()
                 for test in tests_of(programs.files()[program])]
        with concurrent.futures.ThreadPoolExecutor(jobs) as pool:
            results = pool.map(lambda name: self._run(programs, count, *name), names)
            for (program, test), (is_passed, numbers) in zip(names, results):
                if not is_passed:
                    self.failed.append(test)
                for number in numbers:
                    self.tests.setdefault(number, {}).setdefault(program, []).append(test)

    def of(self, number):
        return self.tests.get(number, {})

    @staticmethod
    def _run(programs, count, program, test):
        """Whether the test passes, and the numbers of the changes that it comes to."""
        with tempfile.NamedTemporaryFile() as marks:
            marks.truncate(count + 1)
            is_passed = programs.passes(program, [test], {"ONE_TOKEN_MARKS": marks.name})
            return is_passed, [i for i, mark in enumerate(marks.read()) if mark]


def tests_of(program):
    """The full names of a program's tests."""
    listed = subprocess.run([str(program), "--gtest_list_tests"], stdout=subprocess.PIPE, text=True,
                            check=True).stdout
    names, suite = [], ""
    for line in listed.splitlines():
        name = line.split("#")[0].strip()
        if line.startswith(" "):
            names.append(suite + name)
        else:
            suite = name
    return names
