"""Shared by both benchmarks of this directory: alternating rounds, and tables."""

import statistics


def alternating(subjects, rounds):
    """Returns the results of each subject, run round by round, so that other load slows all subjects."""
    results = {name: [] for name in subjects}
    for _ in range(rounds):
        for name, run in subjects.items():
            results[name].append(run())
    return results


def cell(values, digits=2):
    """Returns the median and, in brackets, the two quartiles."""
    low, middle, high = statistics.quantiles(values, n=4, method='inclusive')
    return f'{middle:.{digits}f} ({low:.{digits}f}-{high:.{digits}f})'


def table(heading, rows):
    lines = [heading, ['---'] * len(heading), *rows]
    return '\n'.join('| ' + ' | '.join(str(field) for field in line) + ' |' for line in lines)
