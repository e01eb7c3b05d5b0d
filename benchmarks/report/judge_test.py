"""Tests of the judge: a figure is never better than its measurements."""
import json
import unittest
import xml.etree.ElementTree

import plot
import table
from figures import (AddedGrowth, AddedRatio, Counter, InstructionRatio, Instructions, PerEntryGrowth, Ratio)
from judge import judge
from measurements import Measurements
from rules import RULES, Rule


NOISE = 'no verdict: control off by more than half of what is added'


def measured(times, instructions=()):
    """Measurements of {"row/way:x": time or (time, counters)}."""
    measurements = Measurements()
    for name, value in times.items():
        time, counters = value if isinstance(value, tuple) else (value, {})
        measurements.add_run({'name': name, 'cpu_time': time, 'real_time': 1e9, 'time_unit': 'ns', **counters})
    measurements.add_instructions(json.dumps(
        {'rows': [dict(zip(('row', 'way', 'instructions'), entry)) for entry in instructions]}))
    return measurements


def verdict(figure, bound, measurements, row='r', **options):
    (judgement,) = judge([Rule(row, figure, bound, 'text')], measurements, **options)
    return judgement.figure, judgement.verdict


class JudgeTest(unittest.TestCase):
    def test_times(self):
        steady = {'r/way:direct': 100, 'r/way:again': 104}
        small = {'n:4/way:direct': 100, 'n:4/way:again': 100, 'n:4/way:ours': 110}
        large = {'n:40/way:direct': 200, 'n:40/way:again': 200}
        added = AddedRatio('ours', over='peer')
        cases = [
            ('half of the peer', added, 0.5, {**steady, 'r/way:ours': 110, 'r/way:peer': 120}, 'r', 0.5, 'meets'),
            ('more', added, 0.5, {**steady, 'r/way:ours': 111, 'r/way:peer': 120}, 'r', 0.55, 'misses'),
            ('nothing added', added, 0.5, {**steady, 'r/way:ours': 99, 'r/way:peer': 120}, 'r', 0, 'meets'),
            ('nothing to compare', added, 0.5, {**steady, 'r/way:ours': 99, 'r/way:peer': 99}, 'r', None,
             'no verdict: peer adds nothing'),
            ('out of noise', added, 0.5,
             {'r/way:direct': 200, 'r/way:again': 209, 'r/way:ours': 199, 'r/way:peer': 203}, 'r', None, NOISE),
            ('noise of half', added, 0.5, {**steady, 'r/way:ours': 104, 'r/way:peer': 108}, 'r', 0.5, 'meets'),
            ('noise of more', added, 0.5, {**steady, 'r/way:ours': 103, 'r/way:peer': 107}, 'r', None, NOISE),
            ('noise downwards', added, 0.5, {**steady, 'r/way:again': 96, 'r/way:ours': 103, 'r/way:peer': 107}, 'r',
             None, NOISE),
            ('no control', added, 0.5, {'r/way:direct': 100, 'r/way:ours': 103, 'r/way:peer': 107}, 'r', 3 / 7,
             'no verdict: no control'),
            ('no peer', added, 0.5, {**steady, 'r/way:ours': 110}, 'r', None, 'peer missing'),
            ('fastest of the others', Ratio('ours', over=('a', 'b')), 1.1,
             {**steady, 'r/way:ours': 120, 'r/way:a': 200, 'r/way:b': 100}, 'r', 1.2, 'misses'),
            ('one of the others missing', Ratio('ours', over=('a', 'b')), 1.1,
             {**steady, 'r/way:ours': 120, 'r/way:a': 200}, 'r', None, 'no verdict: b missing'),
            ('growth', AddedGrowth('ours', 'n:40', 'n:4'), 1.1, {**small, **large, 'n:40/way:ours': 211}, 'n:40', 1.1,
             'meets'),
            ('too much growth', AddedGrowth('ours', 'n:40', 'n:4'), 1.1, {**small, **large, 'n:40/way:ours': 212},
             'n:40', 1.2, 'misses'),
            ('growth out of noise', AddedGrowth('ours', 'n:40', 'n:4'), 1.1,
             {**small, **large, 'n:40/way:again': 206, 'n:40/way:ours': 200}, 'n:40', None, NOISE),
            ('growth over noise', AddedGrowth('ours', 'n:40', 'n:4'), 1.1,
             {**small, **large, 'n:4/way:again': 94, 'n:40/way:ours': 200}, 'n:40', None, NOISE),
            ('shrinking', AddedGrowth('ours', 'n:40', 'n:4'), 1.1, {**small, **large, 'n:40/way:ours': 190}, 'n:40', 0,
             'meets'),
            ('growth of nothing', AddedGrowth('ours', 'n:40', 'n:4'), 1.1, {**large, 'n:40/way:ours': 211}, 'n:40',
             None, 'no verdict: ours missing'),
            ('per entry', PerEntryGrowth('ours', 'n', 40, 4), 1.3,
             {'n:40/way:ours': 1200, 'n:40/way:again': 1200, 'n:4/way:ours': 100, 'n:4/way:again': 100}, 'n:40', 1.2,
             'meets'),
        ]
        for what, figure, bound, times, row, value, expected in cases:
            with self.subTest(what):
                found, word = verdict(figure, bound, measured(times), row)
                self.assertEqual(word, expected)
                self.assertAlmostEqual(found, value) if value is not None else self.assertIsNone(found)

    def test_control(self):
        ratio = Ratio('ours', over=('peer',))
        ways = {'r/way:ours': 50, 'r/way:peer': 100}
        cases = [
            ('a control of ours', {'r/way:again': 52}, 'meets'),
            ('off upwards', {'r/way:again': 53}, 'no verdict: control off by 6%'),
            ('off downwards', {'r/way:again': 47}, 'no verdict: control off by 6%'),
            ('none', {}, 'no verdict: no control'),
            ('of the direct call', {'r/way:again': 20, 'r/way:direct': 20}, 'meets'),
            ('of the direct call, off', {'r/way:again': 50, 'r/way:direct': 20}, 'no verdict: control off by 150%'),
        ]
        for what, control, expected in cases:
            with self.subTest(what):
                self.assertEqual(verdict(ratio, 0.5, measured({**ways, **control}))[1], expected)
        # The control of each row that a figure is made of counts.
        growth = PerEntryGrowth('ours', 'n', 40, 4)
        rows = {'n:40/way:ours': 1000, 'n:40/way:again': 1000, 'n:4/way:ours': 100, 'n:4/way:again': 120}
        self.assertEqual(verdict(growth, 1.3, measured(rows), 'n:40')[1], 'no verdict: control off by 20%')

    def test_counts_need_no_control(self):
        counts = measured({'r/way:ours': (5, {'peak': 2.5})},
                          [('i', 'direct', 1000), ('i', 'ours', 1400), ('i', 'nomap', 1380)])
        cases = [
            (Counter('peak', 'ours'), 3, 'r', 'meets'),
            (Counter('peak', 'ours'), 2, 'r', 'misses'),
            (Counter('other', 'ours'), 3, 'r', 'no verdict: other missing'),
            (Instructions('ours'), 400, 'i', 'meets'),
            (Instructions('ours'), 399, 'i', 'misses'),
            (InstructionRatio('ours', over='nomap'), 1.01, 'i', 'misses'),
            (InstructionRatio('ours', over='peer'), 1.01, 'i', 'peer missing'),
        ]
        for figure, bound, row, expected in cases:
            with self.subTest(figure=figure, bound=bound):
                self.assertEqual(verdict(figure, bound, counts, row)[1], expected)

    def test_counters_take_the_worst_round(self):
        measurements = measured({'r/way:ours': (5, {'opened': 0})})
        for opened in (1, 0):
            measurements.add_run({'name': 'r/way:ours', 'cpu_time': 5, 'time_unit': 'ns', 'opened': opened})
        self.assertEqual(verdict(Counter('opened', 'ours'), 0, measurements), (1, 'misses'))

    def test_what_a_run_lacks_is_told(self):
        rules = [Rule('P1/.*', Ratio('ours', over=('peer',)), 1, '')]
        self.assertEqual(judge(rules, measured({})), [])
        self.assertEqual([j.verdict for j in judge(rules, measured({}), complete=True)], ['not measured'])
        ways = {'r/way:ours': 1, 'r/way:again': 1, 'r/way:peer': 1}
        self.assertEqual(verdict(Ratio('ours', over=('peer',)), 1, measured(ways), quick=True)[1], 'meets (quick)')

    def test_ways_through_latency_and_look_ups_have_their_rules(self):
        cases = ['P9/bypass/channels:6/latency:0', 'P9/bypass/channels:6/latency:1000', 'P4/find-id/plugins:10000',
                 'P4/find-locator-anywhere/plugins:10000', 'P4/add-known/plugins:10000']
        texts = [[rule.text for rule in RULES if rule.applies(row)] for row in cases]
        self.assertEqual([len(found) for found in texts], [1] * len(cases))
        self.assertEqual(len({found[0] for found in texts}), len(cases))

    def test_every_group_has_a_rule(self):
        self.assertEqual({rule.rows.split('/')[0] for rule in RULES}, {f'P{i}' for i in range(1, 10)})


