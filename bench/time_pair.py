#!/usr/bin/env python3
"""Times a command next to its floor, alternating the two run by run.

    time_pair.py RUNS -- COMMAND... -- FLOOR...

Prints four tab-separated numbers in milliseconds: the fastest wall time and the median CPU
time (user + system of the process and the children it waited for) of COMMAND, then the
same for FLOOR. Standard output and error of both go to /dev/null. Alternating the runs
makes both see the same machine: on a shared virtual machine the speed of the host drifts
by tens of percent from one minute to the next, which timing all runs of one and then all
runs of the other turns into a false ratio. The median leaves out the runs that a burst of
other work disturbed. Exits 1 when a run of either ends with a status other than 0.
"""
import os
import statistics
import sys
import time

WARMUP = 2


def run_once(argv):
    start = time.perf_counter()
    # posix_spawn starts the child without copying this interpreter's memory, which a fork
    # would charge to the child's CPU time.
    pid = os.posix_spawnp(argv[0], argv, os.environ,
                          file_actions=[(os.POSIX_SPAWN_OPEN, fd, os.devnull, os.O_WRONLY, 0)
                                        for fd in (1, 2)])
    _, status, usage = os.wait4(pid, 0)
    wall = time.perf_counter() - start
    if not os.WIFEXITED(status) or os.WEXITSTATUS(status) != 0:
        sys.exit("time_pair.py: '%s' failed (status %d)" % (" ".join(argv), status))
    return wall * 1000, (usage.ru_utime + usage.ru_stime) * 1000


def main():
    args = sys.argv[1:]
    if len(args) < 5 or args[1] != "--" or "--" not in args[2:]:
        sys.exit(__doc__)
    runs = int(args[0])
    split = args.index("--", 2)
    command, floor = args[2:split], args[split + 1:]
    if runs < 1 or not command or not floor:
        sys.exit(__doc__)
    samples = {0: [], 1: []}
    for i in range(WARMUP + runs):
        for which, argv in ((0, command), (1, floor)):
            sample = run_once(argv)
            if i >= WARMUP:
                samples[which].append(sample)
    out = []
    for which in (0, 1):
        out.append(min(s[0] for s in samples[which]))
        out.append(statistics.median(s[1] for s in samples[which]))
    print("\t".join("%.3f" % v for v in out))


if __name__ == "__main__":
    main()
