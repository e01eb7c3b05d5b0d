"""Gives each row its verdict."""
import dataclasses

from figures import NoFigure
from measurements import in_order

MOST_CONTROL = 0.05  # the control may be off by this much


@dataclasses.dataclass
class Judgement:
    row: str
    text: str
    bound: float
    verdict: str  # "meets", "misses", "peer missing", "not measured", or "no verdict" with a reason
    figure: float = None


def baseline(ways):
    """The way that the control, `again`, runs a second time."""
    return 'direct' if 'direct' in ways else 'ours'


def control(measurements, row):
    """How far the control is off its baseline, or None where there is none."""
    ways = measurements.rows.get(row, {})
    base = baseline(ways)
    if 'again' not in ways or base not in ways or ways[base].median() == 0:
        return None
    return abs(ways['again'].median() / ways[base].median() - 1)


def objection(measurements, rows):
    """Why figures of these rows say nothing, or None."""
    for row in rows:
        off = control(measurements, row)
        if off is None:
            return 'no control'
        if off > MOST_CONTROL:
            return f'control off by {off:.0%}'
    return None


def judge_row(rule, measurements, row):
    judgement = Judgement(row, rule.text, rule.bound, '')
    try:
        figure = rule.figure.of(measurements, row)
    except NoFigure as reason:
        judgement.verdict = str(reason)
        return judgement
    judgement.figure = figure.value
    reason = objection(measurements, figure.timed)
    if reason is not None:
        judgement.verdict = f'no verdict: {reason}'
    else:
        judgement.verdict = 'meets' if figure.value <= rule.bound else 'misses'
    return judgement


def judge(rules, measurements, complete=False, quick=False):
    """With `complete`, a rule that no row answers to is told as "not measured". A quick run's verdicts bear the
    word."""
    judgements = []
    for rule in rules:
        rows = in_order(row for row in rule.figure.rows(measurements) if rule.applies(row))
        judgements += [judge_row(rule, measurements, row) for row in rows]
        if complete and not rows:
            judgements.append(Judgement(rule.rows, rule.text, rule.bound, 'not measured'))
    for judgement in judgements:
        if quick and judgement.verdict in ('meets', 'misses'):
            judgement.verdict += ' (quick)'
    return judgements
