"""The table of the comparison."""

HEADINGS = f"{'workload':32} {'books':>9} {'ours':>12} {'theirs':>14} {'ratio':>8}  " \
           f"{'target':28} {'floor':>9}  met"


def print_table(workloads, sizes, figures):
    """A line for each workload, size and target; at the end, how many targets are met."""
    print(HEADINGS)
    verdicts = []
    for workload in workloads:
        for size in sizes:
            for target in applicable(workload, sizes, size):
                verdict = is_met(target, workload, size, figures)
                print_line(workload, size, figures, target, verdict)
                if target:
                    verdicts.append(verdict)
    print(f"{verdicts.count(True)} of {len(verdicts)} targets met")


def applicable(workload, sizes, size):
    """The targets at that size, or None if there are none. The smallest size has no growth."""
    targets = [t for t in workload.targets if not (t.is_growth and size == min(sizes))]
    return targets or [None]


def is_met(target, workload, size, figures):
    """None if what it takes was not measured."""
    ours = figures.ours(workload, size)
    bound = target.bound(figures, workload, size) if target else None
    return None if ours is None or bound is None else ours <= bound


def print_line(workload, size, figures, target, verdict):
    ours = figures.ours(workload, size)
    theirs = figures.theirs(workload, size)
    ratio = ours / theirs if ours is not None and theirs else None
    shown = "not measured" if ours is None else cell(ours)
    met = {True: "yes", False: "no", None: "-"}[verdict]
    print(f"{workload.name:32} {size:>9} {shown:>12} {cell(theirs):>14} {cell(ratio, 3):>8}  "
          f"{target or '-'!s:28} {cell(figures.floor(workload, size)):>9}  {met}")


def cell(figure, digits=1):
    return "-" if figure is None else f"{figure:,.{digits}f}"
