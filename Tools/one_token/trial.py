"""Runs the tests on the plug-in with a change, without touching the checkout."""

import os
import re
import resource
import shlex
import shutil
import signal
import subprocess

from one_token.variants import FLAGS, VariantBuild

LINKER = "lld" if shutil.which("ld.lld") else "gold"
# The tests that may notice a change of a folder, and those of the whole module, which follow.
UNIT_TESTS = {"Assistant": ["AssistantTests"], "Logging": ["LoggingTests", "AssistantTests"]}
MODULE_TESTS = ["ModuleTests", "ReplayTests"]
MODULE_UNIT = "Sources/Assistant/Module.cpp"
CPU_SECONDS = 20  # Of one process; the slowest needs less than five.
WALL_SECONDS = 300
MEMORY = 4 << 30


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
        run(["cmake", "--build", self.build, "--target", "AssistantTests", "LoggingTests",
             *MODULE_TESTS])
        shutil.rmtree(work / "Sources", ignore_errors=True)
        for folder in ("PlatformModel", *UNIT_TESTS):
            shutil.copytree(checkout / "Sources" / folder, self.sources / folder)
        self.links = {target: self._link_command(target)
                      for target in ("AssistantTests", "LoggingTests", "NidusAssistant")}
        for program in ["nidus", *MODULE_TESTS]:
            shutil.copy2(self.build / "bin" / program, work / program)

    def units(self):
        return sorted(str(path.relative_to(self.work)) for folder in UNIT_TESTS
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
        (folder / "lib/nidus").mkdir(parents=True)
        shutil.copy2(workshop.work / "nidus", folder / "bin/nidus")

    def link(self, objects):
        """Links `objects`, by unit; says whether that could be done."""
        logging = [made for unit, made in objects.items() if "/Logging/" in unit]
        linked = [made for unit, made in objects.items() if unit != MODULE_UNIT]
        return (self._link("AssistantTests", linked, "AssistantTests")
                and self._link("LoggingTests", logging, "LoggingTests")
                and self._link("NidusAssistant", objects.values(), "lib/nidus/NidusAssistant.so"))

    def noticed_by(self, file, number=0):
        """The first program whose tests fail with the change of that number, which is one of
        `file`; "nobody" when all pass."""
        unit_tests = [] if file == MODULE_UNIT else UNIT_TESTS[file.split("/")[1]]
        for name in unit_tests:
            if not self._passes(self.folder / name, number):
                return name
        for name in MODULE_TESTS:
            if not self._passes(self.workshop.work / name, number):
                return name
        return "nobody"

    def _link(self, target, objects, output):
        """Links with the changed units in front, so that their definitions are the ones taken."""
        first, *others = self.workshop.links[target]
        command = [first, f"-fuse-ld={LINKER}", "-Wl,--allow-multiple-definition", *objects,
                   *others, "-o", str(self.folder / output)]
        return subprocess.run(command, stderr=subprocess.DEVNULL, check=False).returncode == 0

    def _passes(self, program, number):
        environment = dict(os.environ, ONE_TOKEN_CHANGE=str(number),
                           NIDUS_PROGRAM=str(self.folder / "bin/nidus"),
                           NIDUS_MODULE_FILE=str(self.folder / "lib/nidus/NidusAssistant.so"))
        with subprocess.Popen([str(program), "--gtest_fail_fast", "--gtest_brief=1"],
                              stdin=subprocess.DEVNULL, stdout=subprocess.DEVNULL,
                              stderr=subprocess.DEVNULL, env=environment, cwd=self.folder,
                              start_new_session=True, preexec_fn=limit_resources) as process:
            try:
                return process.wait(WALL_SECONDS) == 0
            except subprocess.TimeoutExpired:
                os.killpg(process.pid, signal.SIGKILL)
                return False


class Trials:
    """Tries changes: most of them in programs that hold all, the others one by one."""

    def __init__(self, workshop, changes, jobs):
        """`changes` are by number, from 1."""
        self.workshop = workshop
        self.changes = changes
        folder = workshop.work / "all"
        shutil.rmtree(folder, ignore_errors=True)
        build = VariantBuild(workshop.sources, folder, changes)
        units = workshop.units()
        self.all = Programs(workshop, workshop.work / "programs")
        if not self.all.link(dict(zip(units, build.objects(units, jobs)))):
            raise TrialError("the changed units cannot be linked")
        noticer = self.all.noticed_by("Sources/Logging/WLOLog.cpp")
        if noticer != "nobody":
            raise TrialError(f"{noticer} fails without any change")
        self.built, self.left_out = build.built(), build.left_out()
        self.spare = [Programs(workshop, workshop.work / f"apart{i}") for i in range(jobs)]

    def verdict(self, number):
        """Which program notices the change, "nobody", or "compiler" when it cannot be built."""
        if number in self.built:
            return self.all.noticed_by(self.changes[number].file, number)
        if number in self.left_out:
            return "compiler"
        programs = self.spare.pop()
        try:
            return self._verdict_apart(self.changes[number], programs)
        finally:
            self.spare.append(programs)

    def _verdict_apart(self, change, programs):
        text = (self.workshop.work / change.file).read_text(encoding="utf-8")
        for alternative in change.alternatives:
            file = programs.folder / change.file
            file.parent.mkdir(parents=True, exist_ok=True)
            file.write_text(change.applied(text, alternative), encoding="utf-8")
            objects = self._compile(programs.folder, self.workshop.units_of(change.file))
            file.unlink()
            if objects and programs.link(objects):
                return programs.noticed_by(change.file)
        return "compiler"

    def _compile(self, folder, units):
        """Compiles units with the changed file in `folder`; none when one does not compile."""
        objects = {}
        for unit in units:
            source = folder / unit if (folder / unit).exists() else self.workshop.work / unit
            objects[unit] = str(folder / unit.replace("/", "_")) + ".o"
            done = subprocess.run(["clang++", *FLAGS, f"-I{folder}/Sources",
                                   f"-I{self.workshop.sources}", "-c", str(source), "-o",
                                   objects[unit]], stderr=subprocess.DEVNULL, check=False)
            if done.returncode:
                return None
        return objects


def limit_resources():
    resource.setrlimit(resource.RLIMIT_CPU, (CPU_SECONDS, CPU_SECONDS))
    resource.setrlimit(resource.RLIMIT_AS, (MEMORY, MEMORY))
    resource.setrlimit(resource.RLIMIT_CORE, (0, 0))
