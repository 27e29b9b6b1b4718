#!/usr/bin/env python3
"""Makes grids of daily values for the benchmarks, as reanalyses are stored: (time, latitude,
longitude), north first, 32-bit floats, with a seasonal cycle and gamma noise whose scale differs
from point to point. The same arguments give the same values.

usage: grid_data.py DIRECTORY NX NY YEARS [classic|cdf5|deflate]

Prints the name of the file, which is made only where it is missing.
"""
import datetime
import pathlib
import sys

import netCDF4
import numpy

RECIPE = 1  # counts up when the values change, so that kept files are made anew
SEED = 20240229
FIRST_YEAR = 1961
BLOCK = 4_000_000  # values held at a time
VARIABLE = "wind"
CHUNK_STEPS, CHUNK_SIDE = 365, 20

FORMATS = {"classic": "NETCDF3_64BIT_OFFSET", "cdf5": "NETCDF3_64BIT_DATA", "deflate": "NETCDF4"}


def file_name(nx, ny, years, layout):
    return f"daily-{nx}x{ny}x{years}-{layout}-{RECIPE}.nc"


def days_of(years):
    first = datetime.date(FIRST_YEAR, 1, 1)
    return (datetime.date(FIRST_YEAR + years, 1, 1) - first).days


def create(path, nx, ny, days, layout):
    data = netCDF4.Dataset(path, "w", format=FORMATS[layout])
    data.Conventions = "CF-1.8"
    for name, size in [("time", days), ("latitude", ny), ("longitude", nx)]:
        data.createDimension(name, size)
    time = data.createVariable("time", "i4", ("time",))
    time.units = f"hours since {FIRST_YEAR}-01-01 00:00:00"
    time.calendar = "proleptic_gregorian"
    time[:] = 24 * numpy.arange(days)
    for name, unit, values in [("latitude", "degrees_north", 60 - 0.25 * numpy.arange(ny)),
                               ("longitude", "degrees_east", -20 + 0.25 * numpy.arange(nx))]:
        axis = data.createVariable(name, "f4", (name,))
        axis.units = unit
        axis[:] = values
    kept = {}
    if layout == "deflate":
        chunks = (min(CHUNK_STEPS, days), min(CHUNK_SIDE, ny), min(CHUNK_SIDE, nx))
        kept = {"zlib": True, "complevel": 1, "shuffle": True, "chunksizes": chunks}
    wind = data.createVariable(VARIABLE, "f4", ("time", "latitude", "longitude"), **kept)
    wind.long_name = "daily maximum wind speed"
    wind.units = "m s-1"
    return data


def fill(data, steps_of_block):
    wind = data[VARIABLE]
    days, ny, nx = wind.shape
    # A generator for each variate, so that the values do not depend on the size of the blocks.
    first, second, third = [numpy.random.default_rng(SEED + number) for number in range(3)]
    scale = third.uniform(1.5, 3.0, (ny, nx)).astype("f4")
    for start in range(0, days, steps_of_block):
        day = numpy.arange(start, min(start + steps_of_block, days), dtype="f8")
        # A sum of two exponential variates is one of the gamma distribution with shape 2.
        values = first.standard_exponential((day.size, ny, nx), dtype="f4")
        values += second.standard_exponential((day.size, ny, nx), dtype="f4")
        season = (6 + 3 * numpy.cos(2 * numpy.pi * day / 365.2425)).astype("f4")
        values *= scale
        values += season[:, numpy.newaxis, numpy.newaxis]
        wind[start:start + day.size] = values


def make(directory, nx, ny, years, layout="classic"):
    """The grid's path in the directory."""
    path = pathlib.Path(directory) / file_name(nx, ny, years, layout)
    if path.exists():
        return path
    path.parent.mkdir(parents=True, exist_ok=True)
    unfinished = path.with_suffix(".part")
    # Whole chunks at a time: one that is written twice would be packed twice.
    steps = CHUNK_STEPS if layout == "deflate" else max(1, BLOCK // (nx * ny))
    with create(unfinished, nx, ny, days_of(years), layout) as data:
        fill(data, steps)
    unfinished.rename(path)
    return path


if __name__ == "__main__":
    print(make(sys.argv[1], *map(int, sys.argv[2:5]), *sys.argv[5:6]))
