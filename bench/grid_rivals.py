#!/usr/bin/env python3
"""The grid batch with Python's libraries: annual maxima at each point of a grid of daily values,
fitted distributions, and quantiles at five return periods, written to a netCDF file.

usage: grid_rivals.py scipy|xarray|slices GRID OUTPUT

scipy   annual maxima with xarray, then a loop over scipy.stats.genextreme.fit (maximum likelihood)
        at SAMPLE points that lie evenly over the grid, its time scaled up to all points
xarray  annual maxima with xarray, then L-moment fits of GEV and Gumbel for all points at once
slices  the same, but annual maxima year by year with netCDF4 and NumPy

Prints one line of JSON: processor and wall seconds from the start of reading to the written file,
without the time that Python takes to start and to load the libraries.
"""
import json
import math
import sys
import time

import netCDF4
import numpy
import xarray
from scipy.special import gamma
from scipy.stats import genextreme

import grid_data

PERIODS = numpy.array([2.0, 10.0, 50.0, 100.0, 200.0])
SAMPLE = 200
EULER = 0.5772156649015329


def maxima_by_xarray(path):
    with xarray.open_dataset(path) as data:
        return data[grid_data.VARIABLE].groupby("time.year").max().values


def maxima_by_slices(path):
    with netCDF4.Dataset(path) as data:
        time_axis, wind = data["time"], data[grid_data.VARIABLE]
        wind.set_auto_maskandscale(False)
        dates = netCDF4.num2date(time_axis[:], time_axis.units, time_axis.calendar)
        years = numpy.array([date.year for date in dates])
        starts = numpy.flatnonzero(numpy.diff(years, prepend=years[0] - 1))
        ends = numpy.append(starts[1:], years.size)
        return numpy.stack([wind[start:end].max(axis=0) for start, end in zip(starts, ends)])


def l_moments(values):
    """l1, l2 and t3 along the first axis, unbiased."""
    x = numpy.sort(values, axis=0).astype("f8")
    n = x.shape[0]
    rank = numpy.arange(n, dtype="f8")
    b0 = x.mean(axis=0)
    b1 = numpy.tensordot(rank / (n - 1), x, 1) / n
    b2 = numpy.tensordot(rank * (rank - 1) / ((n - 1) * (n - 2)), x, 1) / n
    l2 = 2 * b1 - b0
    return b0, l2, (6 * b2 - 6 * b1 + b0) / l2


def fit_gev(l1, l2, t3):
    """Hosking, Wallis and Wood (1985): kappa by their approximation."""
    c = 2 / (3 + t3) - math.log(2) / math.log(3)
    kappa = 7.8590 * c + 2.9554 * c * c
    g = gamma(1 + kappa)
    alpha = l2 * kappa / ((1 - 2 ** -kappa) * g)
    return {"xi": l1 - alpha * (1 - g) / kappa, "alpha": alpha, "kappa": kappa}


def fit_gumbel(l1, l2):
    alpha = l2 / math.log(2)
    return {"xi": l1 - EULER * alpha, "alpha": alpha}


def quantiles(fitted):
    """One plane for each return period."""
    reduced = -numpy.log(-numpy.log1p(-1 / PERIODS))
    kappa = fitted.get("kappa")
    if kappa is None:
        return [fitted["xi"] + fitted["alpha"] * y for y in reduced]
    return [fitted["xi"] - fitted["alpha"] * numpy.expm1(-kappa * y) / kappa for y in reduced]


def fit_all(maxima):
    """Name -> plane of all results."""
    l1, l2, t3 = l_moments(maxima)
    planes = {}
    for name, fitted in [("GEV", fit_gev(l1, l2, t3)), ("GUM", fit_gumbel(l1, l2))]:
        planes |= {f"{name}_{symbol}": plane for symbol, plane in fitted.items()}
        planes |= {f"{name}_{period:.0f}": plane
                   for period, plane in zip(PERIODS, quantiles(fitted))}
    return planes


def write(path, planes):
    ny, nx = next(iter(planes.values())).shape
    with netCDF4.Dataset(path, "w", format="NETCDF3_64BIT_OFFSET") as data:
        data.createDimension("latitude", ny)
        data.createDimension("longitude", nx)
        for name in planes:
            data.createVariable(name, "f4", ("latitude", "longitude"))
        for name, plane in planes.items():
            data[name][:] = plane


def fit_sample(maxima):
    """GEV parameters and quantiles of the sample, a row for each of its points."""
    series = maxima.reshape(maxima.shape[0], -1)
    chosen = numpy.linspace(0, series.shape[1] - 1, SAMPLE).astype(int)
    rows = []
    for point in chosen:
        fitted = genextreme.fit(series[:, point])
        rows.append([*fitted, *genextreme.isf(1 / PERIODS, *fitted)])
    return numpy.array(rows), series.shape[1] / SAMPLE


class Clock:
    def __init__(self):
        self.start = self.now()

    @staticmethod
    def now():
        return numpy.array([time.process_time(), time.perf_counter()])

    def seconds(self):
        return self.now() - self.start


def run_scipy(grid, output):
    clock = Clock()
    maxima = maxima_by_xarray(grid)
    read = clock.seconds()
    rows, scale = fit_sample(maxima)
    fitted = clock.seconds() - read
    write(output, {"sample": rows})
    return read + scale * fitted


def run_l_moments(find_maxima, grid, output):
    clock = Clock()
    write(output, fit_all(find_maxima(grid)))
    return clock.seconds()


def main():
    rival, grid, output = sys.argv[1:]
    if rival == "scipy":
        seconds = run_scipy(grid, output)
    else:
        find = {"xarray": maxima_by_xarray, "slices": maxima_by_slices}[rival]
        seconds = run_l_moments(find, grid, output)
    print(json.dumps({"rival": rival, "processor": seconds[0], "wall": seconds[1]}))


if __name__ == "__main__":
    main()
