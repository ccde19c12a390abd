#!/usr/bin/env python3
"""Writes the recording that the project carries: the FM band as rtl_power would have recorded it.

    tools/make_demo_recording.py > recordings/fm_band.csv

Twelve sweeps over 88 to 108 MHz, eight hops of 2.5 MHz with 128 bins each. The stations are invented. The same
seed gives the same file.
"""

import datetime
import math
import random

SEED = 20240517
SWEEPS = 12
SECONDS_A_SWEEP = 5
FIRST_HZ, HOPS, HOP_HZ, BINS = 88_000_000, 8, 2_500_000, 128
STEP_HZ = HOP_HZ / BINS
AVERAGES = 16  # transforms behind each value
NOISE_FLOOR_DB = -51.5

# Frequency, power (dB), loudness: how far the programme pushes the carrier on average (kHz).
STATIONS = [
    (88.4, -24, 34), (89.5, -31, 28), (90.9, -16, 40), (92.2, -30, 22), (93.1, -21, 36), (94.7, -8, 44),
    (95.4, -34, 30), (96.8, -27, 26), (98.5, -18, 38), (100.2, -33, 30), (101.9, -14, 42), (103.6, -25, 18),
    (104.4, -33, 34), (105.9, -20, 40), (107.3, -29, 24),
]
OSCILLATOR_MHZ, OSCILLATOR_DB = 99.32, -22  # unmodulated, one bin wide
FADING_MHZ = 100.2                          # a distant station that comes and goes

PILOT_KHZ = 19.0
MIN_SPREAD_KHZ = 8.0


def power(db):
    return 10 ** (db / 10)


def station_density(offset_khz, spread_khz):
    """Share of a station's power in a bin at an offset: a bell as wide as the deviation, shoulders of the pilot."""
    bell = math.exp(-0.5 * (offset_khz / spread_khz) ** 2) / (spread_khz * math.sqrt(2 * math.pi))
    shoulder = 0.004 * math.exp(-abs(offset_khz) / (3 * PILOT_KHZ)) / PILOT_KHZ
    return (bell + shoulder) * STEP_HZ / 1e3


def tuner_response_db(bin_index):
    """The filter droops towards both edges of a hop and ripples in between."""
    position = (bin_index - BINS / 2) / (BINS / 2)
    return -1.6 * position ** 6 + 0.25 * math.cos(9 * position)


def sweep_settings(rng, number):
    """Power and spread of each station in this sweep: programmes grow louder and softer, paths fade."""
    settings = []
    for mhz, db, loudness_khz in STATIONS:
        fading_db = 7 * math.sin(number / 2) if mhz == FADING_MHZ else 0
        spread_khz = max(MIN_SPREAD_KHZ, rng.gauss(loudness_khz, loudness_khz / 4))
        settings.append((mhz, power(db + fading_db + rng.gauss(0, 0.5)), spread_khz))
    return settings


def level_db(rng, hz, bin_index, settings):
    total = power(NOISE_FLOOR_DB + 1.5 * math.sin(hz / 6.1e6))
    for mhz, station_power, spread_khz in settings:
        total += station_power * station_density((hz - mhz * 1e6) / 1e3, spread_khz)
    if abs(hz - OSCILLATOR_MHZ * 1e6) <= STEP_HZ / 2:
        total += power(OSCILLATOR_DB)
    estimate = rng.gammavariate(AVERAGES, 1 / AVERAGES)  # an averaged power scatters as chi squared
    return 10 * math.log10(total * estimate) + tuner_response_db(bin_index)


def main():
    rng = random.Random(SEED)
    time = datetime.datetime(2024, 5, 17, 14, 3, 20)
    for number in range(SWEEPS):
        settings = sweep_settings(rng, number)
        for hop in range(HOPS):
            low = FIRST_HZ + hop * HOP_HZ
            levels = [level_db(rng, low + i * STEP_HZ, i, settings) for i in range(BINS)]
            levels.append(levels[-1])  # rtl_power writes the last bin twice
            values = ", ".join(f"{level:.2f}" for level in levels)
            print(f"{time:%Y-%m-%d, %H:%M:%S}, {low}, {low + HOP_HZ}, {STEP_HZ:.2f}, {AVERAGES}, {values}")
        time += datetime.timedelta(seconds=SECONDS_A_SWEEP)


if __name__ == "__main__":
    main()
