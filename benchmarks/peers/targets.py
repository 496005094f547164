"""The workloads, and what each of them is to reach."""
from dataclasses import dataclass


class Target:
    """A bound of what we need; `bound` gives None where something for it was not measured."""
    is_growth = False


@dataclass(frozen=True)
class Times(Target):
    """At most so many times what one of the others needs."""
    factor: float
    other: str  # "theirs" or "floor", as `Figures` calls them

    def __str__(self):
        return f"{self.factor:g} x {self.other}"

    def bound(self, figures, workload, size):
        figure = getattr(figures, self.other)(workload, size)
        return None if figure is None else self.factor * figure


def times_theirs(factor):
    return Times(factor, "theirs")


def times_floor(factor):
    return Times(factor, "floor")


@dataclass(frozen=True)
class Absolute(Target):
    """At most that figure."""
    figure: float
    unit: str = "ns"

    def __str__(self):
        return f"{self.figure:,g} {self.unit}"

    def bound(self, _figures, _workload, _size):
        return self.figure


@dataclass(frozen=True)
class OtherWorkload(Target):
    """At most so many times what we need for another workload."""
    factor: float
    workload: str

    def __str__(self):
        return f"{self.factor:g} x {self.workload}"

    def bound(self, figures, _workload, size):
        other = figures.ours(Workload(self.workload), size)
        return None if other is None else self.factor * other


@dataclass(frozen=True)
class Growth(Target):
    """At most so many times as much at ten times the size.

    A cost that follows the logarithm of the size grows by 1.25 from 10^4 to 10^5; memory that is
    farther away adds to that. One that follows the square root grows by 3.2, the size itself by 10.
    """
    is_growth = True
    factor: float

    def __str__(self):
        return f"growth {self.factor:g}"

    def bound(self, figures, workload, size):
        smaller = figures.smaller(size)
        before = None if smaller is None else figures.ours(workload, smaller)
        if before is None:
            return None
        return before * self.factor ** figures.decades(smaller, size)


@dataclass(frozen=True)
class Workload:
    name: str
    targets: tuple = ()
    #: The name of what the peer does for it, if that differs.
    peer: str = ""

    @property
    def theirs(self):
        return self.peer or self.name


def moves():
    targets = (Absolute(1000), Growth(2))
    for way in "from the front", "from the back", "all at once":
        yield Workload(f"move {way}", targets)
        yield Workload(f"undo moves {way}", targets)


def reads(order, value, typed):
    name = f"read {order}"
    yield Workload(f"{name}, Value", (times_theirs(value),), name)
    yield Workload(f"{name}, typed accessor", (times_theirs(typed),), name)


WORKLOADS = (
    Workload("create", (times_theirs(0.5),)),
    Workload("bytes a book", (Absolute(200, "bytes"),)),
    *reads("in order", value=2, typed=1),
    Workload("read in order, generated getter", (times_floor(1.5),), "read in order"),
    *reads("at random", value=1.5, typed=1),
    Workload("set, Value", (times_theirs(2),), "set"),
    Workload("set, generated setter", (times_theirs(0.8),), "set"),
    Workload("set recorded", (times_theirs(0.25),)),
    Workload("bytes a recorded change", (Absolute(130, "bytes"),)),
    Workload("undo sets", (times_theirs(0.8),)),
    Workload("one recorded set", (Absolute(1500),)),
    *moves(),
    Workload("find by UUID", (times_theirs(0.3),)),
    Workload("resolve a reference", (times_theirs(1),)),
    Workload("read a local reference"),
    Workload("read a resolved reference", (OtherWorkload(1.2, "read a local reference"),)),
    Workload("count 1 %", (times_theirs(1),)),
    Workload("rows 1 %", (times_theirs(1),)),
    Workload("count 50 %", (times_theirs(1),)),
    Workload("rows 50 %", (times_theirs(1),)),
    Workload("rows of a join", (times_theirs(1),)),
    Workload("delete every second book", (times_theirs(0.1), Growth(2))),
    Workload("destroy the model", (times_floor(1.5),)),
)
