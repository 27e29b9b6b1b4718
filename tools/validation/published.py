"""Published and independently checked fits of annual maxima, from a table of a collection of them.

The table, reference_fits.csv, has a row for each series: its file and column beside the table, n,
mean, sd, skew (G1), l1, l2, t3, t4, and the maximum likelihood fits of the GEV (gev_loc, gev_scale,
gev_shape_xi, which is -kappa, gev_nllh) and Gumbel distributions (gum_loc, gum_scale, gum_nllh).
"""

import csv
import math
import os
import tempfile
from dataclasses import dataclass

import program

TABLE = "reference_fits.csv"

# What each series is, by its file and column. A file without an entry goes by its own name.
CAPTIONS = os.path.join(os.path.dirname(os.path.abspath(__file__)), "published.csv")


@dataclass
class Published:
    """A row of the table, its series and what the program makes of it."""

    row: dict
    caption: str
    source: str
    values: list
    statistics: dict  # mean, sd, skew, l1, l2, t3, t4
    gev: program.Fit
    gumbel: program.Fit

    def number(self, key):
        return float(self.row[key])

    def statistics_difference(self):
        """The largest difference among the statistics in units of the table's last digit, or of
        what the 32-bit numbers of a data file leave uncertain where that is more."""
        level = abs(self.number("mean"))
        in_units = {"mean", "sd", "l1", "l2"}
        return max(_digits_off(value, self.row[key],
                               2.0**-24 * level / (1 if key in in_units else self.number("sd")))
                   for key, value in self.statistics.items())

    def gains(self):
        """By how much the program's two likelihoods lie above the table's; NaN where it refuses."""
        return [fit.log_likelihood + self.number(key)
                for fit, key in ((self.gev, "gev_nllh"), (self.gumbel, "gum_nllh"))]

    def parameter_difference(self):
        """The largest relative difference of a location or scale, or difference of the shape."""
        pairs = []
        if not self.gev.failed:
            (_, xi), (_, alpha), (_, kappa) = self.gev.parameters
            pairs += [abs(xi / self.number("gev_loc") - 1),
                      abs(alpha / self.number("gev_scale") - 1),
                      abs(kappa + self.number("gev_shape_xi"))]
        (_, xi), (_, alpha) = self.gumbel.parameters
        pairs += [abs(xi / self.number("gum_loc") - 1), abs(alpha / self.number("gum_scale") - 1)]
        return max(pairs)

    def fault(self):
        """Why the row fails, or an empty text. The table's likelihoods have three decimals."""
        if self.statistics_difference() > 1:
            return "statistics differ"
        if any(gain < -0.0006 for gain in self.gains() if not math.isnan(gain)):
            return "likelihood below the published"
        return ""


def _digits_off(value, text, uncertain):
    decimals = len(text.partition(".")[2])
    return abs(value - float(text)) / max(10.0**-decimals, uncertain)


def _column(path, name):
    """The numbers of a column; cells without one are gaps."""
    with open(path, encoding="utf-8-sig", newline="") as file:
        lines = [line for line in file if not line.startswith("#")]
    delimiter = ";" if ";" in lines[0] else ","
    cells = [row[name].strip() for row in csv.DictReader(lines, delimiter=delimiter)]
    return [float(cell) for cell in cells if cell not in ("", "NA")]


def _statistics(results):
    moments = results["OrdinaryMoments"]
    l = results["LMoments"]
    return {"mean": moments["Mean"], "sd": math.sqrt(moments["Variance"]),
            "skew": moments["Skewness"], "l1": l["L_1"], "l2": l["L_2"],
            "t3": l["L_skewness"], "t4": l["L_Kurtosis"]}


def _fits(ryn, values):
    with tempfile.TemporaryDirectory() as folder:
        path = os.path.join(folder, "values.txt")
        with open(path, "w", encoding="utf-8") as text:
            text.writelines(f"{value!r}\n" for value in values)
        series = program.Series("", "AMS", "", "", path, True, values=values)
        return ryn.fit("GEV/ML", series), ryn.fit("GUM/ML", series)


def read(ryn, directory):
    """Every row of the table with the program's own fits."""
    with open(CAPTIONS, encoding="utf-8", newline="") as file:
        captions = {(row["file"], row["column"]): row for row in csv.DictReader(file)}
    found = []
    with open(os.path.join(directory, TABLE), encoding="utf-8", newline="") as file:
        for row in csv.DictReader(file):
            values = _column(os.path.join(directory, row["file"]), row["column"])
            if len(values) != int(row["n"]):
                raise ValueError(f"{row['file']}: {len(values)} values, the table has {row['n']}")
            known = captions.get((row["file"], row["column"]),
                                 {"caption": row["file"], "source": ""})
            statistics = _statistics(ryn.analysis(values)["SampleStatistics"])
            found.append(Published(row, known["caption"], known["source"], values, statistics,
                                   *_fits(ryn, values)))
    return found
