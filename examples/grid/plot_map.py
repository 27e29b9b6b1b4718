#!/usr/bin/env python3
"""Draws one item of a grid of results as a map.

usage: plot_map.py RESULTS.nc ITEM PICTURE.png

ITEM is its long name, such as "GEV/LMOM - Estimated quantile 50.00 years", or the name of its
variable. An item that does not exist is answered with a list of those that do.
"""
import sys

import matplotlib

matplotlib.use("Agg")  # draws without a screen
import matplotlib.pyplot
import xarray


def find(data, name):
    items = {variable.attrs.get("long_name", key): key for key, variable in data.data_vars.items()
             if variable.ndim == 3}
    key = items.get(name, name)
    if key not in items.values():
        sys.exit("\n".join([f"no item {name}; there are:", *items]))
    return data[key]


def main():
    results, name, picture = sys.argv[1:]
    with xarray.open_dataset(results) as data:
        # Missing places come as NaN and stay white. A grid of results has one time step.
        plane = find(data, name).isel(time=0)
        figure, axes = matplotlib.pyplot.subplots(figsize=(10, 5), layout="constrained")
        plane.plot(ax=axes, cmap="viridis", robust=True)
        axes.set_title(plane.attrs.get("long_name", name))
        figure.savefig(picture, dpi=120)


if __name__ == "__main__":
    main()
