#!/usr/bin/env python3
"""Makes and compares the sound of the stranger's test, and looks whether a picture shows more than one colour.

usage: sound.py make FILE | sound.py compare IN OUT --gain G --delay FRAMES | sound.py picture FILE
"""
import array
import random
import struct
import sys
import zlib


def write_wav(path, channels, frames, samples):
    data = array.array('f', samples).tobytes()
    head = struct.pack('<HHIIHH', 3, channels, 48000, 48000 * channels * 4, channels * 4, 32)
    body = b'WAVEfmt ' + struct.pack('<I', len(head)) + head + b'data' + struct.pack('<I', len(data)) + data
    open(path, 'wb').write(b'RIFF' + struct.pack('<I', len(body)) + body)


def read_wav(path):
    raw = open(path, 'rb').read()
    at, form, data = 12, None, None
    while at + 8 <= len(raw):
        name, size = raw[at:at + 4], struct.unpack('<I', raw[at + 4:at + 8])[0]
        if name == b'fmt ':
            form = struct.unpack('<HHIIHH', raw[at + 8:at + 24])
        if name == b'data':
            data = raw[at + 8:at + 8 + size]
        at += 8 + size + size % 2
    if form is None or data is None or form[5] != 32:
        sys.exit(path + ': not a file of 32-bit floats')
    return form[1], array.array('f', data)


def compare(before, after, gain, delay):
    channels, source = read_wav(before)
    other_channels, result = read_wav(after)
    if channels != other_channels:
        sys.exit('%s has %d channels, %s has %d' % (before, channels, after, other_channels))
    shift = delay * channels
    for index in range(len(source) - shift):
        wanted = source[index] * gain
        if abs(result[index + shift] - wanted) > 1e-6:
            sys.exit('%s: sample %d is %g, not %g' % (after, index + shift, result[index + shift], wanted))
    if any(abs(value) > 1e-6 for value in result[:shift]):
        sys.exit(after + ': sound before the latency has passed')


def picture(path):
    raw = open(path, 'rb').read()
    if raw[:8] != b'\x89PNG\r\n\x1a\n':
        sys.exit(path + ': not a PNG')
    at, packed = 8, b''
    while at < len(raw):
        size, name = struct.unpack('>I4s', raw[at:at + 8])
        if name == b'IDAT':
            packed += raw[at + 8:at + 8 + size]
        at += 12 + size
    pixels = zlib.decompress(packed)
    if len(set(pixels[index:index + 3] for index in range(1, len(pixels) - 3, 3))) < 8:
        sys.exit(path + ': an empty window')


def main():
    words = sys.argv[1:]
    if words[:1] == ['make']:
        noise = random.Random(7)  # The same noise each time
        write_wav(words[1], 2, 48000, [noise.uniform(-0.5, 0.5) for _ in range(2 * 48000)])
    elif words[:1] == ['compare']:
        compare(words[1], words[2], float(words[4]), int(words[6]))
    elif words[:1] == ['picture']:
        picture(words[1])
    else:
        sys.exit(__doc__)


main()
