"""Runs the program of benchmarks and gives their medians."""
import json
import subprocess


def medians(program, names, repetitions, seconds=0.05):
    """Name -> record of the median of each benchmark whose name matches the expression `names`;
    a leading minus takes all others."""
    result = subprocess.run(
        [program, f"--benchmark_filter={names}", f"--benchmark_repetitions={repetitions}",
         "--benchmark_enable_random_interleaving=true",
         "--benchmark_report_aggregates_only=true", "--benchmark_format=json",
         f"--benchmark_min_time={seconds}"],
        check=True, stdout=subprocess.PIPE, stderr=subprocess.PIPE)
    runs = json.loads(result.stdout)["benchmarks"]
    failed = [f"{run['name']}: {run['error_message']}" for run in runs if "error_message" in run]
    if failed:
        raise RuntimeError("; ".join(failed))
    return {run["run_name"]: run for run in runs if run["aggregate_name"] == "median"}


SECONDS = {"ns": 1e-9, "us": 1e-6, "ms": 1e-3, "s": 1.0}


def processor_seconds(record):
    return record["cpu_time"] * SECONDS[record["time_unit"]]
