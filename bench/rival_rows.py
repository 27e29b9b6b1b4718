"""Rows against R and SciPy: the same work on the same 50 values, on one core, processor time."""
import os
import pathlib
import subprocess

import benchmarks

BENCH = pathlib.Path(__file__).resolve().parent
SERIES = BENCH.parent / "tests/reference/stats/series/portpirie.txt"
COUNT = 50
REPETITIONS = 7
REPLICATES = 1000
SAME_SHAPE = 1e-4  # about where the rivals' optimisers stop

# Debian's own interpreters: others that stand before them in PATH would not know its packages.
R = ["/usr/bin/Rscript", "--vanilla"]
PYTHON = ["/usr/bin/python3"]


def install():
    packages = BENCH / "packages.txt"
    subprocess.run([BENCH.parent / "tools/install-packages", packages], check=True)


def reported(interpreter, script):
    """Name -> value of the lines that a script prints."""
    one_thread = {name: "1" for name in
                  ["OPENBLAS_NUM_THREADS", "OMP_NUM_THREADS", "MKL_NUM_THREADS"]}
    result = subprocess.run([*interpreter, BENCH / script, SERIES, str(COUNT)], check=True,
                            stdout=subprocess.PIPE, text=True, env=os.environ | one_thread)
    return dict(line.split() for line in result.stdout.splitlines())


def check_same_answer(name, theirs, ours):
    if abs(float(theirs["kappa"]) - ours["kappa"]) > SAME_SHAPE:
        raise RuntimeError(f"{name} fits another shape: {theirs['kappa']}, not {ours['kappa']}")


def add(table, program):
    evd = reported(R, "evd_speed.R")
    scipy = reported(PYTHON, "scipy_speed.py")
    l_moments = reported(R, "lmom_speed.R")
    found = benchmarks.medians(program, "^(Gev|MonteCarloOfAnnualMaxima)", REPETITIONS)

    fit = found["GevLikelihoodFit"]
    likelihood = found["GevReplicates/likelihood"]
    replicates = found["GevReplicates/lMoments"]
    for name, theirs, ours in [("evd", evd, fit), ("SciPy", scipy, likelihood),
                               ("R", l_moments, replicates)]:
        check_same_answer(name, theirs, ours)

    seconds = benchmarks.processor_seconds
    table.add("evd::fgev / GEV/ML fit of 50 values",
              float(evd["with_standard_errors"]) / seconds(fit), at_least=50)
    table.add("evd::fgev without standard errors / the same",
              float(evd["without_standard_errors"]) / seconds(fit))
    scipy_thousand = REPLICATES * float(scipy["replicate"])
    table.add("SciPy (1000 x the time of one) / 1000 replicates of GEV/ML on 50 values",
              scipy_thousand / seconds(likelihood), at_least=1000)
    rival = "R package lmom" if l_moments["code"] == "lmom" else "plain R code (no package lmom)"
    table.add(f"{rival} / 1000 replicates of GEV/LMOM on 50 values",
              float(l_moments["replicates"]) / seconds(replicates), at_least=5)

    everything = found["MonteCarloOfAnnualMaxima"]
    count = f"{everything['combinations']:.0f}"
    table.add(f"seconds for Monte Carlo of all {count} annual maximum combinations on 60 values",
              seconds(everything), at_most=1)
    table.add("SciPy's 1000 replicates of GEV/ML alone / the same",
              scipy_thousand / seconds(everything))
