"""Runs a command, its output thrown away, and prints exit status, seconds (wall, user, system) and peak memory in bytes.

A separate program, because a process starts with the peak memory of its parent, and this one is small.
"""

import os
import sys
import time

output = [(os.POSIX_SPAWN_OPEN, 1, os.devnull, os.O_WRONLY, 0), (os.POSIX_SPAWN_DUP2, 1, 2)]
start = time.perf_counter()
process = os.posix_spawnp(sys.argv[1], sys.argv[1:], os.environ, file_actions=output)
_, status, usage = os.wait4(process, 0)
wall = time.perf_counter() - start
print(os.waitstatus_to_exitcode(status), wall, usage.ru_utime, usage.ru_stime, usage.ru_maxrss * 1024)
