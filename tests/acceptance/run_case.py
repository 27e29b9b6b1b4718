#!/usr/bin/env python3
"""Runs one acceptance case: a folder with a script and what is expected of it.

usage: run_case.py PROGRAM_DIRECTORY CASE_FOLDER [--accept]

    CASE_FOLDER/script       bash, run in a new directory with the programs on the PATH
    CASE_FOLDER/input/       copied into that directory before, where there is any
    CASE_FOLDER/stdout       what the script prints, on standard output and standard error together
    CASE_FOLDER/files/       files that must be there afterwards, byte for byte

The script's exit code must be 0; it prints the codes that it is about. The directory's name is
"<here>" in `stdout`, the source's is "<source>". With --accept the expected output is written anew
from the run, to be read before it is committed.
"""
import os
import pathlib
import shutil
import subprocess
import sys
import tempfile

TIME_LIMIT = 120  # seconds


def run(programs, case, here):
    """Exit code and output of the case's script in the directory `here`."""
    source = case.resolve().parents[2]
    environment = dict(os.environ, LC_ALL="C", RYN_SOURCE=str(source))
    environment["LSAN_OPTIONS"] = "print_suppressions=0"  # a sanitized build prints them else
    environment["PATH"] = f"{programs.resolve()}:{os.environ['PATH']}"
    if (case / "input").is_dir():
        shutil.copytree(case / "input", here, dirs_exist_ok=True)
    result = subprocess.run(
        ["bash", str((case / "script").resolve())], cwd=here, env=environment, timeout=TIME_LIMIT,
        stdin=subprocess.DEVNULL, stdout=subprocess.PIPE, stderr=subprocess.STDOUT, check=False)
    output = result.stdout.replace(str(here).encode(), b"<here>")
    return result.returncode, output.replace(str(source).encode(), b"<source>")


def faults(case, here, code, output):
    """What differs from the expectation, one line each."""
    if code != 0:
        yield f"the script ended with {code}"
    if output != (case / "stdout").read_bytes():
        yield "standard output differs; it is:\n" + output.decode(errors="replace")
    expected = case / "files"
    for path in sorted(p for p in expected.rglob("*") if p.is_file()):
        made = here / path.relative_to(expected)
        if not made.is_file():
            yield f"{made.name} was not made"
        elif made.read_bytes() != path.read_bytes():
            yield f"{made.name} differs; it is:\n" + made.read_bytes().decode(errors="replace")


def main():
    programs, case = pathlib.Path(sys.argv[1]), pathlib.Path(sys.argv[2])
    with tempfile.TemporaryDirectory(prefix="ryn-acceptance-") as name:
        here = pathlib.Path(name).resolve()
        code, output = run(programs, case, here)
        if "--accept" in sys.argv[3:]:
            (case / "stdout").write_bytes(output)
        found = list(faults(case, here, code, output))
    print("\n".join(found) if found else "as expected")
    return 1 if found else 0


if __name__ == "__main__":
    sys.exit(main())
