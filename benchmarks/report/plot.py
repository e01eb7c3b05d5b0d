"""An SVG picture: for each judged row a bar of its figure over its bound, on a logarithmic axis. Left of the line at
1 the bound is met."""
import html
import math

from table import number

COLOURS = {'meets': '#2f855a', 'misses': '#c53030'}
UNDECIDED = '#a0aec0'
ROW, TOP, LEFT, WIDTH, RIGHT = 20, 64, 330, 460, 330


def decades(ratios):
    low = min([math.log10(ratio) for ratio in ratios] + [-1])
    high = max([math.log10(ratio) for ratio in ratios] + [0.3])
    return math.floor(max(low, -4)), math.ceil(high)


def text(x, y, content, **attributes):
    rest = ''.join(f' {key.replace("_", "-")}="{value}"' for key, value in attributes.items())
    return f'<text x="{x:.1f}" y="{y:.1f}"{rest}>{html.escape(content)}</text>'


def axis(place, low, high, bottom):
    for exponent in range(low, high + 1):
        x = place(10.0 ** exponent)
        bound = exponent == 0
        yield (f'<line x1="{x:.1f}" y1="{TOP - 6}" x2="{x:.1f}" y2="{bottom}" '
               f'stroke="{"#1a202c" if bound else "#e2e8f0"}" stroke-width="{1.5 if bound else 1}"/>')
        yield text(x, TOP - 12, 'bound' if bound else f'{10.0 ** exponent:g}', text_anchor='middle', fill='#4a5568')


def bar(judgement, y, place):
    yield text(LEFT - 10, y + 14, judgement.row, text_anchor='end')
    start, end = place(0), LEFT
    if judgement.figure is not None and judgement.bound > 0:
        end = place(judgement.figure / judgement.bound)
    elif judgement.figure:
        end = LEFT + WIDTH  # a bound of zero that is not met
    colour = COLOURS.get(judgement.verdict.split(' ')[0], UNDECIDED)
    yield f'<rect x="{start:.1f}" y="{y + 4}" width="{max(end - start, 2):.1f}" height="{ROW - 7}" fill="{colour}"/>'
    figure = '' if judgement.figure is None else f'{number(judgement.figure)} of {number(judgement.bound)}: '
    yield text(LEFT + WIDTH + 12, y + 14, f'{figure}{judgement.verdict}', fill='#2d3748')


def svg(judgements, title):
    judgements = [judgement for judgement in judgements if judgement.verdict != 'not measured']
    ratios = [j.figure / j.bound for j in judgements if j.figure and j.figure > 0 and j.bound > 0]
    low, high = decades(ratios)

    def place(ratio):
        exponent = math.log10(ratio) if ratio > 0 else low
        return LEFT + WIDTH * (min(max(exponent, low), high) - low) / (high - low)

    bottom = TOP + ROW * len(judgements) + 6
    lines = [f'<svg xmlns="http://www.w3.org/2000/svg" width="{LEFT + WIDTH + RIGHT}" height="{bottom + 14}" '
             'font-family="sans-serif" font-size="12">',
             '<rect width="100%" height="100%" fill="white"/>',
             text(20, 24, title, font_size=16, font_weight='bold'),
             *axis(place, low, high, bottom)]
    for index, judgement in enumerate(judgements):
        lines += bar(judgement, TOP + index * ROW, place)
    return '\n'.join(lines + ['</svg>', ''])
