"""What the comparisons come to, as tables of docs/methods.md and as one of all numbers."""

import csv
import math

KINDS = {"AMS": "annual maxima", "PDS": "partial durations"}


def six(value):
    return "-" if math.isnan(value) else f"{value:.6g}"


def small(value):
    """A difference; rounding alone counts as none."""
    if math.isnan(value):
        return "-"
    return "0" if value == 0 else f"{value:.0e}".replace("e-0", "e-")


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
    return [fit.name.replace(" (", ", ").rstrip(")"), fit.series.name, str(len(fit.series.values)),
            _parameters(fit), six(fit.event), six(fit.log_likelihood), shown.peer,
            small(shown.difference), _gain(shown), everywhere]


def _lines(heading, rows):
    cells = [heading, ["---"] * len(heading)] + rows
    return "\n".join("| " + " | ".join(row) + " |" for row in cells)


def _series_table(series):
    rows = [[s.name, KINDS[s.kind], str(len(s.values)), s.caption, s.source,
             "" if s.threshold is None else f"{s.threshold:g}, {len(s.values)}/{s.years:g}"]
            for s in series]
    return _lines(["series", "kind", "n", "what", "source", "threshold, peaks a year"], rows)


def _count(comparisons):
    made = [c for c in comparisons if not c.fit.failed]
    equations = [c for c in made if not c.is_likelihood]
    likelihoods = [c for c in made if c.is_likelihood]
    names = {(c.fit.series.kind, c.fit.name) for c in made}
    worst = max(c.difference for c in equations)
    base = max(c.difference for c in likelihoods if c.peer.startswith("base R"))
    package = max(c.difference for c in likelihoods if not c.peer.startswith("base R"))
    gains = [c for c in likelihoods if not math.isnan(c.gain)]
    lowest, highest = min(gains, key=lambda c: c.gain), max(gains, key=lambda c: c.gain)
    return (f"{len(names)} names, {len(made)} comparisons. Largest relative difference of fits by "
            f"moments and L-moments {small(worst)}, by maximum likelihood {small(base)} to base R "
            f"and {small(package)} to the packages. The program's log-likelihood less the peer's lies "
            f"between {small(lowest.gain)} ({_place(lowest)}) and {small(highest.gain)} "
            f"({_place(highest)}).")


def _place(c):
    return f"{c.fit.name} of {c.fit.series.name}"


def fits_table(comparisons, series):
    """The series, a summary, and one row for each name and peer, parted by the kind of series."""
    heading = ["name", "series", "n", "parameters", "100-year event", "ln L", "compared with",
               "difference", "ln L against it", "largest difference on all series"]
    parts = [_series_table(series), _count(comparisons)]
    for kind, caption in KINDS.items():
        rows = []
        names = []
        for (of_kind, name, _), group in _grouped(comparisons).items():
            if of_kind == kind:
                names += [] if name in names else [name]
                rows.append(_row(group, len(names)))
        parts.append(f"**{caption.capitalize()}**\n\n" + _lines(heading, rows))
    return "\n\n".join(parts)


def literature_table(printed):
    """One row for each fit: printed numbers and the program's."""
    groups = {}
    for p in printed:
        groups.setdefault((p.fit.name, p.fit.series.name, p.source), []).append(p)
    rows = []
    for (name, series, source), group in groups.items():
        rows.append([name, series, source, ", ".join(f"{p.quantity} {p.text}" for p in group),
                     ", ".join(f"{p.ours:.7g}" for p in group)])
    beyond = [f"{p.quantity} of {p.fit.name} on {p.fit.series.name} "
              f"({small(p.difference / abs(p.ours))})" for p in printed if not p.in_last_digit]
    text = (f"{len(printed)} numbers, {len(printed) - len(beyond)} of them met within one unit of "
            "the last digit")
    text += "; beyond that (relative): " + ", ".join(beyond) + "." if beyond else "."
    return _lines(["name", "series", "source", "printed", "program"], rows) + "\n\n" + text


def _refused_or(fit, text):
    return f"refused: {fit.failed}" if fit.failed else text


def _signed(gain):
    return "" if math.isnan(gain) else f"{gain:+.4f}"


def published_table(rows):
    """One row for each series: the likelihoods against the table's, which have three decimals."""
    heading = ["series", "n", "source", "l1, l2, t3, t4", "GEV/ML kappa", "ln L", "less published",
               "GUM/ML ln L", "less published"]
    lines = []
    for r in sorted(rows, key=lambda r: r.caption.lower()):
        l = ", ".join(six(r.statistics[key]) for key in ("l1", "l2", "t3", "t4"))
        gev_gain, gumbel_gain = (_signed(gain) for gain in r.gains())
        kappa = _refused_or(r.gev, "" if r.gev.failed else six(r.gev.parameters[2][1]))
        lines.append([r.caption, str(len(r.values)), r.source, l, kappa, six(r.gev.log_likelihood),
                      gev_gain, six(r.gumbel.log_likelihood), gumbel_gain])
    return _lines(heading, lines) + "\n\n" + _published_summary(rows)


def _published_summary(rows):
    gains = [gain for r in rows for gain in r.gains() if not math.isnan(gain)]
    worst = max((r for r in rows if not r.gev.failed), key=lambda r: r.parameter_difference())
    refused = [f"{r.caption} ({r.gev.failed})" for r in rows if r.gev.failed]
    text = (f"{len(rows)} series, {len(gains)} likelihoods: the program's less the published one "
            f"lies between {min(gains):+.4f} and {max(gains):+.4f}, where the published ones are "
            "rounded to 0.001. Mean, standard deviation, skewness and L-moments differ by at most "
            f"{max(r.statistics_difference() for r in rows):.2f} units of the last digit given. "
            "Largest difference of a location or scale (relative) or of the shape: "
            f"{worst.parameter_difference():.0e} ({worst.caption}).")
    if refused:
        text += " Refused by the program: GEV/ML of " + ", ".join(refused) + "."
    return text


def write_csv(path, comparisons):
    """Every number of every fit and of its peers."""
    with open(path, "w", encoding="utf-8", newline="") as file:
        out = csv.writer(file)
        out.writerow(["kind", "name", "series", "n", "peer", "failed", "parameters", "event",
                      "logLikelihood", "peerNumbers", "peerLogLikelihood", "difference"])
        for c in comparisons:
            fit = c.fit
            difference = "" if fit.failed or not c.made_by_peer else repr(c.difference)
            ours = " ".join(repr(value) for _, value in fit.parameters)
            theirs = " ".join(repr(value) for value in c.numbers)
            out.writerow([fit.series.kind, fit.name, fit.series.name, len(fit.series.values),
                          c.peer, fit.failed, ours, fit.event, fit.log_likelihood, theirs,
                          c.log_likelihood, difference])


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
