"""Rows of the grid batch, against SciPy, xarray and NumPy and against itself: other sizes, two
processes. Its grids, some 2 GB, are made once and kept in build/bench-data beneath the repository.

One-core rows are processor time of processes that may use one core. All files lie in the page
cache. The row of wall time needs a machine that does nothing else.
"""
import dataclasses
import json
import os
import pathlib
import resource
import shutil
import statistics
import subprocess
import time

import rival_rows

BENCH = pathlib.Path(__file__).resolve().parent
DATA = BENCH.parent / "build/bench-data"
WORK = DATA / "work"
REPETITIONS = 3

LIMITED = ["prlimit", "--nofile=1024:1024"]
ONE_CORE = [*LIMITED, "taskset", "--cpu-list", "0"]
ONE_THREAD = {name: "1" for name in
              ["OPENBLAS_NUM_THREADS", "OMP_NUM_THREADS", "MKL_NUM_THREADS"]}

# Largest relative difference of a quantile: the rivals take kappa from an approximation.
SAME_GEV, SAME_GUMBEL = 2e-3, 1e-6


@dataclasses.dataclass
class Spent:
    processor: float
    wall: float
    printed: str


def children_processor():
    used = resource.getrusage(resource.RUSAGE_CHILDREN)
    return used.ru_utime + used.ru_stime


def run(command):
    """What a process and those that it started and waited for have spent."""
    before, start = children_processor(), time.perf_counter()
    done = subprocess.run(command, capture_output=True, text=True, env=os.environ | ONE_THREAD,
                          cwd=WORK, check=False)
    wall = time.perf_counter() - start
    if done.returncode != 0:
        raise RuntimeError(f"{command}: exit code {done.returncode}: {done.stderr}")
    return Spent(children_processor() - before, wall, done.stdout)


def make_grid(nx, ny, years, layout="classic"):
    made = subprocess.run([*rival_rows.PYTHON, "-B", BENCH / "grid_data.py", DATA,
                           str(nx), str(ny), str(years), layout],
                          check=True, stdout=subprocess.PIPE, text=True)
    return pathlib.Path(made.stdout.strip())


class Batch:
    """The command `ryn grid` on a whole grid."""

    def __init__(self, program, grid):
        self.program = program
        self.output = WORK / f"{grid.stem}-results.nc"
        self.case = WORK / f"{grid.stem}.ryn"
        run([program, "new", self.case, "--yes", "--fit", "GEV/LMOM", "--fit", "GUM/LMOM",
             "--periods", "2,10,50,100,200", "--grid", grid, "--grid-item", "1",
             "--grid-out", self.output, "Tsq2Input.UncertaintyCal=false",
             f"DefineEVS.OutputFileName={grid.stem}.res"])

    def run(self, limits, *options):
        return run([*limits, self.program, "grid", self.case, *options])

    def on_one_core(self):
        return self.run(ONE_CORE)


def run_rival(name, grid):
    return run([*ONE_CORE, *rival_rows.PYTHON, "-B", BENCH / "grid_rivals.py", name, grid,
                WORK / f"{name}.nc"])


def repeated(runs):
    """Name -> what each repetition of that run has spent; the runs take turns, after one that
    brings the files into the cache."""
    spent = {name: [] for name in runs}
    for name, work in runs.items():
        work()
    for _ in range(REPETITIONS):
        for name, work in runs.items():
            spent[name].append(work())
    return spent


def processor(spent):
    return statistics.median(one.processor for one in spent)


def wall(spent):
    return statistics.median(one.wall for one in spent)


def reported(spent):
    """Of a rival, without the start of Python and its libraries."""
    return statistics.median(json.loads(one.printed)["processor"] for one in spent)


def check_same_answers(batch):
    for rival in ["xarray", "slices"]:
        lines = run([*rival_rows.PYTHON, "-B", BENCH / "grid_answers.py", batch.output,
                     WORK / f"{rival}.nc"]).printed
        found = {name: float(value) for name, value in map(str.split, lines.splitlines())}
        if not (found["GEV"] <= SAME_GEV and found["GUM"] <= SAME_GUMBEL):
            raise RuntimeError(f"{rival} finds other quantiles: {found}")


def add_rivals(table, batch, grid):
    runs = {"ryn": batch.on_one_core}
    runs |= {name: lambda name=name: run_rival(name, grid)
             for name in ["scipy", "xarray", "slices"]}
    spent = repeated(runs)
    check_same_answers(batch)
    ours = processor(spent["ryn"])
    table.add("SciPy's GEV fits of 10^4 points (50 x 200) / ryn grid, 60 years of days",
              reported(spent["scipy"]) / ours, at_least=50)
    faster = min(["xarray", "slices"], key=lambda name: reported(spent[name]))
    table.add(f"ryn grid / the same L-moment fits by NumPy, annual maxima by {faster}",
              ours / reported(spent[faster]), at_most=10)
    table.add("ryn grid / the same with the start of Python and its libraries",
              ours / processor(spent[faster]))


def add_two_processes(table, batch):
    spent = repeated({"one": lambda: batch.run(LIMITED),
                      "two": lambda: batch.run(LIMITED, "--jobs", "2")})
    table.add("ryn grid / ryn grid --jobs 2 with its merge, wall time",
              wall(spent["one"]) / wall(spent["two"]), at_least=1.7)
    table.add("ryn grid --jobs 2 with its merge / ryn grid, processor time",
              processor(spent["two"]) / processor(spent["one"]))


def print_split(program, batch):
    """What a point costs by step, in milliseconds of processor time."""
    lines = run([*ONE_CORE, program.resolve().parent / "ryn_grid_split", batch.case]).printed
    print("\nryn grid, milliseconds a point, 60 years of days (writing: results taken into the "
          "grids, last point's files, output file)")
    print(lines, end="")
    print(f"all {sum(float(line.split()[1]) for line in lines.splitlines()):.4f}")


def add_sizes(table, program):
    batches = {name: Batch(program, make_grid(*size)) for name, size in
               {"small": (40, 25, 6), "large": (400, 250, 6),
                "plain": (100, 100, 6), "packed": (100, 100, 6, "deflate")}.items()}
    spent = repeated({name: batch.on_one_core for name, batch in batches.items()})
    table.add("ryn grid, a point of 10^5 / a point of 10^3, 6 years of days",
              processor(spent["large"]) / 1e5 / (processor(spent["small"]) / 1e3), at_most=1.3)
    table.add("ryn grid, 10^4 points in deflated chunks / contiguous, 6 years of days",
              processor(spent["packed"]) / processor(spent["plain"]))


def add(table, program):
    ryn = program.resolve().parent / "ryn"
    WORK.mkdir(parents=True, exist_ok=True)
    grid = make_grid(100, 100, 60)
    batch = Batch(ryn, grid)
    add_rivals(table, batch, grid)
    add_two_processes(table, batch)
    print_split(program, batch)
    add_sizes(table, ryn)
    shutil.rmtree(WORK)
