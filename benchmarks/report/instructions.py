"""Counts the instructions of a block, for every way of every row of the process path, under callgrind.

    instructions.py [--build build/bench] [--filter EXPRESSION] [--profile FOLDER] OUT.json

Writes {"rows": [{"row": "P1/frames:64", "way": "ours", "instructions": 123.4}, ...]}: instructions per block, exact but
for the loop that repeats it. With --profile, callgrind's files stay in that folder for callgrind_annotate.
"""
import argparse
import concurrent.futures
import json
import os
import pathlib
import re
import subprocess
import sys
import tempfile

ROOT = pathlib.Path(__file__).resolve().parents[2]
BLOCKS = 960  # whole rounds of a delay line, and of the tick between changes


def arguments():
    parser = argparse.ArgumentParser()
    parser.add_argument('--build', type=pathlib.Path, default=ROOT / 'build/bench')
    parser.add_argument('--filter', default='.')
    parser.add_argument('--profile', type=pathlib.Path)
    parser.add_argument('out', type=pathlib.Path)
    return parser.parse_args()


def cases(program, environment):
    run = subprocess.run([program], env=environment, capture_output=True, text=True, check=True)
    return [tuple(line.split()) for line in run.stdout.splitlines()]


def count(program, environment, row, way, profile):
    """Only what runs inside ZebCountedBlocks is counted."""
    subprocess.run(['valgrind', '--tool=callgrind', '--collect-atstart=no', '--toggle-collect=ZebCountedBlocks',
                    f'--callgrind-out-file={profile}', program, row, way, str(BLOCKS)],
                   env=environment, capture_output=True, text=True, check=True)
    total = re.search(r'^(?:summary|totals): (\d+)', profile.read_text(), re.MULTILINE)
    if total is None or int(total[1]) == 0:
        raise SystemExit(f'{row} {way}: nothing was counted')
    return int(total[1]) / BLOCKS


def main():
    options = arguments()
    program = options.build / 'bin/zeb_bench_instructions'
    environment = {**os.environ, 'LD_BIND_NOW': '1'}
    wanted = re.compile(options.filter)
    chosen = [case for case in cases(program, environment) if wanted.search(case[0])]
    with tempfile.TemporaryDirectory() as temporary, \
            concurrent.futures.ThreadPoolExecutor(os.cpu_count()) as pool:
        folder = options.profile or pathlib.Path(temporary)
        folder.mkdir(parents=True, exist_ok=True)
        counts = pool.map(lambda case: count(program, environment, *case,
                                             folder / f'{"-".join(case).replace("/", "-")}.callgrind'), chosen)
        rows = [{'row': row, 'way': way, 'instructions': counted} for (row, way), counted in zip(chosen, counts)]
    options.out.write_text(json.dumps({'rows': rows}, indent=1) + '\n')


if __name__ == '__main__':
    try:
        main()
    except subprocess.CalledProcessError as error:
        sys.exit(f'{" ".join(map(str, error.cmd))}: {error.stderr.strip()}')
