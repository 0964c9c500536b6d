"""What was measured, as a table in Markdown."""

import statistics

median = statistics.median


class Table:
    """One line for each measure: our number, the yardstick's, their ratio and the goal."""

    def __init__(self):
        self.missed = 0
        self._begun = False

    def _begin(self):
        if not self._begun:
            print("| measure | viewer | yardstick | ratio | goal | |\n|---|---:|---:|---:|---:|---|",
                  flush=True)
        self._begun = True

    def _line(self, name, ours, theirs, value, goal, fits):
        self._begin()
        self.missed += not fits
        print(f"| {name} | {ours} | {theirs} | {value} | {goal} | {'' if fits else 'over'} |",
              flush=True)

    def ratio(self, name, ours, theirs, unit, goal, at_least=False):
        ours, theirs = median(ours), median(theirs)
        value = ours / theirs if theirs else float("inf")
        fits = value >= goal if at_least else value <= goal
        self._line(name, f"{ours:.1f} {unit}", f"{theirs:.1f} {unit}", f"{value:.2f}",
                   f"{'≥' if at_least else '≤'} {goal:g}", fits)

    def number(self, name, ours, unit, goal, theirs=""):
        self._line(name, f"{ours:.1f} {unit}", theirs, "", f"≤ {goal:g} {unit}", ours <= goal)

    def note(self, name, text, theirs=""):
        self._begin()
        print(f"| {name} | {text} | {theirs} | | | |", flush=True)
