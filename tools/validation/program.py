"""The program under validation, by its command line alone."""

import csv
import json
import os
import re
import struct
import subprocess
import tempfile
from dataclasses import dataclass, field

CORRECTED = "GUM/MOM (sample size correction)"  # the one fit that has no name of its own


@dataclass
class Series:
    """A real series and what makes it one of annual maxima or of partial durations."""

    name: str
    kind: str  # AMS or PDS
    caption: str
    source: str
    path: str
    shown: bool  # whether the table may give its fits in full
    threshold: float | None = None
    years: float | None = None
    values: list = field(default_factory=list)

    @property
    def rate(self):
        return 1.0 if self.years is None else len(self.values) / self.years

    @property
    def is_single(self):
        """Whether a data file, which holds 32-bit numbers, holds the very values."""
        return all(struct.unpack("f", struct.pack("f", v))[0] == v for v in self.values)

    def exceedance(self, period):
        return 1.0 / (period * self.rate)


@dataclass
class Fit:
    """Numbers of one fit; `failed` is the reason where there are none."""

    name: str
    series: Series
    parameters: list = field(default_factory=list)  # pairs of symbol and value
    event: float = float("nan")  # of 100 years
    log_likelihood: float = float("nan")
    failed: str = ""


def read_series(table, directory):
    """The series of a table like series.csv, with their values."""
    found = []
    with open(table, encoding="utf-8", newline="") as file:
        for row in csv.DictReader(file):
            path = os.path.join(directory, row["name"] + ".txt")
            with open(path, encoding="utf-8") as text:
                values = [float(line) for line in text if not line.startswith("#")]
            found.append(Series(row["name"], row["kind"], row["caption"], row["source"], path,
                                row["shown"] == "yes",
                                float(row["threshold"]) if row["threshold"] else None,
                                float(row["years"]) if row["years"] else None, values))
    return found


class Program:
    """Runs ryn; English texts, whatever the caller's language."""

    def __init__(self, path):
        self.path = os.path.abspath(path)

    def _run(self, *arguments, check=True):
        return subprocess.run([self.path, *arguments, "--lang", "en"], capture_output=True,
                              text=True, check=check)

    def names(self, kind):
        """All names that can arise: the message about a wrong one lists them."""
        options = [] if kind == "AMS" else ["--pds", "--rate", "1", "--threshold", "0"]
        answer = self._run("fit", "?", os.devnull, *options, check=False).stderr
        offered = re.search(r"on offer for [a-z ]+: (.*)", answer)
        if not offered:
            raise ValueError(f"{self.path} lists no names: {answer}")
        return offered.group(1).split(", ")

    def fit(self, name, series):
        """The fit of a series, by the full numbers of --json."""
        if name == CORRECTED:
            return self._fit_corrected(series)
        options = ["--periods", "100", "--json"]
        if series.kind == "PDS":
            options += ["--pds", "--rate", repr(series.rate), "--threshold", repr(series.threshold)]
        answer = self._run("fit", name, series.path, *options, check=False).stdout
        return fit_of(name, series, json.loads(answer))

    def analysis(self, values, *settings):
        """The results of a whole analysis of annual maxima with GUM/MOM, as `info` tells them. A
        data file holds 32-bit numbers, so that the values lose digits beyond the seventh."""
        with tempfile.TemporaryDirectory() as folder:
            at = lambda name: os.path.join(folder, name)
            with open(at("table.csv"), "w", encoding="utf-8") as table:
                table.write("date,value\n")
                for i, value in enumerate(values):
                    table.write(f"{1801 + i}-01-01,{value!r}\n")
            self._run("import", at("table.csv"), at("series.tsq0"))
            self._run("new", at("case.ryn"), "DefineEVS.InputFileName=" + at("series.tsq0"),
                      "DefineEVS.OutputFileName=" + at("case.res"), "--fit", "GUM/MOM", *settings,
                      "--periods", "100")
            self._run("run", at("case.RYN"))
            return json.loads(self._run("info", at("case.res"), "--json").stdout)["RYNoutput"]

    def _fit_corrected(self, series):
        """Gumbel's constants of the sample size are an option of an analysis, not of a name."""
        results = self.analysis(series.values, "Analysis.LogLikelihood=true",
                                "ProbabilityDistribution.Item1.SampleCorrection=true")
        item = results["DistributionAnalysis"]["Item1"]
        parameters = [(item["ParameterEstimates"][f"strParEst{i}"],
                       item["ParameterEstimates"][f"ParEst{i}"]) for i in (1, 2)]
        return Fit(CORRECTED, series, parameters, item["TyearEventTable"]["TyearEvent"],
                   item["GoodnessOfFitStatistics"]["LogLikelihoodStatistic"])


def fit_of(name, series, answer):
    """A fit as the program's JSON tells it."""
    number = lambda value: float("nan") if value is None else float(value)
    if answer["failed"]:
        return Fit(name, series, failed=answer["failed"].split(":")[0])
    return Fit(name, series, [(p["symbol"], number(p["estimate"])) for p in answer["parameters"]],
               number(answer["quantiles"][0]["estimate"]), number(answer["logLikelihood"]))
