"""The formulas of the table of rules. Each makes one number of a row's measurements, and names the rows that went
into it, whose controls it depends on."""
import dataclasses


class NoFigure(Exception):
    """The row has not what the formula needs; the text is its verdict."""


@dataclasses.dataclass
class Figure:
    value: float
    timed: list  # the rows whose times went into it; none for counts, which need no control


def median(measurements, row, way):
    sample = measurements.rows.get(row, {}).get(way)
    if sample is None:
        raise NoFigure('peer missing' if way == 'peer' else f'no verdict: {way} missing')
    return sample.median()


def added(measurements, row, way, base):
    return median(measurements, row, way) - median(measurements, row, base)


def refuse_noise(measurements, rows, base, smallest):
    """The control may be off by a part of the whole time, of which what is added may be a small part."""
    for row in rows:
        ways = measurements.rows.get(row, {})
        if 'again' in ways and abs(added(measurements, row, 'again', base)) > smallest / 2:
            raise NoFigure('no verdict: control off by more than half of what is added')


class Timed:
    """A formula on times: it applies to rows that were timed."""

    @staticmethod
    def rows(measurements):
        return measurements.rows


class Counted:
    """A formula on instruction counts."""

    @staticmethod
    def rows(measurements):
        return measurements.instructions


@dataclasses.dataclass
class Ratio(Timed):
    """A way's time over that of another; over several others, which must all be there, of the fastest of them."""
    way: str
    over: tuple

    def of(self, measurements, row):
        best = min(median(measurements, row, way) for way in self.over)
        return Figure(median(measurements, row, self.way) / best, [row])


@dataclasses.dataclass
class AddedRatio(Timed):
    """What one way adds to the direct call, over what another adds."""
    way: str
    over: str
    base: str = 'direct'

    def of(self, measurements, row):
        theirs = added(measurements, row, self.over, self.base)
        if theirs <= 0:
            raise NoFigure(f'no verdict: {self.over} adds nothing')
        refuse_noise(measurements, [row], self.base, theirs)
        return Figure(max(added(measurements, row, self.way, self.base), 0) / theirs, [row])


@dataclasses.dataclass
class AddedGrowth(Timed):
    """What a way adds in this row over what it adds in the row with another value of a variable."""
    way: str
    this: str
    that: str
    base: str = 'direct'

    def of(self, measurements, row):
        other = row.replace(self.this, self.that)
        small = added(measurements, other, self.way, self.base)
        if small <= 0:
            raise NoFigure('no verdict: nothing added')
        refuse_noise(measurements, [row, other], self.base, small)
        return Figure(max(added(measurements, row, self.way, self.base), 0) / small, [row, other])


@dataclasses.dataclass
class PerEntryGrowth(Timed):
    """The time per entry at one number of entries over that at another."""
    way: str
    variable: str
    large: int
    small: int

    def of(self, measurements, row):
        other = row.replace(f'{self.variable}:{self.large}', f'{self.variable}:{self.small}')
        here = median(measurements, row, self.way) / self.large
        return Figure(here / (median(measurements, other, self.way) / self.small), [row, other])


@dataclasses.dataclass
class Counter(Timed):
    """A number that the program counted, in its worst round."""
    name: str
    way: str

    def of(self, measurements, row):
        sample = measurements.rows[row].get(self.way)
        if sample is None or self.name not in sample.counters:
            raise NoFigure(f'no verdict: {self.name} missing')
        return Figure(sample.counter(self.name), [])


def instructions(measurements, row, way):
    counts = measurements.instructions[row]
    if way not in counts:
        raise NoFigure('peer missing' if way == 'peer' else f'no verdict: {way} missing')
    return counts[way]


@dataclasses.dataclass
class Instructions(Counted):
    """Instructions of a way, less those of the call that it wraps."""
    way: str
    base: str = 'direct'

    def of(self, measurements, row):
        return Figure(instructions(measurements, row, self.way) - instructions(measurements, row, self.base), [])


@dataclasses.dataclass
class InstructionRatio(Counted):
    way: str
    over: str

    def of(self, measurements, row):
        return Figure(instructions(measurements, row, self.way) / instructions(measurements, row, self.over), [])
