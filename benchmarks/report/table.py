"""The tables on standard output."""
from judge import control
from measurements import in_order


def number(value):
    if value is None:
        return '-'
    if value == int(value) and abs(value) < 1e6:
        return str(int(value))
    return f'{value:.3g}'


def duration(nanoseconds):
    for unit, size in (('s', 1e9), ('ms', 1e6), ('us', 1e3)):
        if nanoseconds >= size:
            return f'{nanoseconds / size:.3g} {unit}'
    return f'{nanoseconds:.3g} ns'


def percent(part):
    return '-' if part is None else f'{part:.1%}'


def aligned(head, lines):
    widths = [max(len(line[i]) for line in [head, *lines]) for i in range(len(head))]
    for line in [head, ['-' * width for width in widths], *lines]:
        yield '  '.join(cell.ljust(width) for cell, width in zip(line, widths)).rstrip()


def times(measurements):
    ways = sorted({way for row in measurements.rows.values() for way in row if way != 'again'},
                  key=lambda way: (('direct', 'ours', 'peer') + (way,)).index(way))
    lines = []
    for row in in_order(measurements.rows):
        samples = measurements.rows[row]
        cells = [duration(samples[way].median()) if way in samples else '-' for way in ways]
        lines.append([row, *cells, percent(control(measurements, row)),
                      percent(max(sample.spread() for sample in samples.values()))])
    return aligned(['row', *ways, 'control', 'spread'], lines)


def verdicts(judgements):
    return aligned(['row', 'figure', 'bound', 'verdict', 'of'],
                   [[j.row, number(j.figure), number(j.bound), j.verdict, j.text] for j in judgements])
