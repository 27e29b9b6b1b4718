#!/usr/bin/env python3
"""Holds every fit the program offers against fits made in R, on real series.

    tools/validation/validate.py RYN [--out FILE.csv] [--docs docs/methods.md]

Prints the table of docs/methods.md and, with --docs, puts it there between its two marks; --out takes
every number of every fit. The exit code is 1 when a difference is larger than demanded.
"""

import argparse
import os
import sys

import comparison
import program
import tables

HERE = os.path.dirname(os.path.abspath(__file__))
SERIES = os.path.join(HERE, "..", "..", "tests", "reference", "stats", "series")


def all_fits(ryn, series):
    """Every name on every series of its kind."""
    fits = []
    for kind in ("AMS", "PDS"):
        for name in ryn.names(kind):
            fits += [ryn.fit(name, s) for s in series if s.kind == kind]
            if name == "GUM/MOM":
                fits += [ryn.fit(program.CORRECTED, s) for s in series
                         if s.kind == kind and s.is_single]
    return fits


def arguments():
    parser = argparse.ArgumentParser(description=__doc__.splitlines()[0])
    parser.add_argument("ryn")
    parser.add_argument("--out")
    parser.add_argument("--docs")
    return parser.parse_args()


def main():
    options = arguments()
    series = program.read_series(os.path.join(HERE, "series.csv"), SERIES)
    comparisons = comparison.compare(all_fits(program.Program(options.ryn), series))
    text = tables.fits_table(comparisons)
    print(text)
    if options.out:
        os.makedirs(os.path.dirname(os.path.abspath(options.out)), exist_ok=True)
        tables.write_csv(options.out, comparisons)
    if options.docs:
        tables.put_between_marks(options.docs, "validation table", text)
    faults = [c for c in comparisons if c.fault()]
    for c in faults:
        print(f"{c.fit.name} {c.fit.series.name}: {c.fault()}", file=sys.stderr)
    return 1 if faults else 0


if __name__ == "__main__":
    sys.exit(main())
