"""Turns mihost's nodes into native types keyed by name."""

from __future__ import absolute_import, division, print_function

__metaclass__ = type

# The kinds with many nodes: the key of the result, and the property that names a node.
LISTS = dict(
    driver=('drivers', 'driver_name'),
    user=('users', 'user_name'),
    group=('groups', 'group_name'),
)
SINGLE = ('computer', 'os')


def values_of(node):
    """The properties of a node; a value that is hidden or unknown is None."""
    return dict((name.replace('-', '_'), entry['value']) for name, entry in node['properties'].items())


def native(nodes):
    """The data of the nodes, without the nodes that have none."""
    result = {}
    for node in nodes:
        kind = node['kind']
        values = values_of(node)
        if kind in SINGLE:
            result[kind] = values
        elif kind in LISTS:
            key, name = LISTS[kind]
            result.setdefault(key, {})[values[name]] = values
        elif kind == 'log-entry':
            result.setdefault('log', []).append(values)
    return result
