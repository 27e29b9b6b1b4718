#!/usr/bin/env python3
"""Prints how far the quantiles of the grid batch lie from those of grid_rivals.py, as the largest
relative difference over all points and return periods: one line for GEV, one for Gumbel.

usage: grid_answers.py OURS THEIRS
"""
import sys

import netCDF4
import numpy

import grid_rivals


def difference(ours, theirs, name):
    largest = 0.0
    for period in grid_rivals.PERIODS:
        plane = ours[f"{name}_LMOM_Estimated_quantile_{period:.0f}_00_years"][0]
        # The batch writes latitudes that ascend; the rival keeps those of the grid, north first.
        theirs_turned = theirs[f"{name}_{period:.0f}"][::-1]
        largest = max(largest, numpy.abs(plane / theirs_turned - 1).max())
    return largest


def main():
    with netCDF4.Dataset(sys.argv[1]) as ours, netCDF4.Dataset(sys.argv[2]) as theirs:
        for name in ["GEV", "GUM"]:
            print(name, difference(ours, theirs, name))


if __name__ == "__main__":
    main()
