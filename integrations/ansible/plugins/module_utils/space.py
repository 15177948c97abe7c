"""Problems that a sandbox does not show: the machine's file systems may be full or read-only."""

from __future__ import absolute_import, division, print_function

__metaclass__ = type

import os


def nearest(path):
    """The path, or its longest existing part."""
    while not os.path.lexists(path):
        path = os.path.dirname(path)
    return path


def room_needed(path):
    """A tool writes a new copy next to the file; a new file takes a block."""
    return max(os.lstat(path).st_size, 1) if os.path.isfile(path) else 1


def obstacle(changes):
    """Why the changes would fail on the machine itself; None if unknown."""
    taken = {}
    for change in changes:
        if change['change'] == 'removed':
            continue
        path = change['file']
        place = nearest(path)
        system = os.statvfs(place)
        if system.f_flag & os.ST_RDONLY:
            return 'the file system of %s is read-only' % path
        device = os.lstat(place).st_dev
        blocks = -(-room_needed(path) // system.f_frsize)
        taken[device] = taken.get(device, 0) + blocks
        # A file system without a limit on inodes reports 0.
        is_out_of_inodes = system.f_files > 0 and system.f_ffree == 0
        if taken[device] > system.f_bfree or is_out_of_inodes:
            return 'no space left for %s' % path
    return None
