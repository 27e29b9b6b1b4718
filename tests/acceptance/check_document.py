#!/usr/bin/env python3
"""Runs the examples of a document and compares what they print with what it shows.

usage: check_document.py PROGRAM_DIRECTORY DOCUMENT [FILE...]

An example is a line "$ COMMAND" in a block of kind `console`, with the lines up to the next one as
its output; a command goes on after a backslash at the end of its line. All run one after the other
in a new directory, which the document calls /home/me and which holds copies of the files.
"""
import os
import pathlib
import shutil
import subprocess
import sys
import tempfile

HOME = b"/home/me"


def examples(text):
    """Line number, command and expected lines of each example."""
    found, is_console = [], False
    for number, line in enumerate(text.splitlines(), 1):
        if line.startswith("```"):
            is_console = line == "```console"
        elif is_console and line.startswith("$ "):
            found.append((number, line[2:], []))
        elif is_console and found[-1][1].endswith("\\"):
            start, command, expected = found[-1]
            found[-1] = (start, command[:-1] + line.strip(), expected)
        elif is_console:
            found[-1][2].append(line)
    return found


def main():
    programs, document = pathlib.Path(sys.argv[1]).resolve(), pathlib.Path(sys.argv[2])
    environment = dict(os.environ, LC_ALL="C", PATH=f"{programs}:{os.environ['PATH']}")
    environment["LSAN_OPTIONS"] = "print_suppressions=0"  # a sanitized build prints them else
    faults = 0
    all_examples = examples(document.read_text(encoding="utf-8"))
    with tempfile.TemporaryDirectory(prefix="ryn-document-") as name:
        here = pathlib.Path(name).resolve()
        for file in sys.argv[3:]:
            shutil.copy(file, here)
        for number, command, expected in all_examples:
            result = subprocess.run(
                ["bash", "-c", command], cwd=here, env=environment, stdin=subprocess.DEVNULL,
                stdout=subprocess.PIPE, stderr=subprocess.STDOUT, timeout=60, check=False)
            printed = result.stdout.replace(str(here).encode(), HOME).decode().splitlines()
            if printed != expected:
                faults += 1
                print(f"{document}:{number}: `{command}` prints:", *printed, sep="\n")
    print(f"{len(all_examples)} examples, {faults} differ")
    return 1 if faults or not all_examples else 0


if __name__ == "__main__":
    sys.exit(main())
