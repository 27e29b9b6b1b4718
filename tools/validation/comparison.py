"""The same fits in R, and how far the two lie apart."""

import csv
import io
import math
import os
import subprocess
from dataclasses import dataclass

import program

HERE = os.path.dirname(os.path.abspath(__file__))

# What is demanded, relative: fits that solve equations, fits that maximise a likelihood in base R,
# and optimisers of packages, which see a likelihood by its values alone.
EQUATIONS = 1e-8
MAXIMUM = 1e-6
PACKAGE = 1e-4
LIKELIHOOD = 1e-6  # absolute; by so much may the program's likelihood lie below a peer's


@dataclass
class Comparison:
    """One fit held against one peer's."""

    fit: program.Fit
    peer: str
    numbers: list  # the peer's parameters and event
    log_likelihood: float

    @property
    def is_likelihood(self):
        return self.fit.name.endswith("/ML")

    @property
    def made_by_peer(self):
        return not math.isnan(self.numbers[-1])

    @property
    def difference(self):
        """The largest relative difference among parameters and event; of what the peer has."""
        ours = [value for _, value in self.fit.parameters] + [self.fit.event]
        return max(abs(a - b) / abs(b) for a, b in zip(ours, self.numbers) if not math.isnan(b))

    @property
    def gain(self):
        """By how much the program's log-likelihood lies above the peer's."""
        return self.fit.log_likelihood - self.log_likelihood

    @property
    def demanded(self):
        if not self.is_likelihood:
            return EQUATIONS
        return MAXIMUM if self.peer.startswith("base R") else PACKAGE

    def fault(self):
        """Why the comparison fails, or an empty text."""
        if self.fit.failed:
            # More than a quarter of the values outside the range: R makes the fit, and it stands
            # without a likelihood.
            refused = not self.made_by_peer or (
                self.fit.failed == "C13" and math.isnan(self.log_likelihood))
            return "" if refused else f"refused as {self.fit.failed}, fitted by {self.peer}"
        if not self.made_by_peer:
            return f"not fitted by {self.peer}"
        if not self.difference <= self.demanded:
            return f"{self.peer}: differs by {self.difference:.1e}"
        if math.isnan(self.fit.log_likelihood) != math.isnan(self.log_likelihood):
            if self.fit.name != program.CORRECTED:
                return f"{self.peer}: likelihood of one only"
        elif self.gain < -LIKELIHOOD:
            return f"{self.peer}: likelihood below by {-self.gain:.1e}"
        return ""


def _task(name, series):
    threshold = "" if series.threshold is None else repr(series.threshold)
    path = '"' + series.path.replace('"', '""') + '"'
    return f"{name},{series.kind},{series.name},{path},{threshold},{series.exceedance(100)!r}\n"


def _number(cell):
    return math.nan if cell.strip() == "NA" else float(cell)


def compare(fits):
    """Holds the fits against R's, one comparison a peer, in the order of the fits."""
    tasks = "name,kind,series,file,threshold,exceedance\n" + "".join(
        _task(fit.name, fit.series) for fit in fits)
    answer = subprocess.run(["Rscript", os.path.join(HERE, "fit.R")], input=tasks, text=True,
                            stdout=subprocess.PIPE, check=True).stdout
    by_key = {(fit.name, fit.series.kind, fit.series.name): fit for fit in fits}
    found = []
    for row in csv.DictReader(io.StringIO(answer)):
        fit = by_key[row["name"], row["kind"], row["series"]]
        parameters = [_number(row[key]) for key in ("p1", "p2", "p3")][:len(fit.parameters)]
        found.append(Comparison(fit, row["peer"], parameters + [_number(row["event"])],
                                _number(row["logLikelihood"])))
    return found
