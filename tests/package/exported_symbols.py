#!/usr/bin/env python3
"""Compares the names that the shared library exports with the stored list.

usage: exported_symbols.py LIBRARY LIST [--update]
A name that goes away breaks programs that are already built; a new one is a promise. Both want a decision, and then
--update. Names of the VST 3 SDK must never appear: plug-ins carry their own copies, and a clash crashes them.
"""
import re
import subprocess
import sys

# Audio Units are linked against nothing of the host: the published functions and constants of components, units and
# property lists that they leave open are found here, where the system has none.
PUBLISHED = re.compile(r'^(k?CF|AudioComponent|AudioUnit|AU(EventListener|Listener|Parameter))[A-Za-z0-9_]*$')


def is_ours(name):
    return 'Steinberg' not in name and ('zeb' in name or PUBLISHED.match(name))


def exported(library):
    out = subprocess.run(['nm', '--dynamic', '--defined-only', '--demangle', library],
                         check=True, capture_output=True, text=True).stdout
    return sorted({line.split(' ', 2)[2] for line in out.splitlines() if line})


def main():
    library, path = sys.argv[1], sys.argv[2]
    names = exported(library)
    foreign = [name for name in names if not is_ours(name)]
    if foreign:
        sys.exit('exported, and not ours to export:\n  ' + '\n  '.join(foreign))
    if '--update' in sys.argv:
        open(path, 'w', encoding='utf-8').write('\n'.join(names) + '\n')
        return
    stored = open(path, encoding='utf-8').read().split('\n')[:-1]
    gone = [name for name in stored if name not in set(names)]
    new = [name for name in names if name not in set(stored)]
    if gone or new:
        sys.exit('exported names differ from the list (%s LIBRARY LIST --update takes them over):\n%s' % (
            sys.argv[0], '\n'.join(['  gone: ' + n for n in gone] + ['  new:  ' + n for n in new])))
    print(len(names), 'exported names, as listed')


main()
