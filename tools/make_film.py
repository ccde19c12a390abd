#!/usr/bin/env python3
"""Makes an animated picture of screenshots: make_film.py OUT.gif MILLISECONDS WIDTH PICTURE.png...

Needs the Debian package python3-pil. The pictures come from tests/wine/session.sh; the film of the README is made by

    tools/make_film.py docs/pictures/session.gif 1800 900 build/screenshots/session/*.png
"""

import sys

from PIL import Image

COLOURS = 64  # enough for traces, bars and grey text


def main():
    out, milliseconds, width = sys.argv[1], int(sys.argv[2]), int(sys.argv[3])
    frames = []
    for path in sys.argv[4:]:
        picture = Image.open(path).convert("RGB")
        height = round(picture.height * width / picture.width)
        frames.append(picture.resize((width, height), Image.LANCZOS).quantize(COLOURS, dither=Image.Dither.NONE))
    frames[0].save(out, save_all=True, append_images=frames[1:], duration=milliseconds, loop=0, optimize=True)


if __name__ == "__main__":
    main()
