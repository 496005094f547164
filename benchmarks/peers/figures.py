"""What the processes of both sides measured."""
import math
import statistics
from collections import defaultdict


class Figures:
    """The median of all samples, by side, workload and size."""

    def __init__(self):
        self._samples = defaultdict(list)

    def read(self, size, lines):
        """Takes the lines that a process printed: side, workload, figure."""
        for line in lines:
            side, workload, figure = line.split("\t")
            self._samples[side, workload, size].append(float(figure))

    def ours(self, workload, size):
        return self._median("ours", workload.name, size)

    def theirs(self, workload, size):
        return self._median("theirs", workload.theirs, size)

    def floor(self, workload, size):
        return self._median("floor", workload.name, size)

    def smaller(self, size):
        """The next smaller size that was measured, or None."""
        return max((s for _, _, s in self._samples if s < size), default=None)

    @staticmethod
    def decades(smaller, size):
        return math.log10(size / smaller)

    def _median(self, *key):
        return statistics.median(self._samples[key]) if key in self._samples else None
