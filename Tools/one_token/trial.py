"""Runs the tests on the plug-in with a change, without touching the checkout."""

import pathlib
import re
import shlex
import shutil
import subprocess

from one_token.reach import Reach
from one_token.variants import FLAGS, VariantBuild
from one_token.watched import passes

LINKER = "lld" if shutil.which("ld.lld") else "gold"
FOLDERS = ("Assistant", "Logging")
MODULE = "NidusAssistant"
MODULE_FILE = "lib/nidus/NidusAssistant.so"
LIBRARY = "libPlatformModel.so"
MODULE_UNIT = "Sources/Assistant/Module.cpp"
UNIT_TESTS = ("LoggingTests", "AssistantTests")
MODULE_TESTS = ("ModuleTests", "ReplayTests")
# The programs in the order in which they are run, with what is linked anew for each of them.
LINKED = {**{name: name for name in UNIT_TESTS}, **{name: MODULE for name in MODULE_TESTS}}


class TrialError(Exception):
    """Something that keeps all trials from going on."""


def run(command, folder=None):
    """Runs a command of the set-up, which has to succeed."""
    done = subprocess.run(command, cwd=folder, stdout=subprocess.PIPE, stderr=subprocess.STDOUT,
                          text=True, check=False)
    if done.returncode:
        raise TrialError(f"{shlex.join(map(str, command))}\n{done.stdout}")
    return done.stdout


class Workshop:
    """All that the trials start from: copies of the sources and of what is linked with the changed
    units, so that the checkout and its build folder may change meanwhile."""

    def __init__(self, checkout, work, preset):
        self.build = checkout / "build" / preset
        self.work = work
        self.sources = work / "Sources"
        if not (self.build / "build.ninja").exists():
            run(["cmake", "--preset", preset], checkout)
        run(["cmake", "--build", self.build, "--target", *UNIT_TESTS, *MODULE_TESTS])
        shutil.rmtree(work / "Sources", ignore_errors=True)
        for folder in ("PlatformModel", *FOLDERS):
            shutil.copytree(checkout / "Sources" / folder, self.sources / folder)
        self.links = {target: self._link_command(target)
                      for target in (*UNIT_TESTS, MODULE)}
        for program in ("nidus", *MODULE_TESTS):
            shutil.copy2(self.build / "bin" / program, work / program)
        shutil.copy2(self.build / "lib" / LIBRARY, work / LIBRARY)

    def units(self):
        return sorted(str(path.relative_to(self.work)) for folder in FOLDERS
                      for path in (self.sources / folder).glob("*.cpp"))

    def units_of(self, file):
        """The units that a change of `file` reaches."""
        if file.endswith(".cpp"):
            return [file]
        return [unit for unit in self.units() if self._includes(unit, file, set())]

    def _includes(self, file, header, seen):
        if file in seen or not (self.work / file).exists():
            return False
        seen.add(file)
        included = re.findall(r'^#include "(.*)"', (self.work / file).read_text(), re.MULTILINE)
        return any(f"Sources/{name}" == header or self._includes(f"Sources/{name}", header, seen)
                   for name in included)

    def _link_command(self, target):
        """The build's command that links a target, without the target, with its inputs copied
        without debug information."""
        commands = run(["ninja", "-C", self.build, "-t", "commands", target]).splitlines()
        words = shlex.split(commands[-1])
        words = words[words.index("&&") + 1:]
        words = words[:words.index("&&")]
        output = words.index("-o")
        del words[output:output + 2]
        folder = self.work / target
        shutil.rmtree(folder, ignore_errors=True)
        folder.mkdir()
        return [self._copied(folder, word) for word in words if word != "-g"]

    def _copied(self, folder, word):
        file = self.build / word
        if word.startswith("-") or not word.endswith((".o", ".a", ".so")) or not file.exists():
            return word
        copy = folder / file.name
        run(["objcopy", "--strip-debug", file, copy])
        return str(copy)


class Programs:
    """Test programs and module with changed units, in a folder of their own."""

    def __init__(self, workshop, folder):
        self.workshop = workshop
        self.folder = folder
        shutil.rmtree(folder, ignore_errors=True)
        (folder / "bin").mkdir(parents=True)
        (folder / MODULE_FILE).parent.mkdir(parents=True)
        # The program looks for its libraries beside itself.
        shutil.copy2(workshop.work / "nidus", folder / "bin/nidus")
        shutil.copy2(workshop.work / LIBRARY, folder / "lib" / LIBRARY)

    def link(self, target, objects):
        """Links a target with its part of the changed `objects`, by unit, in front, so that their
        definitions are the ones taken; says whether that could be done."""
        changed = [made for unit, made in objects.items() if is_part(unit, target)]
        first, *others = self.workshop.links[target]
        command = [first, f"-fuse-ld={LINKER}", "-Wl,--allow-multiple-definition", *changed,
                   *others, "-o", str(self.folder / (MODULE_FILE if target == MODULE else target))]
        return subprocess.run(command, stderr=subprocess.DEVNULL, check=False).returncode == 0

    def files(self):
        """The programs in the order in which they are run."""
        return {name: (self.folder if name in UNIT_TESTS else self.workshop.work) / name
                for name in LINKED}

    def noticed_by(self, tests, number=0):
        """The first program of which one of the tests, by program, fails with the change of that
        number; "nobody" when all pass."""
        for name in LINKED:
            if name in tests and not self.passes(name, tests[name],
                                                 {"ONE_TOKEN_CHANGE": str(number)}):
                return name
        return "nobody"

    def noticed_apart(self, objects):
        """The first program of which a test fails with these objects, or "nobody"; "compiler" when
        they cannot be linked. Nothing is linked before it is needed."""
        linked = set()
        for name, target in LINKED.items():
            if not any(is_part(unit, target) for unit in objects):
                continue
            if target not in linked and not self.link(target, objects):
                return "compiler"
            linked.add(target)
            if not self.passes(name, ["*"], {}):
                return name
        return "nobody"

    def passes(self, name, tests, environment):
        """Says whether these tests of a program pass."""
        return passes(self.files()[name], ["--gtest_filter=" + ":".join(tests)],
                      dict(environment, NIDUS_PROGRAM=str(self.folder / "bin/nidus"),
                           NIDUS_MODULE_FILE=str(self.folder / MODULE_FILE)),
                      self.folder)


