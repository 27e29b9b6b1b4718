"""The table that the benchmarks end in: a text, a ratio, and the limit where there is one."""


class RatioTable:
    def __init__(self):
        self.rows = []

    def add(self, text, value, at_most=None, at_least=None):
        limit, verdict = "", ""
        if at_most is not None:
            limit = f"   at most {at_most:g}"
            verdict = "   MISSED" if value > at_most else ""
        if at_least is not None:
            limit = f"   at least {at_least:g}"
            verdict = "   MISSED" if value < at_least else ""
        self.rows.append((text, value, limit, verdict))

    def print(self):
        width = max(len(text) for text, *_ in self.rows)
        for text, value, limit, verdict in self.rows:
            print(f"{text:<{width}}  {value:8.2f}{limit}{verdict}")

    def missed(self):
        return any(verdict for *_, verdict in self.rows)
