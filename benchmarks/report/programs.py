"""Runs the programs of the list that the build wrote, and the drivers, which time whole commands."""
import os
import pathlib
import re
import subprocess
import sys

ROUNDS, QUICK_ROUNDS = 21, 3
DRIVERS = {'P5': 'scan_rows.py', 'P8': 'tail_rows.py'}  # in benchmarks/catalogue


class Runner:
    def __init__(self, build, folder, expression, quick):
        self.build = build
        self.folder = folder
        self.expression = expression
        self.rounds = QUICK_ROUNDS if quick else ROUNDS
        self.seconds = '0.01' if quick else '0.05'
        # Every symbol is bound before the first round, not within one.
        self.environment = {**os.environ, 'LD_BIND_NOW': '1'}

    def run(self, measurements):
        for name in (self.build / 'benchmarks.txt').read_text().split():
            program = self.build / 'bin' / name
            if not program.exists():
                measurements.problems.append(f'{name} is not built')
            elif self.matches(program):
                self.measure(name, [program, *self.flags(name)], measurements)
        drivers = pathlib.Path(__file__).resolve().parent.parent / 'catalogue'
        for group, script in DRIVERS.items():
            if (drivers / script).exists() and self.wants(group):
                self.measure(script, [sys.executable, drivers / script, '--build', self.build, '--rounds',
                                      str(self.rounds), '--filter', self.expression, '--out', self.out(script)],
                             measurements)

    def out(self, name):
        return self.folder / f'{pathlib.Path(name).stem}.json'

    def flags(self, name):
        return ['--benchmark_enable_random_interleaving=true', f'--benchmark_repetitions={self.rounds}',
                f'--benchmark_min_time={self.seconds}', f'--benchmark_min_warmup_time={self.seconds}',
                f'--benchmark_filter={self.expression or "."}', f'--benchmark_out={self.out(name)}',
                '--benchmark_out_format=json']

    def matches(self, program):
        run = subprocess.run([program, '--benchmark_list_tests=true', f'--benchmark_filter={self.expression or "."}'],
                             env=self.environment, capture_output=True, text=True)
        return run.returncode != 0 or '/way:' in run.stdout

    def wants(self, group):
        """Whether rows of this group may pass; the driver looks more closely."""
        groups = re.match(r'\^\(([^)]*)\)/', self.expression)
        return group in groups[1].split('|') if groups else True

    def measure(self, name, command, measurements):
        print(f'bench: {name}', file=sys.stderr, flush=True)
        self.out(name).unlink(missing_ok=True)
        run = subprocess.run(command, env=self.environment, stdout=subprocess.DEVNULL, stderr=subprocess.PIPE,
                             text=True)
        if run.returncode != 0:
            last = (run.stderr.strip().splitlines() or ['no word'])[-1]
            measurements.problems.append(f'{name} ended with {run.returncode}: {last}')
        elif self.out(name).exists():
            measurements.add_runs(self.out(name).read_text())
