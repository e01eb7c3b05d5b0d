"""P5: a scan of 20 bundles, in the program itself and in a worker, and a second one when nothing has changed.

The whole commands are timed: start, search, 20 binaries, list saved. The bundles are copies of one effect with class
IDs of their own, which writes a line to a log whenever its binary is opened.
"""
import json
import os
import pathlib
import shutil
import subprocess
from xml.etree import ElementTree

from driver import Runs, folder, options, timed

BUNDLES = 20


class Scans:
    def __init__(self, build, work):
        self.zebhost = build / 'bin/zebhost'
        self.peer = build / 'bin/bench_peer_scan'
        self.work = work
        self.log = work / 'loads'
        self.places = work / 'plugins'
        self.copy_bundles(build / 'vst3bench-state/ZebState.vst3')
        empty = work / 'empty'
        empty.mkdir()
        self.environment = {**os.environ, 'VST3_PATH': str(self.places), 'VST_PATH': str(empty),
                            'AUDIO_COMPONENT_PATH': str(empty), 'ZEB_LOAD_LOG': str(self.log)}

    def copy_bundles(self, bundle):
        (binary,) = bundle.glob('Contents/*/*.so')
        for number in range(BUNDLES):
            name = f'Effect {number:02}'
            place = self.places / f'{name}.vst3/Contents' / binary.parent.name
            place.mkdir(parents=True)
            shutil.copy(binary, place / f'{name}.so')

    def command(self, way, kind, settings):
        if way == 'peer':
            return [self.peer, self.places, settings / 'list.xml']
        command = [self.zebhost, '--settings', settings, '--quiet', 'scan']
        return command + (['--in-process'] if kind == 'in-process' else [])

    def scan(self, way, kind, settings):
        """Its times, and how many binaries it opened."""
        self.log.unlink(missing_ok=True)
        times = timed(self.command(way, kind, settings), self.environment)
        return times, len(set(self.log.read_text().splitlines())) if self.log.exists() else 0

    def recorded(self, way, settings):
        """How many effects stand in the list that the scans have left."""
        if way == 'peer':
            return len(ElementTree.parse(settings / 'list.xml').findall('PLUGIN'))
        run = subprocess.run([self.zebhost, '--settings', settings, 'list', '--json'], env=self.environment,
                             capture_output=True, text=True)
        return len(json.loads(run.stdout)['filters']) if run.returncode == 0 else 0

    def twice(self, way, kind):
        settings = self.work / 'settings'
        shutil.rmtree(settings, ignore_errors=True)
        settings.mkdir()
        first, opened = self.scan(way, kind, settings)
        if opened != BUNDLES:
            raise SystemExit(f'{way} opened {opened} of {BUNDLES} bundles')
        again = self.scan(way, kind, settings)
        recorded = self.recorded(way, settings)
        if recorded != BUNDLES:
            raise SystemExit(f'{way} recorded {recorded} effects in {BUNDLES} bundles')
        return first, *again


def main():
    chosen = options(__doc__.splitlines()[0])
    runs = Runs(chosen)
    kinds = [kind for kind in ('in-process', 'worker')
             if runs.wants(f'P5/first/{kind}') or runs.wants(f'P5/again/{kind}')]
    with folder() as work:
        scans = Scans(chosen.build.resolve(), pathlib.Path(work))
        ways = ['ours', 'again'] + (['peer'] if scans.peer.exists() else [])
        for number in range(chosen.rounds + 1):
            for kind, way in ((kind, way) for kind in kinds for way in ways):
                first, again, opened = scans.twice(way, kind)
                if number > 0:  # the first round warms up
                    runs.add(f'P5/first/{kind}', way, *first, clock='real_time')
                    runs.add(f'P5/again/{kind}', way, *again, clock='real_time', opened=opened)
    runs.write()


if __name__ == '__main__':
    main()
