#!/usr/bin/env python3
"""Where the highest peak stands in a picture of the graph: peak_place.py WHOLE PICTURE

In thousandths of the graph's width, which the trace of another picture, WHOLE, fills from edge to edge.
"""

import sys

import judge_pictures
import png


def main():
    whole, picture = (png.read(path)[2] for path in sys.argv[1:3])
    traced = [x for x, column in enumerate(zip(*whole)) if any(map(judge_pictures.is_trace, column))]
    left, right = traced[0], traced[-1]
    print(round(1000 * (judge_pictures.peak_column(picture) - left) / (right - left)))


if __name__ == "__main__":
    main()
