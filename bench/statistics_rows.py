"""Rows of fitting and resampling, each method at two sizes; processor time."""
import statistics

import benchmarks

REPETITIONS = 5


def size_ratios(found, family, small, large):
    """Ratio of the times at the two sizes -> name of the combination, ascending."""
    ratios = []
    for name, record in found.items():
        if name.startswith(family + "/") and name.endswith(f"/{large}"):
            base = name.removesuffix(f"/{large}")
            ratios.append((record["cpu_time"] / found[f"{base}/{small}"]["cpu_time"],
                           base.removeprefix(family + "/")))
    return sorted(ratios)


def add(table, program):
    found = benchmarks.medians(program, "^(Fit|Jackknife)/", REPETITIONS, seconds=0.01)
    for family, text, small, large in [("Fit", "fit of", 50, 500),
                                       ("Jackknife", "jackknife of", 1000, 10000)]:
        ratios = size_ratios(found, family, small, large)
        worst, name = ratios[-1]
        proportion = f"(in proportion: {large // small})"
        table.add(f"{text} {large} / {small} values, median of {len(ratios)} {proportion}",
                  statistics.median(ratio for ratio, _ in ratios))
        table.add(f"{text} {large} / {small} values, most: {name} {proportion}", worst)


def print_monte_carlo(program):
    found = benchmarks.medians(program, "^MonteCarlo/", repetitions=3, seconds=0.01)
    rows = sorted(((benchmarks.processor_seconds(record), name.removeprefix("MonteCarlo/"))
                   for name, record in found.items()), reverse=True)
    print("Monte Carlo of 1000 samples of 60 values, 107 quantiles: milliseconds of processor time")
    for seconds, name in rows:
        print(f"  {name:<20} {1000 * seconds:8.1f}")
