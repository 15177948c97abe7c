"""The page in the real Cockpit and a headless Chromium.

For tests that run in a copy of this machine: an invented machine is laid over it, Cockpit becomes part
of it, and its network is a loopback interface of its own.
"""

import os
import pwd
import shutil
import signal
import socket
import subprocess
import unittest

from support import browser, environment, machine
from support.machine import read, write
from support.wait import until

PAGE = os.environ.get('MI_PAGE', '')
WS = '/usr/lib/cockpit/cockpit-ws'
SHELL = '/usr/share/cockpit/shell'
NEEDED = (
    PAGE or 'npm', *browser.NEEDED, 'cockpit-bridge', environment.daemon(WS), environment.daemon(SHELL),
)

PORT = 9090
ADDRESS = f'http://127.0.0.1:{PORT}'
MIHOST = '/usr/local/bin/mihost'
CALLS = '/run/mihost-calls'
PROCESSES = '/run/mihost-processes'

# Cockpit starts this instead of the program. It records each call, and the arguments of every process of
# the machine at that time.
RECORDER = f'''#!/bin/sh
echo "$$ $*" >>{CALLS}
cat /proc/[0-9]*/cmdline 2>/dev/null | tr '\\0' ' ' >>{PROCESSES}
exec {environment.MIHOST} "$@"
'''
# Is killed in a preview, and does everything else.
DIES_IN_PREVIEW = RECORDER.replace('exec', '[ "$1" != --sandbox ] || kill -9 $$\nexec')


def install_mihost(script=RECORDER):
    """Puts a program where the page looks for mihost.

    Renamed into place: a file cannot be written while it is being started.
    """
    draft = MIHOST + '.new'
    write(draft, script, 0o755)
    os.replace(draft, MIHOST)


def install_cockpit():
    """Makes Cockpit and the page part of this copy of the machine."""
    for path in ('/usr/lib/cockpit', SHELL, '/usr/share/cockpit/static'):
        unpacked = environment.daemon(path)
        if unpacked != path:
            shutil.copytree(unpacked, path, dirs_exist_ok=True)
    shutil.copytree(PAGE, '/usr/share/cockpit/mihost')
    forget_calls()
    install_mihost()


def forget_calls():
    for file in (CALLS, PROCESSES):
        write(file, '', 0o666)


def calls():
    """Returns the arguments of each call of mihost since the page was opened."""
    return [line.partition(' ')[2] for line in read(CALLS).splitlines()]


def running(arguments):
    """Returns the process ids of the running mihosts with such arguments."""
    called = [line.split()[0] for line in read(CALLS).splitlines() if arguments in line]
    return [int(process) for process in called if os.path.exists(f'/proc/{process}')]


def kill_mihost(arguments):
    """Kills the mihost with such arguments, as soon as it runs."""
    os.kill(until(lambda: running(arguments), f'no mihost {arguments}')[-1], signal.SIGKILL)


def listening():
    with socket.socket() as connection:
        return connection.connect_ex(('127.0.0.1', PORT)) == 0


def session_of(account):
    """Returns the command that starts a session of an account without a login."""
    if account == 'root':
        return '/usr/bin/cockpit-bridge'
    identity = pwd.getpwnam(account)
    write('/run/session', f"""#!/bin/sh
HOME=/tmp USER={account} LOGNAME={account}
export HOME USER LOGNAME
exec setpriv --reuid={identity.pw_uid} --regid={identity.pw_gid} --clear-groups /usr/bin/cockpit-bridge
""", 0o755)
    return '/run/session'


class Cockpit:
    """A running cockpit-ws, to log in to or with the session of an account."""

    def __init__(self, account=None):
        session = [f'--local-session={session_of(account)}'] if account else []
        self.process = subprocess.Popen(
            [WS, '--no-tls', '--address=127.0.0.1', f'--port={PORT}', *session],
            stdin=subprocess.DEVNULL, stdout=subprocess.DEVNULL, stderr=subprocess.DEVNULL,
            env={'PATH': '/usr/local/bin:/usr/sbin:/usr/bin:/sbin:/bin', 'LC_ALL': 'C.UTF-8', 'HOME': '/root'},
        )
        until(lambda: self.process.poll() is not None or listening(), 'cockpit-ws does not listen')
        if self.process.returncode is not None:
            raise RuntimeError(f'cockpit-ws ended with {self.process.returncode} (run {WS})')

    def stop(self):
        self.process.kill()
        self.process.wait()


class Page(browser.Browser):
    """The page in a browser."""

    def open(self, tab=None):
        """Loads the page again with a tab of it chosen; the earlier calls of mihost are forgotten."""
        self.load('about:blank')
        forget_calls()
        self.load(f'{ADDRESS}/cockpit/@localhost/mihost/index.html')
        if tab:
            self.click(f'#tab-{tab}')


class PageTest(unittest.TestCase):
    """A test of the page; Cockpit and the browser serve all tests of the class."""

    ACCOUNT = 'root'

    @classmethod
    def setUpClass(cls):
        cls.prepare()
        cls.cockpit = Cockpit(cls.ACCOUNT)
        cls.addClassCleanup(cls.cockpit.stop)
        cls.browser = Page()
        cls.addClassCleanup(cls.browser.stop)

    @classmethod
    def prepare(cls):
        """Prepares the machine for the tests of the class."""
        machine.lay()


def main():
    environment.skip_or_fail_without(NEEDED)
    if 'MI_PICTURES_PIPE' in os.environ:
        browser.pictures()  # an empty archive where a test takes none
    else:
        browser.send_pictures()
    environment.main_in_sandbox(*NEEDED)