def is_part(unit, target):
    """Says whether a target is linked with a unit."""
    if target == "LoggingTests":
        return "/Logging/" in unit
    return target == MODULE or unit != MODULE_UNIT


class Trials:
    """Tries changes: most of them in programs that hold all, the others one by one."""

    def __init__(self, workshop, changes, jobs):
        """`changes` are by number, from 1."""
        self.workshop = workshop
        self.changes = changes
        folder = workshop.work / "all"
        shutil.rmtree(folder, ignore_errors=True)
        build = VariantBuild(workshop.sources, folder, changes)
        files = {change.file for change in changes.values()}
        units = sorted({unit for file in files for unit in workshop.units_of(file)})
        self.all = Programs(workshop, workshop.work / "programs")
        objects = dict(zip(units, build.objects(units, jobs)))
        if not all(self.all.link(target, objects) for target in set(LINKED.values())):
            raise TrialError("the changed units cannot be linked")
        self.reach = Reach(self.all, len(changes), jobs)
        if self.reach.failed:
            raise TrialError(f"{len(self.reach.failed)} tests fail without any change, such as "
                             f"{self.reach.failed[0]}")
        noticer = self.all.noticed_by(dict.fromkeys(LINKED, ["*"]))
        if noticer != "nobody":
            raise TrialError(f"{noticer} fails without any change")
        self.built, self.left_out = build.built(), build.left_out()
        self.spare = [Programs(workshop, workshop.work / f"apart{i}") for i in range(jobs)]

    def order(self):
        """The numbers of all changes, those that take long last."""
        quick = {number for number in self.built | self.left_out
                 if not self.changes[number].is_dropped_return()}
        return sorted(self.changes, key=lambda number: number not in quick)

    def verdict(self, number):
        """Which program notices the change, "nobody", or "compiler" when it cannot be built."""
        change = self.changes[number]
        if number in self.left_out:
            return "compiler"
        if number in self.built and not change.is_dropped_return():
            return self.all.noticed_by(self.reach.of(number), number)
        programs = self.spare.pop()
        try:
            if number not in self.built:
                return self._verdict_apart(change, programs)
            # Whether a function still returns without the statement, only its own compilation says.
            is_sound = self._compiled_apart(change, programs.folder, 0, ["-fsyntax-only"])
        finally:
            self.spare.append(programs)
        return self.all.noticed_by(self.reach.of(number), number) if is_sound else "compiler"

    def _verdict_apart(self, change, programs):
        for i in range(len(change.alternatives)):
            objects = self._compiled_apart(change, programs.folder, i)
            verdict = programs.noticed_apart(objects) if objects else "compiler"
            if verdict != "compiler":
                return verdict
        return "compiler"

    def _compiled_apart(self, change, folder, alternative, flags=()):
        """Compiles all units that one alternative of a change reaches, with the changed file in
        `folder`; gives the objects, none when one does not compile."""
        text = (self.workshop.work / change.file).read_text(encoding="utf-8")
        file = folder / change.file
        file.parent.mkdir(parents=True, exist_ok=True)
        file.write_text(change.applied(text, change.alternatives[alternative]), encoding="utf-8")
        objects = {}
        for part, units in self._parts(change.file).items():
            objects[part] = str(folder / part.replace("/", "_")) + ".o"
            if not self._compile(units, folder, objects[part], flags):
                objects = None
                break
        file.unlink()
        return objects

    def _parts(self, file):
        """The units that a change of `file` reaches, those that are linked together as one: that is
        quicker."""
        parts = {}
        for unit in self.workshop.units_of(file):
            part = unit if unit == MODULE_UNIT else str(pathlib.PurePath(unit).parent / "all.cpp")
            parts.setdefault(part, []).append(unit)
        return parts

    def _compile(self, units, folder, made, flags):
        files = [folder / unit if (folder / unit).exists() else self.workshop.work / unit
                 for unit in units]
        command = ["clang++", *FLAGS, *flags, f"-I{folder}/Sources", f"-I{self.workshop.sources}",
                   "-xc++", "-c", "-", "-o", made]
        return subprocess.run(command, input="".join(f'#include "{file}"\n' for file in files),
                              text=True, stderr=subprocess.DEVNULL, check=False).returncode == 0
