"""Fits printed in books and manuals: literature.csv, a row for each number.

Its last column says how near, relative, a number must be that is not met to its last digit: books
round on their way, and Hosking's approximations of a shape by its L-skewness are good to some 1e-3.
"""

import csv
import dataclasses
import math
import os
from dataclasses import dataclass

import program

TABLE = os.path.join(os.path.dirname(os.path.abspath(__file__)), "literature.csv")

@dataclass
class Printed:
    """A printed number and the program's."""

    fit: program.Fit
    quantity: str
    text: str  # as printed
    source: str
    within: float
    ours: float

    @property
    def difference(self):
        return abs(self.ours - float(self.text))

    @property
    def in_last_digit(self):
        """Whether both are the same within one unit of the last printed digit."""
        return self.difference <= 10.0 ** -len(self.text.partition(".")[2])

    def fault(self):
        if self.in_last_digit or self.difference <= self.within * abs(float(self.text)):
            return ""
        return f"{self.quantity} {self.ours:.8g}, printed {self.text}"


def _quantity(fit, name):
    """A parameter, or what a book gives in its place."""
    p = dict(fit.parameters)
    known = {
        "ln L": lambda: fit.log_likelihood,
        "100-year event": lambda: fit.event,
        "1/alpha": lambda: 1 / p["alpha"],
        "mean of lg x": lambda: (p["xi"] + p["kappa"] * p["alpha"]) / math.log(10),
        "deviation of lg x": lambda: abs(p["alpha"]) * math.sqrt(p["kappa"]) / math.log(10),
        "skewness of lg x": lambda: math.copysign(2 / math.sqrt(p["kappa"]), p["alpha"]),
    }
    return known[name]() if name in known else p[name]


def _series_for(ryn, name, series):
    """Books fit the gamma distribution to annual maxima from 0 up: here a partial duration series
    of one peak a year above 0."""
    if name in ryn.names(series.kind):
        return series
    return dataclasses.replace(series, kind="PDS", threshold=0.0, years=float(len(series.values)))


def read(ryn, series):
    """Every printed number with the program's own."""
    by_name = {s.name: s for s in series}
    fits = {}
    found = []
    with open(TABLE, encoding="utf-8", newline="") as file:
        for row in csv.DictReader(file):
            key = row["name"], row["series"]
            if key not in fits:
                own = _series_for(ryn, row["name"], by_name[row["series"]])
                fits[key] = ryn.fit(row["name"], own)
            found.append(Printed(fits[key], row["quantity"], row["published"], row["source"],
                                 float(row["within"]), _quantity(fits[key], row["quantity"])))
    return found
