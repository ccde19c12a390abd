#!/usr/bin/env python3
"""Makes an animated PNG of screenshots, in their own size: make_film.py OUT.png MILLISECONDS PICTURE.png...

Needs the Debian package python3-pil. The pictures come from tests/wine/session.sh; the film of the README is made by

    tools/make_film.py docs/pictures/session.png 1800 build/screenshots/session/*.png
"""

import collections
import sys

from PIL import Image

COLOURS = 128  # the commonest of all pictures; what is rarer are shades of text


def palette_of(pictures):
    counts = collections.Counter()
    for picture in pictures:
        for count, colour in picture.getcolors(picture.width * picture.height):
            counts[colour] += count
    values = [value for colour, _ in counts.most_common(COLOURS) for value in colour]
    palette = Image.new("P", (1, 1))
    palette.putpalette(values + [0] * (3 * 256 - len(values)))
    return palette


def main():
    out, milliseconds = sys.argv[1], int(sys.argv[2])
    pictures = [Image.open(path).convert("RGB") for path in sys.argv[3:]]
    palette = palette_of(pictures)
    frames = [picture.quantize(palette=palette, dither=Image.Dither.NONE) for picture in pictures]
    frames[0].save(out, save_all=True, append_images=frames[1:], duration=milliseconds, loop=0, optimize=True)


if __name__ == "__main__":
    main()
