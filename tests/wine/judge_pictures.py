#!/usr/bin/env python3
"""Judges the pictures of an unattended play: judge_pictures.py FOLDER SWEEPS

For each sweep there must be a picture of the window and one of the graph. None may be blank, the graph must hold a
trace across its width, each sweep must look different from the one before, and the graph must stand in the window as
it was saved. The highest peak must move on evenly, as the carrier of the recording does. Prints "ok ..." or
"not ok ..." a line each; exits with 1 when one is not.
"""

import collections
import pathlib
import sys

import png


def commonest_share(rows):
    colours = collections.Counter(pixel for row in rows for pixel in row)
    return colours.most_common(1)[0][1] / sum(colours.values()), len(colours)


def is_trace(pixel):
    """The first trace is drawn in green; nothing else of the graph has a colour."""
    red, green, blue = pixel
    return green > red + 32 and green > blue + 32


def peak_column(rows):
    for row in rows:
        columns = [x for x, pixel in enumerate(row) if is_trace(pixel)]
        if columns:
            return sum(columns) / len(columns)
    return -1


def traced_columns(rows):
    """Share of the columns that hold a piece of the trace."""
    return sum(any(map(is_trace, column)) for column in zip(*rows)) / len(rows[0])


# In the window the strips that collapse the areas lie on the graph's right and lower edge.
STRIP_PX = 6


def stands_in(window, graph):
    """Whether the graph's rows are found in the window, one below the other."""
    graph = [row[:-STRIP_PX] for row in graph[:-STRIP_PX]]
    lines = [bytes(v for pixel in row for v in pixel) for row in window]
    wanted = [bytes(v for pixel in row for v in pixel) for row in graph]
    # Found by the row with most to tell: an empty one is found beside the graph as well.
    telling = max(range(len(wanted)), key=lambda y: sum(a != b for a, b in zip(wanted[y], wanted[y][3:])))
    for top in range(len(lines) - len(wanted) + 1):
        at = lines[top + telling].find(wanted[telling])
        if at >= 0 and at % 3 == 0 and all(lines[top + y][at:at + len(row)] == row for y, row in enumerate(wanted)):
            return True
    return False


def main():
    folder, sweeps = pathlib.Path(sys.argv[1]), int(sys.argv[2])
    bad = 0

    def expect(holds, what):
        nonlocal bad
        bad += not holds
        print(("ok" if holds else "not ok"), what)

    expect(len(list(folder.glob("*.png"))) == 2 * sweeps, f"{sweeps} pictures each of window and graph are there")
    previous, peaks = None, []
    for number in range(1, sweeps + 1):
        window = png.read(folder / f"window-{number:04}.png")[2]
        graph = png.read(folder / f"spectrum-{number:04}.png")[2]
        share, colours = commonest_share(window)
        expect(share < 0.97 and colours >= 4, f"sweep {number}: the window is not blank")
        # The areas beside the graph have a quarter of the picture, its margins some more.
        expect(traced_columns(graph) > 0.65, f"sweep {number}: the graph has a trace across its width")
        expect(graph != previous, f"sweep {number}: the graph shows a sweep of its own")
        expect(stands_in(window, graph), f"sweep {number}: the window shows the graph that was saved")
        previous = graph
        peaks.append(peak_column(graph))
    moves = [after - before for before, after in zip(peaks, peaks[1:])]
    expect(min(moves) > 20 and max(moves) - min(moves) <= 4,
           f"the highest peak moves on by the same way each sweep: {moves}")
    return 1 if bad else 0


if __name__ == "__main__":
    sys.exit(main())
