"""Just enough of PNG to judge a screenshot: eight bits a channel, not interlaced."""

import struct
import zlib

CHANNELS = {0: 1, 2: 3, 6: 4}  # by colour type: grey, RGB, RGBA


def read(path):
    """Width, height, and the rows as lists of (red, green, blue)."""
    with open(path, "rb") as file:
        data = file.read()
    if data[:8] != b"\x89PNG\r\n\x1a\n":
        raise ValueError(f"{path} is not a PNG file")
    at, body = 8, b""
    while at < len(data):
        length, kind = struct.unpack(">I4s", data[at:at + 8])
        chunk = data[at + 8:at + 8 + length]
        if zlib.crc32(kind + chunk) != struct.unpack(">I", data[at + 8 + length:at + 12 + length])[0]:
            raise ValueError(f"{path} is damaged")
        if kind == b"IHDR":
            width, height, depth, colour, _, _, interlaced = struct.unpack(">IIBBBBB", chunk)
            if depth != 8 or colour not in CHANNELS or interlaced:
                raise ValueError(f"{path}: a kind of PNG that this does not read")
        elif kind == b"IDAT":
            body += chunk
        at += 12 + length
    return width, height, _pixels(zlib.decompress(body), width, height, CHANNELS[colour])


def _pixels(raw, width, height, channels):
    rows, stride = [], width * channels
    previous = bytearray(stride)
    for y in range(height):
        start = y * (stride + 1)
        line = bytearray(raw[start + 1:start + 1 + stride])
        _unfilter(raw[start], line, previous, channels)
        step = [line[i::channels] for i in range(min(channels, 3))]
        rows.append(list(zip(*(step if channels >= 3 else step * 3))))
        previous = line
    return rows


def _unfilter(kind, line, up, bpp):
    for i in range(len(line)) if kind else ():
        a = line[i - bpp] if i >= bpp else 0
        b, c = up[i], up[i - bpp] if i >= bpp else 0
        if kind == 1:
            guess = a
        elif kind == 2:
            guess = b
        elif kind == 3:
            guess = (a + b) // 2
        else:
            guess = min((a, b, c), key=lambda value: (abs(a + b - c - value), (a, b, c).index(value)))
        line[i] = (line[i] + guess) & 255
