"""What a run has measured: rows, the ways of each row, and for each way its times and counters of all rounds.

The name of a measurement is "P1/frames:64/way:direct". Everything before "/way:" is the row; what Google Benchmark
appends after the way ("/real_time", "/iterations:5") says how it was measured.
"""
import json
import re
import statistics

NAME = re.compile(r'(?P<row>.+)/way:(?P<way>[\w-]+)(?P<how>/.*)?$')
NANOSECONDS = {'ns': 1, 'us': 1e3, 'ms': 1e6, 's': 1e9}
# Members of a run in Google Benchmark's JSON that are none of the program's own counters.
STANDARD = {'family_index', 'per_family_instance_index', 'repetitions', 'repetition_index', 'threads', 'iterations',
            'real_time', 'cpu_time'}


def in_order(rows):
    """Rows by name, numbers by size: Google Benchmark has interleaved them at random."""
    return sorted(rows, key=lambda row: [(part.isdigit(), int(part) if part.isdigit() else part)
                                         for part in re.split(r'(\d+)', row)])


class Sample:
    """The times of one way of one row, in nanoseconds, and the counters that its program reported."""

    def __init__(self):
        self.times = []
        self.counters = {}

    def median(self):
        return statistics.median(self.times)

    def spread(self):
        """The middle half of the rounds, as a part of the median."""
        if len(self.times) < 2 or self.median() == 0:
            return 0.0
        low, _, high = statistics.quantiles(self.times, n=4, method='inclusive')
        return (high - low) / self.median()

    def counter(self, name):
        """The worst round."""
        return max(self.counters[name])


class Measurements:
    def __init__(self):
        self.rows = {}  # row -> way -> Sample
        self.instructions = {}  # row -> way -> instructions per unit of work
        self.problems = []  # what could not be run, as sentences

    def sample(self, row, way):
        return self.rows.setdefault(row, {}).setdefault(way, Sample())

    def add_runs(self, text):
        """The JSON of Google Benchmark, or of a driver that writes the same form."""
        for run in json.loads(text)['benchmarks']:
            if run.get('run_type', 'iteration') == 'iteration':
                self.add_run(run)

    def add_run(self, run):
        name = NAME.match(run['name'])
        if name is None:
            self.problems.append(f'{run["name"]}: the name says no way')
        elif run.get('error_occurred'):
            self.problems.append(f'{run["name"]}: {run.get("error_message", "failed")}')
        else:
            real = re.search(r'real_time|manual_time', name['how'] or '')
            sample = self.sample(name['row'], name['way'])
            sample.times.append(run['real_time' if real else 'cpu_time'] * NANOSECONDS[run['time_unit']])
            for counter in run.keys() - STANDARD:
                if isinstance(run[counter], (int, float)) and not isinstance(run[counter], bool):
                    sample.counters.setdefault(counter, []).append(run[counter])

    def expect_rounds(self, rounds):
        for row, ways in self.rows.items():
            for way, sample in ways.items():
                if len(sample.times) != rounds:
                    self.problems.append(f'{row}/way:{way}: {len(sample.times)} rounds instead of {rounds}')

    def add_instructions(self, text):
        for entry in json.loads(text)['rows']:
            self.instructions.setdefault(entry['row'], {})[entry['way']] = entry['instructions']

    def as_json(self):
        return {
            'rows': {row: {way: {'median_ns': sample.median(), 'spread': sample.spread(), 'times_ns': sample.times,
                                 'counters': sample.counters} for way, sample in ways.items()}
                     for row, ways in self.rows.items()},
            'instructions': self.instructions,
            'problems': self.problems,
        }
