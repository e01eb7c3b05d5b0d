"""P8: what a block costs in the tail of an echo that dies away through the smallest numbers, against one with signal.

Both ways are `zebhost render` of the same length; what start and end of the program cost is taken off by a render of
a second. "tail" lets zebhost play the tail, "silence" has the same silence in the file.
"""
import pathlib
import random
import struct

from driver import Runs, folder, options, timed

RATE, BLOCK = 48000, 512
FRAME = 8  # two floats, in and out
SECONDS = 120  # an echo of 10 ms that keeps half is below the smallest normal number after 1.3 of them


def write_sound(path, noise, silence):
    """Stereo floats, which keep every step of a tail."""
    generator = random.Random(1)
    second = struct.pack(f'<{2 * RATE}f', *(generator.uniform(-0.5, 0.5) for _ in range(2 * RATE)))
    data = second * noise + bytes(len(second)) * silence
    head = struct.pack('<4sI4s4sIHHIIHH4sI', b'RIFF', 36 + len(data), b'WAVE', b'fmt ', 16, 3, 2, RATE, RATE * 8, 8,
                       32, b'data', len(data))
    path.write_bytes(head + data)


class Renders:
    def __init__(self, build, work):
        self.zebhost = build / 'bin/zebhost'
        self.bundle = build / 'vst3/ZebDelay.vst3'
        self.work = work
        for name, noise, silence in (('short', 1, 0), ('noise', SECONDS, 0), ('silent', 1, SECONDS - 1)):
            write_sound(work / f'{name}.wav', noise, silence)
        timed([self.zebhost, '--settings', work / 'settings', 'scan', self.bundle])

    def render(self, name, tail):
        times = timed([self.zebhost, '--settings', self.work / 'settings', '--quiet', 'render', 'Zeb Delay',
                       self.work / f'{name}.wav', self.work / 'out.wav', '--overwrite', '--settle', '0', '--set',
                       'Time=10', '--set', 'Feedback=50', '--tail', str(tail), '--block', str(BLOCK)])
        if name != 'short' or tail > 0:
            check_sound(self.work / 'out.wav')
        return times


def check_sound(path):
    """What is to be compared must have been rendered: the whole length, and the echo behind the first second."""
    content = path.read_bytes()
    data = content[content.index(b'data') + 8:]
    if len(data) < FRAME * (SECONDS * RATE - BLOCK):
        raise SystemExit(f'only {len(data) / FRAME / RATE:.1f} of {SECONDS} s were rendered')
    if not any(data[FRAME * RATE * 102 // 100:FRAME * RATE * 110 // 100]):
        raise SystemExit('there is no echo behind the first second')


def main():
    chosen = options(__doc__.splitlines()[0])
    runs = Runs(chosen)
    blocks = (SECONDS - 1) * RATE / BLOCK
    ways = {'direct': ('noise', 0), 'again': ('noise', 0)}
    rows = {row: {**ways, 'ours': ours} for row, ours in
            (('P8/tail', ('short', SECONDS - 1)), ('P8/tail/silence', ('silent', 0))) if runs.wants(row)}
    with folder() as work:
        renders = Renders(chosen.build.resolve(), pathlib.Path(work))
        for number in range(chosen.rounds + 1 if rows else 0):
            short = renders.render('short', 0)
            for row, kinds in rows.items():
                for way, kind in kinds.items():
                    wall, processor = renders.render(*kind)
                    if number > 0:  # the first round warms up
                        runs.add(row, way, (wall - short[0]) / blocks, (processor - short[1]) / blocks)
    runs.write()


if __name__ == '__main__':
    main()
