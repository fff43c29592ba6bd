"""Runs a test program that may crash, loop or wait for ever. A loop is told by the processor time
that it takes and a wait by taking none at all, so that nothing depends on how busy the machine is.
"""

import os
import pathlib
import resource
import signal
import subprocess
import time

CPU_SECONDS = 4  # Of one process; the slowest needs a quarter of one.
IDLE_SECONDS = 15  # Of all its processes; the longest pause of a test is shorter than three.
MEMORY = 2 << 30


def passes(program, arguments, environment, folder):
    """Says whether all tests of a program pass that are chosen by `arguments`."""
    with subprocess.Popen([str(program), "--gtest_fail_fast", "--gtest_brief=1", *arguments],
                          stdin=subprocess.DEVNULL, stdout=subprocess.DEVNULL,
                          stderr=subprocess.DEVNULL, env=dict(os.environ, **environment),
                          cwd=folder, start_new_session=True,
                          preexec_fn=limit_resources) as process:
        try:
            return process.wait(IDLE_SECONDS) == 0
        except subprocess.TimeoutExpired:
            return end_of(process) == 0


def end_of(process):
    """The exit status of a process, which is killed when it waits for nothing that comes."""
    idle_since, former = time.monotonic(), None
    while process.poll() is None:
        time.sleep(0.5)
        ticks, is_busy = activity(process.pid)
        if is_busy or ticks != former:
            idle_since, former = time.monotonic(), ticks
        if time.monotonic() - idle_since > IDLE_SECONDS:
            os.killpg(process.pid, signal.SIGKILL)
            process.wait()
    return process.returncode


def activity(session):
    """How much of the processor the threads of a session have had, and whether one wants more."""
    ticks, is_busy = 0, False
    for file in pathlib.Path("/proc").glob("[0-9]*/task/[0-9]*/stat"):
        try:
            # State, parent, group and session follow the name, which is in parentheses.
            fields = file.read_text().rpartition(")")[2].split()
        except OSError:
            continue
        if int(fields[3]) == session:
            ticks += int(fields[11]) + int(fields[12])
            is_busy = is_busy or fields[0] in "RD"
    return ticks, is_busy


def limit_resources():
    resource.setrlimit(resource.RLIMIT_CPU, (CPU_SECONDS, CPU_SECONDS))
    resource.setrlimit(resource.RLIMIT_AS, (MEMORY, MEMORY))
    resource.setrlimit(resource.RLIMIT_CORE, (0, 0))
