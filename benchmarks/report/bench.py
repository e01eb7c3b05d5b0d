"""Runs the benchmarks that stand built and judges their rows; script/bench calls it."""
import argparse
import json
import pathlib
import platform
import re
import shutil
import subprocess
import sys

import plot
import table
from judge import judge
from measurements import Measurements
from programs import QUICK_ROUNDS, ROUNDS, Runner
from rules import RULES

ROOT = pathlib.Path(__file__).resolve().parents[2]


def parse():
    parser = argparse.ArgumentParser(prog='script/bench', description='Builds, runs and judges the benchmarks.')
    parser.add_argument('filter', nargs='?', default='', help='a regular expression: only rows that hold it')
    parser.add_argument('--only', default='', metavar='P4,P7', help='these groups of rows only')
    parser.add_argument('--quick', action='store_true', help='3 short rounds instead of 21; the verdicts say so')
    parser.add_argument('--strict', action='store_true', help='end with 1 unless every row meets its bound')
    parser.add_argument('--no-build', action='store_true', help='measure what stands built')
    parser.add_argument('--build', type=pathlib.Path, default=ROOT / 'build/bench', help=argparse.SUPPRESS)
    return parser.parse_args()


def expression(options):
    groups = '|'.join(re.escape(group) for group in options.only.split(',') if group)
    start = f'^({groups})/' if groups else ''
    return f'{start}.*({options.filter})' if start and options.filter else start or options.filter


def count_instructions(options, folder, measurements):
    """The second opinion: exact where a clock is not."""
    script = ROOT / 'benchmarks/report/instructions.py'
    if options.only and not {'P1', 'P2', 'P3', 'P9'} & set(options.only.split(',')):
        return
    if shutil.which('valgrind') is None:
        measurements.problems.append('instructions: valgrind is not installed')
        return
    out = folder / 'instructions.json'
    run = subprocess.run([sys.executable, script, '--build', options.build.resolve(), out.resolve()], cwd=ROOT,
                         stdout=subprocess.DEVNULL, stderr=subprocess.PIPE, text=True)
    if run.returncode != 0:
        measurements.problems.append(f'instructions: {run.stderr.strip() or "failed"}')
        return
    measurements.add_instructions(out.read_text())
    wanted = re.compile(expression(options))
    measurements.instructions = {row: ways for row, ways in measurements.instructions.items() if wanted.search(row)}


def write(options, folder, measurements, judgements):
    document = {'quick': options.quick, 'machine': platform.machine(), 'processor': processor(),
                **measurements.as_json(), 'judgements': [vars(judgement) for judgement in judgements]}
    (folder / 'bench.json').write_text(json.dumps(document, indent=1) + '\n')
    title = 'Figure over bound' + (' (quick run)' if options.quick else '')
    (folder / 'bench.svg').write_text(plot.svg(judgements, title))


def processor():
    try:
        lines = pathlib.Path('/proc/cpuinfo').read_text().splitlines()
    except OSError:
        return platform.processor()
    return next((line.split(': ', 1)[1] for line in lines if line.startswith('model name')), platform.processor())


def report(options, folder, measurements, judgements):
    print('\n'.join(table.times(measurements)), end='\n\n')
    print('\n'.join(table.verdicts(judgements)))
    if options.quick:
        print('\nA quick run: its figures are hints.')
    for problem in measurements.problems:
        print(f'bench: {problem}', file=sys.stderr)
    print(f'\n{folder / "bench.json"}\n{folder / "bench.svg"}')


def main():
    options = parse()
    folder = options.build / 'results'
    folder.mkdir(parents=True, exist_ok=True)
    measurements = Measurements()
    Runner(options.build, folder, expression(options), options.quick).run(measurements)
    measurements.expect_rounds(QUICK_ROUNDS if options.quick else ROUNDS)
    count_instructions(options, folder, measurements)
    complete = not (options.only or options.filter)
    judgements = judge(RULES, measurements, complete, options.quick)
    write(options, folder, measurements, judgements)
    report(options, folder, measurements, judgements)
    unmeasured = any(judgement.verdict == 'not measured' for judgement in judgements)
    missed = options.strict and not all(judgement.verdict.startswith('meets') for judgement in judgements)
    return 1 if measurements.problems or unmeasured or missed or not measurements.rows else 0


if __name__ == '__main__':
    sys.exit(main())
