"""Builds the plug-in with a change and runs the tests on it, without touching the checkout."""

import os
import pathlib
import re
import resource
import shlex
import shutil
import signal
import subprocess

# The flags of the project's own build with clang; what these refuse, nobody could land.
FLAGS = ("-std=c++20 -O0 -fPIC -fvisibility=hidden -fvisibility-inlines-hidden -ffp-contract=off "
         "-Wall -Wextra -Wpedantic -Wshadow -Wconversion -Wthread-safety -Werror").split()
LINKER = "lld" if shutil.which("ld.lld") else "gold"
UNIT_TESTS = {"Assistant": ["AssistantTests"], "Logging": ["LoggingTests", "AssistantTests"]}
MODULE_TESTS = ["ModuleTests", "ReplayTests"]
CPU_SECONDS = 20  # Of one process; the slowest needs less than three.
WALL_SECONDS = 120
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
    """All that the trials share: copies of the sources, precompiled headers, and what is linked
    with a changed unit. What stands in the build folder is copied, so that it may change."""

    def __init__(self, checkout, work, build="dev"):
        self.build = checkout / "build" / build
        self.work = work
        self.sources = work / "Sources"
        work.mkdir(parents=True, exist_ok=True)
        self._build_tests(checkout, build)
        self._copy_sources(checkout / "Sources")
        self.module_link = self._link_command("NidusAssistant")
        self.test_links = {name: self._link_command(name)
                           for name in ("AssistantTests", "LoggingTests")}
        for program in ["nidus", *MODULE_TESTS]:
            shutil.copy2(self.build / "bin" / program, work / program)

    def units_of(self, file):
        """The units that a change of `file` reaches."""
        if file.endswith(".cpp"):
            return [file]
        units = sorted(str(path.relative_to(self.work)) for folder in UNIT_TESTS
                       for path in (self.sources / folder).glob("*.cpp"))
        return [unit for unit in units if self._includes(unit, file.removeprefix("Sources/"))]

    def precompile(self, unit):
        """Compiles once what a unit includes."""
        header = self.work / (pathlib.Path(unit).stem + ".h")
        includes = re.findall(r"^#include .*\n", (self.work / unit).read_text(), re.MULTILINE)
        header.write_text("".join(includes))
        run(["clang++", *FLAGS, f"-I{self.sources}", "-Xclang", "-fpch-instantiate-templates",
             "-x", "c++-header", header, "-o", f"{header}.pch"])
        return f"{header}.pch"

    def _build_tests(self, checkout, build):
        if not (self.build / "build.ninja").exists():
            run(["cmake", "--preset", build], checkout)
        run(["cmake", "--build", self.build, "--target", "AssistantTests", "LoggingTests",
             *MODULE_TESTS])

    def _copy_sources(self, sources):
        shutil.rmtree(self.sources, ignore_errors=True)
        for folder in ("PlatformModel", *UNIT_TESTS):
            shutil.copytree(sources / folder, self.sources / folder)

    def _includes(self, file, header, seen=None):
        seen = set() if seen is None else seen
        if file in seen or not (self.work / file).exists():
            return False
        seen.add(file)
        included = re.findall(r'^#include "(.*)"', (self.work / file).read_text(), re.MULTILINE)
        return any(name == header or self._includes(f"Sources/{name}", header, seen)
                   for name in included)

    def _link_command(self, target):
        """What links a target, on copies without debug information; the last argument of the
        command that the build has is behind it."""
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


class Trial:
    """Tries changes, one at a time, in a folder of its own."""

    def __init__(self, workshop, precompiled, folder):
        self.workshop = workshop
        self.precompiled = precompiled
        self.folder = folder
        shutil.rmtree(folder, ignore_errors=True)
        (folder / "bin").mkdir(parents=True)
        (folder / "lib/nidus").mkdir(parents=True)
        shutil.copy2(workshop.work / "nidus", folder / "bin/nidus")

    def verdict(self, change):
        """Which program notices the change, "nobody", or "compiler" when it cannot be built."""
        text = (self.workshop.work / change.file).read_text(encoding="utf-8")
        for alternative in change.alternatives:
            objects = self._compile(change.file, change.applied(text, alternative))
            if objects:
                return self._noticed_by(change.file, objects)
        return "compiler"

    def verdict_of_nothing(self):
        """The same without a change: "nobody", when all tests pass."""
        return self._noticed_by("Sources/Logging/WLOLog.cpp", [])

    def _compile(self, file, text):
        if file.endswith(".cpp"):
            unit = self.folder / "unit.cpp"
            unit.write_text(text, encoding="utf-8")
            return self._compile_unit(unit, ["-include-pch", self.precompiled[file]], "unit.o")
        header = self.folder / file
        header.parent.mkdir(parents=True, exist_ok=True)
        header.write_text(text, encoding="utf-8")
        objects = []
        for i, unit in enumerate(self.workshop.units_of(file)):
            made = self._compile_unit(self.workshop.work / unit, [f"-I{self.folder}/Sources"],
                                      f"unit{i}.o")
            if not made:
                break
            objects += made
        else:
            header.unlink()
            return objects
        header.unlink()
        return None

    def _compile_unit(self, unit, options, name):
        target = str(self.folder / name)
        done = subprocess.run(["clang++", *FLAGS, *options, f"-I{self.workshop.sources}", "-c",
                               str(unit), "-o", target], stderr=subprocess.DEVNULL, check=False)
        return [target] if done.returncode == 0 else None

    def _noticed_by(self, file, objects):
        if not file.endswith("/Module.cpp"):
            for name in UNIT_TESTS[file.split("/")[1]]:
                program = self.folder / name
                if not (self._link(self.workshop.test_links[name], objects, program)
                        and self._passes(program)):
                    return name
        if not self._link(self.workshop.module_link, objects,
                          self.folder / "lib/nidus/NidusAssistant.so"):
            return "linker"
        for name in MODULE_TESTS:
            if not self._passes(self.workshop.work / name):
                return name
        return "nobody"

    def _link(self, command, objects, target):
        """Links with the changed units in front, so that their definitions are the ones taken."""
        command = [command[0], f"-fuse-ld={LINKER}", "-Wl,--allow-multiple-definition", *objects, *command[1:], "-o",
                   str(target)]
        return subprocess.run(command, stderr=subprocess.DEVNULL, check=False).returncode == 0

    def _passes(self, program):
        environment = dict(os.environ, NIDUS_PROGRAM=str(self.folder / "bin/nidus"),
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


def limit_resources():
    resource.setrlimit(resource.RLIMIT_CPU, (CPU_SECONDS, CPU_SECONDS))
    resource.setrlimit(resource.RLIMIT_AS, (MEMORY, MEMORY))
    resource.setrlimit(resource.RLIMIT_CORE, (0, 0))
