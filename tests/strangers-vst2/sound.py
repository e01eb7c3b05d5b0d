"""Sound files of 32-bit floats, and the pictures of editors."""
import array
import math
import random
import struct
import zlib

RATE = 48000


def write_noise(path, seconds):
    noise = random.Random(11)  # the same each time
    samples = array.array('f', (noise.uniform(-0.25, 0.25) for _ in range(2 * RATE * seconds)))
    head = struct.pack('<4sIHHIIHH', b'fmt ', 16, 3, 2, RATE, RATE * 8, 8, 32)
    data = struct.pack('<4sI', b'data', 4 * len(samples)) + samples.tobytes()
    path.write_bytes(struct.pack('<4sI4s', b'RIFF', 4 + len(head) + len(data), b'WAVE') + head + data)


def read_samples(path):
    raw = path.read_bytes()
    at = 12
    while at + 8 <= len(raw):
        name, size = struct.unpack('<4sI', raw[at:at + 8])
        if name == b'data':
            return array.array('f', raw[at + 8:at + 8 + size])
        at += 8 + size + size % 2
    raise ValueError(f'{path}: no samples')


def is_finite(path):
    samples = read_samples(path)
    return len(samples) > 0 and all(map(math.isfinite, samples))


def largest_difference(first, second):
    """Infinite if the lengths differ."""
    one, other = read_samples(first), read_samples(second)
    if len(one) != len(other):
        return math.inf
    return max(abs(a - b) for a, b in zip(one, other))


def picture_colours(path):
    """How many colours a picture of zebhost's has: eight bits a part, rows without a filter."""
    raw = path.read_bytes()
    at, packed, width = 8, b'', 0
    while at < len(raw):
        size, name = struct.unpack('>I4s', raw[at:at + 8])
        if name == b'IHDR':
            width = struct.unpack('>I', raw[at + 8:at + 12])[0]
        if name == b'IDAT':
            packed += raw[at + 8:at + 8 + size]
        at += 12 + size
    pixels = zlib.decompress(packed)
    row = 1 + 3 * width
    return len({pixels[start + at:start + at + 3] for start in range(0, len(pixels), row) for at in range(1, row, 3)})
