#!/usr/bin/env python3
"""Reads the #include lines of src/ against the table of folders.

A folder includes itself, what the table allows it, and what those folders show in their public
headers. Prints one line for each include that goes the wrong way and exits with 1.
"""
import pathlib
import re
import sys

# folder: folders it may include. From level 2 up, "strings" is open to all.
MAY_USE = {
    "base": set(),
    "strings": {"base"},
    "units": {"base"},
    "kvf": {"base"},
    "netcdf": {"base"},
    "axes": {"base"},
    "stats": set(),
    "selfcheck": {"base", "stats"},
    "ports": {"base", "strings"},
    "framework": {"base", "strings", "kvf", "ports"},
    "tsq": {"base", "units", "netcdf"},
    "grid": {"base", "units", "netcdf"},
    "controls": {"base", "kvf"},
    "engine": {"base", "kvf", "stats"},
    "import": {"base", "units", "tsq"},
    "series": {"base", "kvf", "tsq", "units", "strings", "ports"},
    "params": {"base", "kvf", "framework", "series", "tsq"},
    "results": {"base", "kvf", "framework", "controls", "ports"},
    "document": {"framework", "params", "results", "ports"},
    "run": {"document", "engine", "grid", "tsq", "series", "ports"},
    "desktop": {"framework", "ports"},
    "widgets": {"controls", "axes", "units", "tsq"},
    "views": {"results", "document", "axes", "desktop", "widgets"},
    "forms": {"run", "params", "desktop", "widgets"},
    "shell": {"views", "forms", "run"},
    "apps": {"run", "import", "stats", "selfcheck"},
}
LEVEL_TWO_AND_UP = set(MAY_USE) - {
    "base", "strings", "units", "kvf", "netcdf", "axes", "stats", "selfcheck", "ports",
}
# What only one folder may call.
PRIVATE_HEADERS = {
    "netcdf.h": "netcdf",
    "netcdf_mem.h": "netcdf",
    "udunits2.h": "units",
}
INCLUDE = re.compile(r'^\s*#\s*include\s+([<"])([^>"]+)[>"]')


def reachable(folder):
    """What `folder` may include: its own, the table's, and theirs in turn."""
    seen, queue = {folder}, [folder]
    while queue:
        for used in MAY_USE[queue.pop()]:
            if used not in seen:
                seen.add(used)
                queue.append(used)
    if folder in LEVEL_TWO_AND_UP:
        seen |= {"strings", "base"}
    return seen


def faults(root):
    source = root / "src"
    for path in sorted(source.rglob("*")):
        if path.suffix not in {".h", ".cpp"}:
            continue
        folder = path.relative_to(source).parts[0]
        if folder not in MAY_USE:
            yield f"{path.relative_to(root)}:1: folder {folder} is not in the table of folders"
            continue
        allowed = reachable(folder)
        for number, line in enumerate(path.read_text(encoding="utf-8").splitlines(), 1):
            match = INCLUDE.match(line)
            if not match:
                continue
            place = f"{path.relative_to(root)}:{number}"
            name = match.group(2)
            if match.group(1) == "<":
                owner = PRIVATE_HEADERS.get(name)
                if owner and owner != folder:
                    yield f"{place}: <{name}> is called by {owner}/ alone"
                if name.startswith("Q") and folder not in {
                    "desktop", "widgets", "views", "forms", "shell", "apps"
                }:
                    yield f"{place}: {folder}/ does not know Qt"
            else:
                target = pathlib.PurePosixPath(name).parts[0]
                if target in MAY_USE and target not in allowed:
                    yield f"{place}: {folder}/ may not use {target}/"
                elif "/" not in name:
                    yield f"{place}: write the folder: {folder}/{name}"


def main():
    root = pathlib.Path(sys.argv[1] if len(sys.argv) > 1 else ".").resolve()
    found = list(faults(root))
    print("\n".join(found) if found else "the order of the folders holds")
    return 1 if found else 0


if __name__ == "__main__":
    sys.exit(main())
