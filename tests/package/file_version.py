"""Fails unless Windows files are of a version: file_version.py VERSION FILE..."""

import pathlib
import struct
import sys

SIGNATURE = struct.pack("<LL", 0xFEEF04BD, 0x00010000)  # of the fixed part of a version resource

wanted = [*(int(number) for number in sys.argv[1].split(".")), 0]
for file in sys.argv[2:]:
    data = pathlib.Path(file).read_bytes()
    start = data.find(SIGNATURE)
    minor, major, build, patch = struct.unpack_from("<4H", data, start + len(SIGNATURE)) if start >= 0 else [-1] * 4
    text = sys.argv[1].encode("utf-16-le")
    if [major, minor, patch, build] != wanted or data.count(text) < 2:
        sys.exit(f"{file}: {major}.{minor}.{patch}.{build}, not {wanted}")
