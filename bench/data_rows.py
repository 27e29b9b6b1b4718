"""Rows of reading and selecting series, and of parameter trees; processor time, since the files lie
in memory and a busy machine shows less in it than in elapsed time."""
import benchmarks

REPETITIONS = 7
MILLION = 1_000_000
TEN = 10 * MILLION


def add(table, program):
    # In a process of their own: the memory that others leave behind moves the library's time by a
    # quarter, one way in one run and the other way in the next.
    alone = benchmarks.medians(program, f"^(NetcdfAlone|ReadSeries)/{TEN}$", REPETITIONS)
    table.add("read 10^7 samples / netCDF alone",
              alone[f"ReadSeries/{TEN}"]["cpu_time"] / alone[f"NetcdfAlone/{TEN}"]["cpu_time"],
              at_most=2.5)

    found = benchmarks.medians(program, "^(Read|Annual|Partial|Kvf)", REPETITIONS)

    def time(name, size):
        return found[f"{name}/{size}"]["cpu_time"]

    read = time("ReadSeries", TEN)
    for name, text in [("AnnualMaximaOfYears", "annual maxima"),
                       ("AnnualMaximaOfSeasons", "annual maxima of a season"),
                       ("PartialDurationsOfAllYear", "partial durations"),
                       ("PartialDurationsOfSeasons", "partial durations of a season")]:
        table.add(f"{text} of 10^7 samples / reading them", time(name, TEN) / read, at_most=1)
    table.add("bytes of memory a sample", found[f"ReadSeries/{TEN}"]["bytesPerSample"], at_most=48)
    # Arrays of 3 x 10^6 samples and more come fresh from the system; smaller ones are used again.
    for name, text in [("ReadSeries", "read"), ("AnnualMaximaOfYears", "annual maxima of"),
                       ("PartialDurationsOfAllYear", "partial durations of")]:
        table.add(f"{text} 10^7 / 3 x 10^6 samples (in proportion: 3.33)",
                  time(name, TEN) / time(name, 3 * MILLION))
    for name, text in [("KvfWrite", "write"), ("KvfRead", "read"), ("KvfLookUpAll", "look up")]:
        table.add(f"{text} a tree of 10^6 / 10^5 keywords (in proportion: 10)",
                  time(name, MILLION) / time(name, MILLION // 10))
