#!/usr/bin/env python3
"""Prints the processor time, in seconds, of one bootstrap replicate with SciPy: draw a sample from
the fitted GEV distribution, fit it by maximum likelihood, take its 100-year quantile.
Last line: kappa of the fit to the series.

usage: scipy_speed.py SERIES COUNT
"""
import itertools
import statistics
import sys
import time

import numpy
from scipy.stats import genextreme

REPETITIONS = 5
REPLICATES = 10  # a repetition; a thousand would take minutes
PERIOD = 100


def replicate(fitted, count, generator):
    sample = genextreme.rvs(*fitted, size=count, random_state=generator)
    return genextreme.isf(1 / PERIOD, *genextreme.fit(sample))


def main():
    with open(sys.argv[1], encoding="utf-8") as lines:
        numbers = (float(line) for line in lines if not line.startswith("#"))
        values = list(itertools.islice(numbers, int(sys.argv[2])))
    fitted = genextreme.fit(values)
    generator = numpy.random.default_rng(12345)
    times = []
    for _ in range(REPETITIONS):
        start = time.process_time()
        for _ in range(REPLICATES):
            replicate(fitted, len(values), generator)
        times.append((time.process_time() - start) / REPLICATES)
    print("replicate", statistics.median(times))
    print("kappa", fitted[0])


if __name__ == "__main__":
    main()
