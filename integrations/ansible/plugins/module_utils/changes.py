"""Turns the changes that mihost reports into Ansible's diffs."""

from __future__ import absolute_import, division, print_function

__metaclass__ = type


def attribute_lines(change, side):
    """Mode and owner, which mihost reports only if they differ."""
    lines = []
    for attribute in ('mode', 'owner'):
        value = change.get(attribute, {}).get(side)
        if value is not None:
            lines.append('%s %s' % (attribute, value))
    return lines


def diff_of(changes):
    """One entry for each file but backups, with the lines that differ after all changes."""
    entries = {}
    order = []
    for change in changes:
        path = change['file']
        if change.get('backup'):
            continue
        if path not in entries:
            entries[path] = dict(before=[], after=[])
            order.append(path)
        entry = entries[path]
        removed = change['removed'] + attribute_lines(change, 'before')
        for line in removed:
            if line in entry['after']:
                entry['after'].remove(line)
            else:
                entry['before'].append(line)
        entry['after'] += change['added'] + attribute_lines(change, 'after')
    return [
        dict(
            before_header=path,
            after_header=path,
            before=''.join(line + '\n' for line in entries[path]['before']),
            after=''.join(line + '\n' for line in entries[path]['after']),
        )
        for path in order
    ]
