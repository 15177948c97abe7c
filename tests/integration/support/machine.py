"""An invented machine, laid over a copy of this one."""

import os
import shutil
import time

from support import environment

MACHINE = os.path.join(environment.SOURCE, 'tests', 'machines', 'users-and-groups')


def write(path, text, mode=0o644):
    with open(path, 'w') as file:
        file.write(text)
    os.chmod(path, mode)


def read(path):
    with open(path) as file:
        return file.read()


def lay():
    """Lays the invented machine, with modules and a log."""
    shutil.copytree(MACHINE, '/', dirs_exist_ok=True)
    os.chmod('/etc/shadow', 0o600)
    for name, script in (
        ('lsmod', 'echo Module Size Used by; echo one 1 0; echo two 1 0'),
        ('modinfo', 'echo "version:        1.$1"'),
    ):
        path = f'/usr/sbin/{name}'
        if os.path.lexists(path):
            os.unlink(path)
        write(path, f'#!/bin/sh\n{script}\n', 0o755)
    write('/var/log/messages', log_lines(['one', 'two', 'three']))


def log_lines(messages):
    stamp = time.strftime('%b %e %H:%M:%S')
    return ''.join(f'{stamp} mole test: {message}\n' for message in messages)


def accounts_file(name):
    """Returns the lines of an account file, keyed by the name that they begin with."""
    return {line.split(':')[0]: line for line in read(f'/etc/{name}').splitlines()}