class MeasurementsTest(unittest.TestCase):
    def test_runs(self):
        measurements = Measurements()
        runs = [
            {'name': 'P4/load/plugins:8/way:ours/real_time', 'real_time': 2, 'cpu_time': 9, 'time_unit': 'ms'},
            {'name': 'P4/load/plugins:8/way:ours/real_time', 'real_time': 4, 'cpu_time': 9, 'time_unit': 'ms'},
            {'name': 'P4/load/plugins:8/way:ours/real_time', 'real_time': 900, 'cpu_time': 9, 'time_unit': 'ms'},
            {'name': 'P4/load/plugins:8/way:ours/real_time_mean', 'run_type': 'aggregate', 'real_time': 7},
            {'name': 'P4/load/plugins:8/way:peer', 'error_occurred': True, 'error_message': 'lost'},
            {'name': 'P4/load', 'real_time': 2, 'cpu_time': 9, 'time_unit': 'ms'},
        ]
        measurements.add_runs(json.dumps({'benchmarks': runs}))
        self.assertEqual(list(measurements.rows), ['P4/load/plugins:8'])
        self.assertEqual(list(measurements.rows['P4/load/plugins:8']), ['ours'])
        self.assertEqual(measurements.rows['P4/load/plugins:8']['ours'].median(), 4e6)
        self.assertEqual(len(measurements.problems), 2)
        self.assertIn('lost', measurements.problems[0])

    def test_rounds_that_are_missing_are_told(self):
        measurements = measured({'r/way:ours': 1, 'r/way:peer': 1})
        measurements.add_run({'name': 'r/way:ours', 'cpu_time': 1, 'time_unit': 'ns'})
        measurements.expect_rounds(2)
        self.assertEqual(measurements.problems, ['r/way:peer: 1 rounds instead of 2'])


class ReportTest(unittest.TestCase):
    def test_pictures_and_tables_show_every_row(self):
        ways = {f'{row}/way:{way}': time for row in ('a<b', 'c') for way, time in
                (('ours', 0.001), ('again', 0.001), ('peer', 100))}
        measurements = measured({**ways, 'd/way:ours': (1, {'opened': 2})})
        judgements = judge([Rule('a<b|c|d', Ratio('ours', over=('peer',)), 1, ''),
                            Rule('d', Counter('opened', 'ours'), 0, '')], measurements)
        picture = xml.etree.ElementTree.fromstring(plot.svg(judgements, 'title'))
        words = [element.text for element in picture.iter('{http://www.w3.org/2000/svg}text')]
        lines = list(table.verdicts(judgements))
        for row in ('a<b', 'c', 'd'):
            self.assertIn(row, words)
            self.assertTrue(any(line.startswith(row) for line in lines))
        self.assertTrue(any('misses' in line for line in lines))
        self.assertEqual(len(list(table.times(measurements))), 5)


if __name__ == '__main__':
    unittest.main()
