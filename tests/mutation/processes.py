"""Runs programs with limits on what they use: processor time and memory, not time on the clock.

The machine may be busy with other things, so a program that takes long by the clock need not hang.
"""

import collections
import os
import pathlib
import resource
import select
import signal
import subprocess
import time

MEMORY_LIMIT = 4 << 30
CLOCK_FACTOR = 60  # a program that waits for ever uses no processor time; the machine may be busy
LOOK = 0.25  # seconds between looks at what a program uses
TICK = os.sysconf("SC_CLK_TCK")
PAGE = os.sysconf("SC_PAGE_SIZE")

ENVIRONMENT = {k: v for k, v in os.environ.items() if not k.startswith("GTEST_")}
ENVIRONMENT.update(ASAN_OPTIONS="allocator_may_return_null=1", UBSAN_OPTIONS="halt_on_error=1")

# ok: ended with 0. ran_out: of PROCESSOR time, or of patience by the CLOCK, or of nothing, "".
# seconds: of the processor, with children.
PROCESSOR, CLOCK = "processor", "clock"
Outcome = collections.namedtuple("Outcome", "ok ran_out seconds output")


def used_by_session(leader):
    """Processor seconds and resident bytes of the processes that a session holds now."""
    seconds = memory = 0
    for entry in os.scandir("/proc"):
        if not entry.name.isdigit():
            continue
        try:
            fields = pathlib.Path(entry.path, "stat").read_text().rpartition(")")[2].split()
        except OSError:
            continue  # it has ended
        if int(fields[3]) == leader:
            seconds += sum(map(int, fields[11:15])) / TICK  # with children that have ended
            memory += int(fields[21]) * PAGE
    return seconds, memory


def run(command, seconds, folder=None, log=None):
    """Runs a command in a session of its own, with at most so many seconds of the processor.

    One that takes all memory has failed; the address space says nothing, since some tests map
    sparse gigabytes. Its output goes to the file `log`, or nowhere.
    """
    def limit():
        resource.setrlimit(resource.RLIMIT_CPU, (int(seconds) + 2, int(seconds) + 3))
        resource.setrlimit(resource.RLIMIT_CORE, (0, 0))

    with open(log or os.devnull, "wb") as sink:
        process = subprocess.Popen(command, stdin=subprocess.DEVNULL, stdout=sink,
                                   stderr=subprocess.STDOUT, env=ENVIRONMENT, preexec_fn=limit,
                                   start_new_session=True, cwd=folder)
    end = time.monotonic() + CLOCK_FACTOR * (seconds + 1)
    ended = select.poll()
    descriptor = os.pidfd_open(process.pid)
    ended.register(descriptor, select.POLLIN)
    ran_out = ""
    too_large = False
    used = 0
    try:
        while not ended.poll(LOOK * 1000):
            used, memory = used_by_session(process.pid)
            if used > seconds:
                ran_out = PROCESSOR
            elif time.monotonic() > end:
                ran_out = CLOCK
            too_large = memory > MEMORY_LIMIT
            if ran_out or too_large:
                break
    finally:
        try:
            os.killpg(process.pid, signal.SIGKILL)  # also what it may have left behind
        except ProcessLookupError:
            pass
        os.close(descriptor)
        _, status, usage = os.wait4(process.pid, 0)
        process.returncode = os.waitstatus_to_exitcode(status)
    used = max(used, usage.ru_utime + usage.ru_stime)
    if used > seconds or process.returncode == -signal.SIGXCPU:
        ran_out = PROCESSOR
    ok = process.returncode == 0 and not ran_out and not too_large
    return Outcome(ok, ran_out, used, log)
