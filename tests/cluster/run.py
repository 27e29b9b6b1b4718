#!/usr/bin/env python3
"""The grid batch under schedulers: a Slurm job array of which a task is killed and submitted again,
mpirun, and GNU parallel each make the output of one process to the bit.

usage: run.py PROGRAM_DIRECTORY
"""
import os
import pathlib
import shutil
import signal
import subprocess
import sys
import tempfile
import time

from local_slurm import LocalSlurm

PARTS = 4
SECONDS = 300  # for a whole run of the program, which takes some ten
GRID = pathlib.Path(__file__).resolve().parents[1] / "acceptance/grid-in-jobs/input/waves.nc"


class Batch:
    """A case in a new directory, whose output is compared with `expected`. The directory is the
    same each time: the output names itself in its title."""

    def __init__(self, program, directory, expected=None):
        self.program, self.directory, self.expected = program, directory, expected
        shutil.rmtree(directory, ignore_errors=True)
        directory.mkdir()
        # Monte Carlo makes each part last long enough to be killed.
        fits = ["GEV/LMOM", "GUM/ML", "GUM/MOM", "P3/LMOM", "LN2/ML"]
        self.ryn("new", "case.ryn", *[word for fit in fits for word in ("--fit", fit)],
                 "--periods", "2,10,100", "DefineEVS.OutputFileName=case.res", "--grid", str(GRID),
                 "--grid-item", "1", "--grid-out", "out.nc")

    def ryn(self, *arguments):
        subprocess.run([self.program, *arguments], cwd=self.directory, check=True,
                       timeout=SECONDS, stdout=subprocess.DEVNULL, stderr=subprocess.DEVNULL)

    def tiles(self):
        return sorted(path.name for path in self.directory.glob("out.nc.tiles/*of*"))

    def output(self):
        return (self.directory / "out.nc").read_bytes()

    def merge(self, name):
        self.ryn("grid", "case.ryn", "--parts", str(PARTS), "--merge")
        if self.output() != self.expected:
            sys.exit(f"{name}: the output differs from that of one process")
        print(f"{name}: the output of one process, to the bit")


def run_slurm(batch):
    script = f"{batch.program} grid case.ryn --parts {PARTS}"
    with LocalSlurm() as slurm:
        job = slurm.submit(batch.directory, script, f"--array=1-{PARTS}")
        # Killed in the middle of its work.
        end = time.monotonic() + 60
        while not batch.tiles() and time.monotonic() < end:
            time.sleep(0.05)
        slurm.output("scancel", "--signal=KILL", "--full", f"{job}_3")
        slurm.wait_for_end(job)
        before = batch.tiles()
        missing = subprocess.run([batch.program, "grid", "case.ryn", "--parts", str(PARTS),
                                  "--merge"], cwd=batch.directory, capture_output=True, text=True,
                                 check=False)
        if missing.returncode != 3 or "are missing" not in missing.stderr:
            sys.exit(f"Slurm: the killed task left nothing missing: {missing.stderr}")
        slurm.wait_for_end(slurm.submit(batch.directory, script, "--array=3"))
        print(f"Slurm: {len(before)} tiles when a task was killed, {len(batch.tiles())} when it "
              "had run again")
    batch.merge("Slurm job array")


def run_mpirun(batch):
    environment = dict(os.environ, OMPI_ALLOW_RUN_AS_ROOT="1", OMPI_ALLOW_RUN_AS_ROOT_CONFIRM="1")
    subprocess.run(["mpirun", "-n", str(PARTS), "--oversubscribe", batch.program, "grid",
                    "case.ryn", "--parts", str(PARTS)], cwd=batch.directory, env=environment,
                   check=True, timeout=SECONDS, stdout=subprocess.DEVNULL)
    batch.merge("mpirun")


def run_parallel(batch):
    environment = dict(os.environ, HOME=str(batch.directory))  # where it keeps its notice
    subprocess.run(["parallel", "--will-cite", "-j2", f"{batch.program} grid case.ryn --parts "
                    f"{PARTS} # {{}}", ":::", *map(str, range(PARTS))], cwd=batch.directory,
                   env=environment, check=True, timeout=SECONDS, stdout=subprocess.DEVNULL)
    batch.merge("GNU parallel")


def main():
    # So that the daemons end with it.
    signal.signal(signal.SIGTERM, lambda *_: sys.exit("stopped"))
    program = str(pathlib.Path(sys.argv[1]).resolve() / "ryn")
    root = pathlib.Path(tempfile.mkdtemp(prefix="ryn-cluster-"))
    try:
        one = Batch(program, root / "case")
        one.ryn("grid", "case.ryn")
        expected = one.output()
        for run in [run_slurm, run_mpirun, run_parallel]:
            run(Batch(program, root / "case", expected))
    finally:
        shutil.rmtree(root)


if __name__ == "__main__":
    main()
