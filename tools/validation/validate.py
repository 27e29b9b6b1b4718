#!/usr/bin/env python3
"""Holds every fit the program offers against fits made in R, on real series.

    tools/validation/validate.py RYN [--out FILE.csv] [--docs docs/methods.md]
                                    [--published DIRECTORY]

Prints the tables of docs/methods.md and, with --docs, puts them there between their marks; --out
takes every number of every fit. A directory with reference_fits.csv, a collection of series with
published fits (published.py tells its form), gives one more table. The exit code is 1 when a
difference is larger than demanded.
"""

import argparse
import os
import sys

import comparison
import literature
import program
import published
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
    parser.add_argument("--published")
    return parser.parse_args()


def show(options, mark, text):
    print(text + "\n")
    if options.docs:
        tables.put_between_marks(options.docs, mark, text)


def validate_fits(options, ryn, series):
    """Against R; the faults."""
    comparisons = comparison.compare(all_fits(ryn, series))
    show(options, "validation table", tables.fits_table(comparisons, series))
    if options.out:
        os.makedirs(os.path.dirname(os.path.abspath(options.out)), exist_ok=True)
        tables.write_csv(options.out, comparisons)
    return [f"{c.fit.name} {c.fit.series.name}: {c.fault()}" for c in comparisons if c.fault()]


def validate_literature(options, ryn, series):
    """Against printed fits; the faults."""
    printed = literature.read(ryn, series)
    show(options, "printed fits", tables.literature_table(printed))
    return [f"{p.fit.name} {p.fit.series.name}: {p.fault()}" for p in printed if p.fault()]


def validate_published(options, ryn):
    """Against a collection's published fits; the faults."""
    rows = published.read(ryn, options.published)
    show(options, "published fits", tables.published_table(rows))
    return [f"{r.caption}: {r.fault()}" for r in rows if r.fault()]


def main():
    options = arguments()
    ryn = program.Program(options.ryn)
    series = program.read_series(os.path.join(HERE, "series.csv"), SERIES)
    faults = validate_fits(options, ryn, series) + validate_literature(options, ryn, series)
    if options.published:
        faults += validate_published(options, ryn)
    for fault in faults:
        print(fault, file=sys.stderr)
    return 1 if faults else 0


if __name__ == "__main__":
    sys.exit(main())
