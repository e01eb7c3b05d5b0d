"""What the drivers share: they time whole commands, and write what Google Benchmark would."""
import argparse
import json
import os
import pathlib
import re
import resource
import subprocess
import tempfile
import time


def options(description):
    parser = argparse.ArgumentParser(description=description)
    parser.add_argument('--build', type=pathlib.Path, required=True)
    parser.add_argument('--rounds', type=int, default=21)
    parser.add_argument('--filter', default='')
    parser.add_argument('--out', type=pathlib.Path, required=True)
    return parser.parse_args()


def folder():
    """Gone at the end; in memory where there is such a file system, so that no disk is measured."""
    memory = '/dev/shm' if os.access('/dev/shm', os.W_OK) else None
    return tempfile.TemporaryDirectory(prefix='zeb-bench-', dir=memory)


def timed(command, environment=None):
    """Runs the command; wall-clock and processor time of it and its children, in nanoseconds."""
    before = resource.getrusage(resource.RUSAGE_CHILDREN)
    start = time.perf_counter_ns()
    run = subprocess.run(command, env=environment, capture_output=True, text=True)
    wall = time.perf_counter_ns() - start
    after = resource.getrusage(resource.RUSAGE_CHILDREN)
    if run.returncode != 0:
        raise SystemExit(f'{" ".join(map(str, command))} ended with {run.returncode}: {run.stderr.strip()}')
    return wall, ((after.ru_utime + after.ru_stime) - (before.ru_utime + before.ru_stime)) * 1e9


class Runs:
    def __init__(self, chosen):
        self.runs = []
        self.wanted = re.compile(chosen.filter)
        self.out = chosen.out

    def wants(self, row):
        return self.wanted.search(f'{row}/way:') is not None

    def add(self, row, way, wall, processor, clock='', **counters):
        """With the clock 'real_time' the wall's is judged, without it the processor's."""
        self.runs.append({'name': f'{row}/way:{way}{clock and "/" + clock}', 'run_type': 'iteration', 'real_time': wall,
                          'cpu_time': processor, 'time_unit': 'ns', **counters})

    def write(self):
        self.out.write_text(json.dumps({'benchmarks': self.runs}, indent=1) + '\n')
