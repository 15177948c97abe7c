"""Where the build and the tools are, and what is missing for these tests."""

import os
import shutil
import sys
import unittest

SOURCE = os.environ['MI_SOURCE']
BIN = os.environ['MI_BIN']
MIHOST = os.path.join(BIN, 'mihost')
SANDBOXED = os.path.join(BIN, 'sandboxed')
DAEMONS = os.path.join(SOURCE, 'build', 'daemons')

SKIPPED = 77


def daemon(path):
    """Returns a program that script/bootstrap unpacked, or the installed one."""
    unpacked = os.path.join(DAEMONS, path.lstrip('/'))
    return unpacked if os.path.exists(unpacked) else path


SSHD = daemon('/usr/sbin/sshd')
PROMETHEUS = daemon('/usr/bin/prometheus')
PROMTOOL = daemon('/usr/bin/promtool')
NODE_EXPORTER = daemon('/usr/bin/prometheus-node-exporter')


def problem(tools):
    """Returns why the tests cannot run here; None if they can."""
    if os.geteuid() != 0:
        return 'only root can make copies of the machine'
    for tool in tools:
        if not shutil.which(tool) and not os.path.exists(tool):
            return f"no {tool} here; 'script/bootstrap integration' installs it"
    return None


def skip_or_fail_without(tools):
    """Ends the program if the tests cannot run here."""
    reason = problem(tools)
    if reason and os.environ.get('MI_INTEGRATION_REQUIRED') != '1':
        # In the form that script/test looks for.
        print(f'{os.path.basename(sys.argv[0])}: Skipped\n{reason}')
        sys.exit(SKIPPED)
    if reason:
        sys.exit(reason)


def main(*tools):
    """Runs the tests of the calling file, or skips all of them with the reason."""
    skip_or_fail_without(tools)
    unittest.main(verbosity=2)


def main_in_sandbox(*tools):
    """As main, in a copy of this machine that is removed afterwards."""
    skip_or_fail_without(tools)
    inside = '--in-sandbox'
    if inside not in sys.argv:
        os.execv(SANDBOXED, [SANDBOXED, sys.executable, *sys.argv, inside])
    sys.argv.remove(inside)
    with open('/proc/1/comm') as first_process:
        if first_process.read() != 'sandboxed\n':
            sys.exit('not in a copy of the machine')
    unittest.main(verbosity=2)
