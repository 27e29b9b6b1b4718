"""What the comparisons come to, as tables of docs/methods.md and as one of all numbers."""

import csv
import math

KINDS = {"AMS": "annual maxima", "PDS": "partial durations"}


def six(value):
    return "-" if math.isnan(value) else f"{value:.6g}"


def small(value):
    """A difference; rounding alone counts as none."""
    return "-" if math.isnan(value) else "0" if value == 0 else f"{value:.0e}".replace("e-0", "e-")


def _parameters(fit):
    return ", ".join(f"{symbol} {six(value)}" for symbol, value in fit.parameters)


def _gain(c):
    """Of a likelihood fit: the same to 1e-6, or by how much the program's is higher."""
    if not c.is_likelihood or math.isnan(c.gain):
        return ""
    if abs(c.gain) <= 1e-6:
        return "the same"
    return f"ours {'higher' if c.gain > 0 else 'lower'} by {small(abs(c.gain))}"


def _grouped(comparisons):
    """By kind, name and peer, in the order of the comparisons."""
    groups = {}
    for c in comparisons:
        groups.setdefault((c.fit.series.kind, c.fit.name, c.peer), []).append(c)
    return groups


def _shown(made, turn):
    """The series of a group that the table gives in full: another one for each name, of those for
    which there is a number in every column."""
    good = [c for c in made if c.fit.series.shown and not math.isnan(c.numbers[0])]
    full = [c for c in good if not math.isnan(c.fit.log_likelihood)]
    choice = full or good
    return choice[turn % len(choice)]


def _row(group, turn):
    made = [c for c in group if not c.fit.failed and c.made_by_peer]
    refused = [f"{c.fit.series.name} {c.fit.failed}" for c in group if c.fit.failed]
    shown = _shown(made, turn)
    worst = max(made, key=lambda c: c.difference)
    everywhere = f"{small(worst.difference)} ({worst.fit.series.name}), {len(made)} series"
    if refused:
        everywhere += "; refused: " + ", ".join(refused)
    fit = shown.fit
    return [fit.name.replace(" (", ", ").rstrip(")"), fit.series.name, str(len(fit.series.values)), _parameters(fit), six(fit.event),
            six(fit.log_likelihood), shown.peer, small(shown.difference), _gain(shown), everywhere]


def _lines(heading, rows):
    cells = [heading, ["---"] * len(heading)] + rows
    return "\n".join("| " + " | ".join(row) + " |" for row in cells)


def fits_table(comparisons):
    """One row for each name and peer, parted by the kind of series."""
    heading = ["name", "series", "n", "parameters", "100-year event", "ln L", "compared with",
               "difference", "ln L against it", "largest difference on all series"]
    parts = []
    for kind, caption in KINDS.items():
        rows = []
        names = []
        for (of_kind, name, _), group in _grouped(comparisons).items():
            if of_kind == kind:
                names += [] if name in names else [name]
                rows.append(_row(group, len(names)))
        parts.append(f"**{caption.capitalize()}**\n\n" + _lines(heading, rows))
    return "\n\n".join(parts)


def write_csv(path, comparisons):
    """Every number of every fit and of its peers."""
    with open(path, "w", encoding="utf-8", newline="") as file:
        out = csv.writer(file)
        out.writerow(["kind", "name", "series", "n", "peer", "failed", "parameters", "event",
                      "logLikelihood", "peerNumbers", "peerLogLikelihood", "difference"])
        for c in comparisons:
            fit = c.fit
            difference = "" if fit.failed or not c.made_by_peer else repr(c.difference)
            out.writerow([fit.series.kind, fit.name, fit.series.name, len(fit.series.values), c.peer,
                          fit.failed, " ".join(repr(v) for _, v in fit.parameters), fit.event,
                          fit.log_likelihood, " ".join(repr(v) for v in c.numbers), c.log_likelihood,
                          difference])


def put_between_marks(path, mark, text):
    """Replaces what stands between <!-- MARK: begin --> and <!-- MARK: end -->."""
    begin, end = f"<!-- {mark}: begin -->", f"<!-- {mark}: end -->"
    with open(path, encoding="utf-8") as file:
        whole = file.read()
    if whole.count(begin) != 1 or whole.count(end) != 1:
        raise ValueError(f"{path}: the marks {begin} and {end} must stand there once")
    head, rest = whole.split(begin)
    tail = rest.split(end)[1]
    with open(path, "w", encoding="utf-8") as file:
        file.write(f"{head}{begin}\n{text}\n{end}{tail}")
